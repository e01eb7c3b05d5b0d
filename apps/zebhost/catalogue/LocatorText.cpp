#include "catalogue/LocatorText.h"

#include <foundation/zebcore/PropList.h>
#include <foundation/zebcore/PropListUtils.h>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using zebcore::proplist::PropList;

namespace
{

const zebcore::UTF8String kLocator = u8"locator";

} // namespace

// A path need not be text that JSON can hold; a property list holds anything.
std::string LocatorText(const PluginLocator& locator)
{
    PropList list;
    list.SetValue(kLocator, locator.ToString());
    zebcore::UTF8String text;
    zebcore::proplist::utils::WritePropList(text, list);
    return {text.begin(), text.end()};
}

std::optional<PluginLocator> ParseLocatorText(const std::string& text)
{
    PropList list;
    zebcore::UTF16String locatorText;
    if (!zebcore::proplist::utils::ReadPropList({text.begin(), text.end()}, list) ||
        !list.GetValue(kLocator, locatorText))
    {
        return std::nullopt;
    }
    PluginLocator locator;
    locator.FromString(locatorText);
    return locator;
}

} // namespace zebhost
