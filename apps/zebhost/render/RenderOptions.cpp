#include "render/RenderOptions.h"

#include "cli/Failure.h"
#include "filter/LoadFilter.h"
#include "output/Numbers.h"
#include "output/Strings.h"

#include <optional>

namespace zebhost
{

namespace
{

std::string_view WithoutEnding(std::string_view text, std::string_view ending)
{
    const bool ends =
        text.size() > ending.size() && EqualIgnoringCase(text.substr(text.size() - ending.size()), ending);
    return ends ? Trimmed(text.substr(0, text.size() - ending.size())) : std::string_view();
}

} // namespace

double TailLength::LongestSeconds() const
{
    constexpr double kLongest = 60; // when a level or the plug-in ends it
    return kind == Kind::Seconds ? seconds : kLongest;
}

TailLength ParseTail(const std::string& text)
{
    constexpr double kLongest = 3600;
    if (EqualIgnoringCase(text, "auto"))
    {
        return {};
    }
    const std::optional<double> level = ParseNumber(WithoutEnding(text, "db"));
    if (level && *level < 0 && *level >= -200)
    {
        return {TailLength::Kind::Level, 0, *level};
    }
    const std::string_view withoutUnit = WithoutEnding(text, "s");
    const std::optional<double> seconds = ParseNumber(withoutUnit.empty() ? std::string_view(text) : withoutUnit);
    if (!seconds || *seconds < 0 || *seconds > kLongest)
    {
        throw Failure(ExitCode::Usage,
                      "--tail " + text + ": give auto, seconds from 0 to 3600, or a level such as -90dB");
    }
    return {TailLength::Kind::Seconds, *seconds, 0};
}

RenderOptions::RenderOptions(const Arguments& arguments)
    : block(arguments.Count("block", 512, 1, 1 << 20))
    , tail(ParseTail(arguments.Text("tail", "auto")))
    , trim(!arguments.Has("no-trim"))
    , realtime(arguments.Has("realtime"))
    , overwrite(arguments.Has("overwrite"))
    , settleMs(static_cast<unsigned int>(arguments.Count("settle", static_cast<int>(kDefaultSettleMs), 0, 600000)))
    , on(arguments.Text("on"))
    , sideChain(arguments.Text("side-chain"))
    , automation(arguments.Text("automation"))
    , format(arguments.Text("format"))
{
    time.tempo = arguments.Number("tempo", 120, 1, 10000);
    ReadTimeSignature(arguments.Text("time-sig", "4/4"), time);
}

} // namespace zebhost
