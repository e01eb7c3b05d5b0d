#include "filter/ProcessFailures.h"

#include "output/Strings.h"
#include "output/Tracing.h"

#include <foundation/zebcore/Trace.h>

#include <array>
#include <cstdio>
#include <string_view>

namespace zebhost
{

namespace
{

// VST 2 plug-ins have no way to say that a block has failed.
constexpr std::array<const char*, 2> kCategories = {"VST3AudioFilter::Process", "XAUAudioFilter::Process"};

// What stands in a trace line behind one of the categories and the level.
std::string_view FailureIn(std::string_view line)
{
    for (const std::string_view category : kCategories)
    {
        const std::size_t at = line.find(category);
        const std::size_t level = at == std::string_view::npos ? at : line.find(' ', at);
        const std::size_t text = level == std::string_view::npos ? level : line.find(' ', level + 1);
        if (text != std::string_view::npos)
        {
            return Trimmed(line.substr(text));
        }
    }
    return {};
}

} // namespace

ProcessFailures::ProcessFailures()
{
    zebcore::debug::SetTraceSink(
        [this](std::string_view line)
        {
            const std::string_view failure = FailureIn(line);
            if (mFirst.empty())
            {
                mFirst = failure;
            }
            if (failure.empty() || IsTracing(kCategories[0]) || IsTracing(kCategories[1]))
            {
                std::fwrite(line.data(), 1, line.size(), stderr);
            }
        });
    for (const char* category : kCategories)
    {
        zebcore::debug::SetTraceCategoryEnabled(category, true);
    }
}

ProcessFailures::~ProcessFailures()
{
    for (const char* category : kCategories)
    {
        zebcore::debug::SetTraceCategoryEnabled(category, IsTracing(category));
    }
    zebcore::debug::SetTraceSink({});
}

} // namespace zebhost
