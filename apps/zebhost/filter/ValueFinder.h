#pragma once

#include <audiofilter/AudioFilter.h>

#include <optional>
#include <string>

namespace zebhost
{

// A filter turns values into text, but not text into values. This finds the normalised value whose text is the wanted
// one: among the steps of a stepped parameter, otherwise by halving the range along the number that the text begins
// with.
class ValueFinder
{
public:
    struct Found
    {
        float value = 0;
        std::string shown;  // what the plug-in displays for it
        bool exact = false; // false: the nearest that could be found
    };

    explicit ValueFinder(const zebaudiofilterhost::AudioFilterParameterInfo& info);

    // `info` is that of the filter's parameter at `index`. A plug-in that only knows the text of the current value is
    // set to other values for a moment, and back when this goes: no audio may run meanwhile.
    ValueFinder(zebaudiofilterhost::AudioFilter& filter, int index,
                const zebaudiofilterhost::AudioFilterParameterInfo& info);
    ~ValueFinder();
    ValueFinder(const ValueFinder&) = delete;
    ValueFinder& operator=(const ValueFinder&) = delete;

    // Throws a usage Failure that tells what the parameter can be, if nothing fits.
    Found Find(const std::string& wanted) const;

    // What the plug-in displays for a value.
    std::string Text(float value) const;

    // The same, with the unit if the plug-in leaves it out.
    std::string Shown(float value) const;

    // All texts of a stepped parameter, at most `limit`; empty for a continuous one.
    std::vector<std::string> StepTexts(int limit) const;

    // 0 for a continuous parameter.
    int StepCount() const;

    // The unit of the parameter, and what else its label says of it; one of them is empty. Where plug-ins only know
    // their current text, a label that is too long for a unit is the parameter's long name.
    const std::string& Unit() const { return mUnit; }
    const std::string& LongName() const { return mLongName; }

private:
    float StepValue(int step) const;
    std::string CurrentTextAt(float value) const;
    bool IsText(const std::string& text, const std::string& wanted) const;

    Found FindStep(const std::string& wanted) const;
    int StepByText(const std::string& wanted) const;
    int StepByNumber(const std::string& wanted) const;
    int StepByBeginning(const std::string& wanted) const;
    Found FindContinuous(const std::string& wanted) const;

    [[noreturn]] void Refuse(const std::string& wanted, const std::string& possible) const;

    const zebaudiofilterhost::AudioFilterParameterInfo& mInfo;
    zebaudiofilterhost::AudioFilter* mFilter = nullptr; // null if the info has all texts
    int mIndex = 0;
    mutable std::optional<float> mValueBefore; // of the filter's parameter, once it has been changed
    std::string mName;
    std::string mUnit;
    std::string mLongName;
};

} // namespace zebhost
