#pragma once

#include <audiofilter/AudioFilterParameterInfo.h>

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

    // Throws a usage Failure that tells what the parameter can be, if nothing fits.
    Found Find(const std::string& wanted) const;

    // The text of a value, with the unit if the plug-in leaves it out.
    std::string Shown(float value) const;

    // All texts of a stepped parameter, at most `limit`; empty for a continuous one.
    std::vector<std::string> StepTexts(int limit) const;

private:
    int StepCount() const;
    float StepValue(int step) const;
    std::string Text(float value) const;
    bool IsText(const std::string& text, const std::string& wanted) const;

    Found FindStep(const std::string& wanted) const;
    int StepByText(const std::string& wanted) const;
    int StepByNumber(const std::string& wanted) const;
    int StepByBeginning(const std::string& wanted) const;
    Found FindContinuous(const std::string& wanted) const;

    [[noreturn]] void Refuse(const std::string& wanted, const std::string& possible) const;

    const zebaudiofilterhost::AudioFilterParameterInfo& mInfo;
    std::string mName;
    std::string mLabel;
};

} // namespace zebhost
