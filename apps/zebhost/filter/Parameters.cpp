#include "filter/Parameters.h"

#include "cli/Failure.h"
#include "output/Numbers.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <algorithm>
#include <array>
#include <optional>
#include <vector>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;

namespace
{

int ByNumber(const AudioFilter& filter, const std::string& name)
{
    if (name.size() < 2 || name.front() != '#')
    {
        return -1;
    }
    const double number = ParseNumber(name.substr(1)).value_or(0);
    const bool there = number >= 1 && number <= filter.GetParameterCount();
    return there ? static_cast<int>(number) - 1 : -1;
}

std::vector<int> Fitting(const AudioFilter& filter, const std::string& wanted)
{
    using Reading = bool (*)(const std::string& name, const std::string& wanted);
    const std::array<Reading, 3> readings = {
        [](const std::string& name, const std::string& text) { return name == text; },
        [](const std::string& name, const std::string& text) { return EqualIgnoringCase(name, text); },
        [](const std::string& name, const std::string& text)
        {
            return StartsWithIgnoringCase(name, text);
        }};
    for (const Reading reading : readings)
    {
        std::vector<int> fitting;
        for (int index = 0; index < filter.GetParameterCount(); ++index)
        {
            if (reading(ParameterName(filter, index), wanted))
            {
                fitting.push_back(index);
            }
        }
        if (!fitting.empty())
        {
            return fitting;
        }
    }
    return {};
}

std::string NamesOf(const AudioFilter& filter, const std::vector<int>& indices)
{
    constexpr std::size_t kMost = 16;
    std::vector<std::string> names;
    for (std::size_t place = 0; place < std::min(indices.size(), kMost); ++place)
    {
        names.push_back(ParameterName(filter, indices[place]) + " (#" + std::to_string(indices[place] + 1) + ")");
    }
    return Joined(names, ", ") + (indices.size() > kMost ? ", ..." : "");
}

std::vector<int> All(const AudioFilter& filter)
{
    std::vector<int> indices;
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        indices.push_back(index);
    }
    return indices;
}

std::optional<int> Only(const AudioFilter& filter, const std::string& name)
{
    const std::string trimmed(Trimmed(name));
    const int byNumber = ByNumber(filter, trimmed);
    if (byNumber >= 0)
    {
        return byNumber;
    }
    const std::vector<int> fitting = trimmed.empty() ? std::vector<int>() : Fitting(filter, trimmed);
    return fitting.size() == 1 ? std::optional<int>(fitting.front()) : std::nullopt;
}

} // namespace

std::string ParameterName(const AudioFilter& filter, int index)
{
    const auto info = filter.GetParameterInfo(index);
    return info == nullptr ? std::string() : Printable(info->GetName());
}

int FindParameter(const AudioFilter& filter, const std::string& name)
{
    if (const std::optional<int> index = Only(filter, name))
    {
        return *index;
    }
    const std::vector<int> fitting = Fitting(filter, std::string(Trimmed(name)));
    if (fitting.size() > 1)
    {
        throw Failure(ExitCode::Usage, "several parameters fit " + name + ": " + NamesOf(filter, fitting) +
                                           "; give a number such as #" + std::to_string(fitting.front() + 1));
    }
    throw Failure(
        ExitCode::Usage,
        "there is no parameter " + name + ": " +
            (filter.GetParameterCount() == 0 ? "this filter has none" : "there are " + NamesOf(filter, All(filter))));
}

std::pair<int, std::string> SplitAssignment(const AudioFilter& filter, const std::string& text)
{
    const std::size_t first = text.find('=');
    if (first == std::string::npos || first == 0)
    {
        throw Failure(ExitCode::Usage, text + ": give a parameter's name, an equal sign and a value");
    }
    for (std::size_t at = first; at != std::string::npos; at = text.find('=', at + 1))
    {
        if (const std::optional<int> index = Only(filter, text.substr(0, at)))
        {
            return {*index, text.substr(at + 1)};
        }
    }
    return {FindParameter(filter, text.substr(0, first)), text.substr(first + 1)};
}

float ParseNormalised(const std::string& text)
{
    const std::optional<double> value = ParseNumber(text);
    if (!value || *value < 0 || *value > 1)
    {
        throw Failure(ExitCode::Usage, text + " is no normalised value: give a number from 0 to 1");
    }
    return static_cast<float>(*value);
}

} // namespace zebhost
