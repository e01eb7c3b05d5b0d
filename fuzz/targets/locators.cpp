// Locators as text, and their order, on which maps and sets of the catalogue rest.
#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/PluginLocator.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

PluginLocator Parsed(const UTF16String& text)
{
    PluginLocator locator(kTechnologyVST, u"stale");
    locator.FromString(text);
    return locator;
}

void CheckText(const UTF16String& text)
{
    const PluginLocator locator = Parsed(text);
    const PluginLocator again = Parsed(locator.ToString());
    Expect(again == locator && again.GetPath() == locator.GetPath(), "a locator's text leads back to it");
    Expect(again.ToString() == locator.ToString(), "a locator has one text");
    const std::size_t colon = text.find(u':');
    Expect(locator.GetPath() == (colon == UTF16String::npos ? UTF16String() : text.substr(colon + 1)),
           "the path is all that follows the first colon");
    Expect(colon != UTF16String::npos || locator.GetTechnologyType() == kTechnologyNone,
           "a text without a colon has no technology");
}

void CheckOrder(const PluginLocator& a, const PluginLocator& b, const PluginLocator& c)
{
    Expect(!(a < a) && a == a, "a locator equals itself");
    Expect(!(a < b && b < a), "one of two locators comes first");
    Expect((a == b) == (!(a < b) && !(b < a)) && (a != b) == !(a == b), "equality follows the order");
    Expect(!(a < b && b < c) || a < c, "the order is transitive");
}

void Run(Bytes bytes)
{
    const UTF16String text = zebcore::utility::UTF8to16(TextOf(bytes));
    const std::size_t first = std::min(text.find(u'\n'), text.size());
    const std::size_t second = std::min(text.find(u'\n', std::min(first + 1, text.size())), text.size());
    const UTF16String texts[] = {text.substr(0, first), text.substr(first, second - first), text.substr(second)};
    for (const UTF16String& each : texts)
        CheckText(each);
    CheckOrder(Parsed(texts[0]), Parsed(texts[1]), Parsed(texts[2]));
    CheckOrder(Parsed(texts[2]), Parsed(texts[0]), Parsed(texts[1]));
}

const Target kTarget("locators", Run);

} // namespace
