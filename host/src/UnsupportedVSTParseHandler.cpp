#include "host/src/UnsupportedVSTParseHandler.h"

#include <utility>

namespace zebaudiofilterhost
{

namespace
{

enum State
{
    kState_Start = 0,
    kState_PluginList = 1,
    kState_Plugin = 2
};

using Attributes = zebcore::xml::AbstractParseHandler::Attributes;

// A missing attribute counts as empty.
UTF16String GetAttribute(const Attributes& attributes, const UTF16String& name)
{
    const auto found = attributes.find(name);
    return found == attributes.end() ? UTF16String() : found->second;
}

} // namespace

UnsupportedVSTParseHandler::UnsupportedVSTParseHandler(std::vector<StaticBanEntry>& entries)
    : mStates({kState_Start}), mEntries(entries)
{
}

// A "plugin" element counts wherever it stands: the states are kept, and never consulted.
void UnsupportedVSTParseHandler::StartElement(const UTF16String& name, const Attributes& attributes)
{
    if (name == u"pluginlist")
    {
        mStates.push(kState_PluginList);
    }
    else if (name == u"plugin")
    {
        mStates.push(kState_Plugin);
        UTF16String fileName = GetAttribute(attributes, u"filename");
        if (!fileName.empty())
        {
            mEntries.push_back(
                {std::move(fileName), GetAttribute(attributes, u"uniqueid"), GetAttribute(attributes, u"version")});
        }
    }
}

void UnsupportedVSTParseHandler::EndElement(const UTF16String&)
{
    // Elements of other names push nothing but pop as well, so the stack may run out before the file does.
    if (!mStates.empty())
    {
        mStates.pop();
    }
}

void UnsupportedVSTParseHandler::Characters(const UTF16String&)
{
}

} // namespace zebaudiofilterhost
