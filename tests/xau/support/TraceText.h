#pragma once

#include "foundation/zebcore/Trace.h"

#include <string>
#include <string_view>
#include <vector>

namespace zebaudiofilterhost::xau
{

// What is traced while it lives.
class TraceText
{
public:
    explicit TraceText(const char* category) : mCategory(category)
    {
        zebcore::debug::SetTraceSink([this](std::string_view line) { mLines.emplace_back(line); });
        zebcore::debug::SetTraceCategoryEnabled(category, true);
    }
    ~TraceText()
    {
        zebcore::debug::SetTraceCategoryEnabled(mCategory, false);
        zebcore::debug::SetTraceSink({});
    }
    TraceText(const TraceText&) = delete;
    TraceText& operator=(const TraceText&) = delete;

    std::vector<std::string> mLines;

private:
    const char* mCategory;
};

} // namespace zebaudiofilterhost::xau
