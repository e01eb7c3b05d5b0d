#pragma once

#include "foundation/zebcore/AbstractParseHandler.h"
#include "host/StaticBanEntry.h"

#include <stack>
#include <vector>

namespace zebaudiofilterhost
{

// Reads the permanent block list into a vector that outlives the handler.
class UnsupportedVSTParseHandler : public zebcore::xml::AbstractParseHandler
{
public:
    explicit UnsupportedVSTParseHandler(std::vector<StaticBanEntry>& entries);

    void StartElement(const UTF16String& name, const Attributes& attributes) override;
    void EndElement(const UTF16String& name) override;
    void Characters(const UTF16String& text) override;

private:
    std::stack<int> mStates;
    std::vector<StaticBanEntry>& mEntries;
};

} // namespace zebaudiofilterhost
