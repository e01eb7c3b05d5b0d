#include "cli/Arguments.h"

#include "cli/Failure.h"
#include "output/Numbers.h"

#include <cmath>

namespace zebhost
{

namespace
{

[[noreturn]] void RefuseNumber(std::string_view name, const std::string& text, const std::string& wanted)
{
    throw Failure(ExitCode::Usage, "--" + std::string(name) + " " + text + ": give " + wanted);
}

std::string Bounds(double lowest, double highest)
{
    return " from " + ShortNumber(lowest) + " to " + ShortNumber(highest);
}

} // namespace

void Arguments::Add(std::string_view name, std::vector<std::string> values)
{
    mValues[std::string(name)] = std::move(values);
}

bool Arguments::Has(std::string_view name) const
{
    return mValues.find(name) != mValues.end();
}

std::string Arguments::Text(std::string_view name) const
{
    return Text(name, {});
}

std::string Arguments::Text(std::string_view name, const std::string& fallback) const
{
    const auto found = mValues.find(name);
    return found == mValues.end() || found->second.empty() ? fallback : found->second.back();
}

std::vector<std::string> Arguments::All(std::string_view name) const
{
    const auto found = mValues.find(name);
    return found == mValues.end() ? std::vector<std::string>() : found->second;
}

double Arguments::Number(std::string_view name, double fallback, double lowest, double highest) const
{
    if (!Has(name))
    {
        return fallback;
    }
    const std::string text = Text(name);
    const std::optional<double> value = ParseNumber(text);
    if (!value || !(*value >= lowest && *value <= highest))
    {
        RefuseNumber(name, text, "a number" + Bounds(lowest, highest));
    }
    return *value;
}

int Arguments::Count(std::string_view name, int fallback, int lowest, int highest) const
{
    const double value = Number(name, fallback, lowest, highest);
    if (value != std::floor(value))
    {
        RefuseNumber(name, Text(name), "a whole number" + Bounds(lowest, highest));
    }
    return static_cast<int>(value);
}

} // namespace zebhost
