#include "filter/NumericRange.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace zebhost
{

namespace
{

constexpr int kSamples = 128;

double Position(int sample)
{
    return static_cast<double>(sample) / kSamples;
}

} // namespace

NumericRange::NumericRange(Display display) : mDisplay(std::move(display))
{
    FindEnds();
    mMonotone = CheckMonotone();
}

// Words such as "Off" may stand at either end.
void NumericRange::FindEnds()
{
    int first = 0;
    int last = kSamples;
    while (first < kSamples && !mDisplay(Position(first)))
    {
        ++first;
    }
    while (last > first && !mDisplay(Position(last)))
    {
        --last;
    }
    mBegin = Position(first);
    mEnd = Position(last);
    mRising = ValueAt(mBegin) <= ValueAt(mEnd);
}

bool NumericRange::CheckMonotone() const
{
    std::optional<double> previous;
    for (int sample = 0; sample <= kSamples; ++sample)
    {
        const double position = Position(sample);
        if (position < mBegin || position > mEnd)
        {
            continue;
        }
        const std::optional<Quantity> shown = mDisplay(position);
        if (!shown || (previous && (mRising ? shown->value < *previous : shown->value > *previous)))
        {
            return false;
        }
        previous = shown->value;
    }
    return previous.has_value() && ValueAt(mBegin) != ValueAt(mEnd);
}

double NumericRange::ValueAt(double normalised) const
{
    const std::optional<Quantity> shown = mDisplay(normalised);
    return shown ? shown->value : 0;
}

double NumericRange::Lowest() const
{
    return std::min(ValueAt(mBegin), ValueAt(mEnd));
}

double NumericRange::Highest() const
{
    return std::max(ValueAt(mBegin), ValueAt(mEnd));
}

// The lowest normalised value from which on isBeyond holds, to within what a float can tell apart.
double NumericRange::Edge(const std::function<bool(double)>& isBeyond) const
{
    if (isBeyond(ValueAt(mBegin)))
    {
        return mBegin;
    }
    double before = mBegin;
    double after = mEnd;
    for (int round = 0; round < 40; ++round)
    {
        const double middle = (before + after) / 2;
        (isBeyond(ValueAt(middle)) ? after : before) = middle;
    }
    return after;
}

double NumericRange::Locate(double wanted) const
{
    const double tolerance = std::isfinite(wanted) ? std::abs(wanted) * 1e-9 : 0;
    const bool rising = mRising;
    const double from =
        Edge([=](double value) { return rising ? value >= wanted - tolerance : value <= wanted + tolerance; });
    const double to =
        Edge([=](double value) { return rising ? value > wanted + tolerance : value < wanted - tolerance; });
    // A number that the end of the range displays is meant to be that end.
    if (from == mBegin)
    {
        return mBegin;
    }
    const bool endShowsWanted = ValueAt(mEnd) == wanted || std::abs(ValueAt(mEnd) - wanted) <= tolerance;
    return endShowsWanted ? mEnd : (from + to) / 2;
}

} // namespace zebhost
