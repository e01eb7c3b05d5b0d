#pragma once

#include "filter/Quantity.h"

#include <functional>
#include <optional>

namespace zebhost
{

// The numbers that a continuous parameter displays, as a function of its normalised value.
class NumericRange
{
public:
    // What stands on the display for a normalised value; nothing where that is no number.
    using Display = std::function<std::optional<Quantity>(double normalised)>;

    explicit NumericRange(Display display);

    // Whether the numbers only ever rise, or only ever fall, over the part of the range that displays numbers.
    bool IsMonotone() const { return mMonotone; }
    double Lowest() const;
    double Highest() const;

    // The normalised value in the middle of those that display `wanted`, or next to which it would stand.
    double Locate(double wanted) const;

private:
    void FindEnds();
    bool CheckMonotone() const;
    double ValueAt(double normalised) const;
    double Edge(const std::function<bool(double value)>& isBeyond) const;

    Display mDisplay;
    double mBegin = 0; // normalised ends of the part that displays numbers
    double mEnd = 1;
    bool mRising = true;
    bool mMonotone = false;
};

} // namespace zebhost
