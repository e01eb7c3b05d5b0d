#include "catalogue/UnitBundle.h"

#include <foundation/zebcore/NativePath.h>
#include <foundation/zebcore/XmlParser.h>
#include <host/TechnologyType.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace zebhost
{

namespace fs = std::filesystem;

using zebaudiofilterhost::PluginLocator;
using zebcore::UTF16String;

namespace
{

// Those that a search of the catalogue takes.
constexpr std::array<std::u16string_view, 4> kTypes = {u"aumx", u"aumf", u"aufx", u"aupn"};

using UnitEntry = std::map<UTF16String, UTF16String>;

// Four characters of Latin 1 as a number, in decimal.
std::optional<std::string> Number(const UTF16String& code)
{
    constexpr std::size_t kLength = 4;
    constexpr unsigned int kBits = 8;
    std::uint32_t number = 0;
    for (const char16_t character : code)
    {
        if (character > 0xFF)
        {
            return std::nullopt;
        }
        number = number << kBits | character;
    }
    return code.size() == kLength ? std::optional(std::to_string(number)) : std::nullopt;
}

std::optional<PluginLocator> ToLocator(UnitEntry entry)
{
    const auto type = Number(entry[u"type"]);
    const auto subType = Number(entry[u"subtype"]);
    const auto maker = Number(entry[u"manufacturer"]);
    if (!type || !subType || !maker || std::find(kTypes.begin(), kTypes.end(), entry[u"type"]) == kTypes.end())
    {
        return std::nullopt;
    }
    const std::string id = *type + ' ' + *subType + ' ' + *maker;
    return PluginLocator(zebaudiofilterhost::kTechnologyAudioUnit, {id.begin(), id.end()});
}

// Follows a property list down to the texts of the dictionaries in "AudioComponents", two levels below that of the
// list.
class UnitReader final : public zebcore::xml::AbstractParseHandler
{
public:
    explicit UnitReader(std::vector<PluginLocator>& units) : mUnits(units) {}

    void StartElement(const UTF16String&, const Attributes&) override
    {
        ++mDepth;
        mText.clear();
        if (mDepth == kEntryDepth)
        {
            mEntry.clear();
        }
    }

    void Characters(const UTF16String& text) override { mText += text; }

    void EndElement(const UTF16String& name) override
    {
        if (mDepth == kListDepth && name == u"key")
        {
            mList = mText;
        }
        else if (mDepth == kTextDepth && name == u"key")
        {
            mKey = mText;
        }
        else if (mDepth == kTextDepth && name == u"string")
        {
            mEntry[mKey] = mText;
        }
        else if (mDepth == kEntryDepth && name == u"dict" && mList == u"AudioComponents")
        {
            Take();
        }
        --mDepth;
    }

private:
    static constexpr int kListDepth = 3; // in <plist><dict>
    static constexpr int kEntryDepth = kListDepth + 1;
    static constexpr int kTextDepth = kEntryDepth + 1;

    void Take()
    {
        const std::optional<PluginLocator> unit = ToLocator(std::exchange(mEntry, {}));
        if (unit && std::find(mUnits.begin(), mUnits.end(), *unit) == mUnits.end())
        {
            mUnits.push_back(*unit);
        }
    }

    std::vector<PluginLocator>& mUnits;
    int mDepth = 0;
    UTF16String mText;
    UTF16String mList;
    UTF16String mKey;
    UnitEntry mEntry;
};

// The component layer of Linux takes these ahead of what it finds in its folders; macOS knows what is installed. It
// goes through the environment so that workers have it, too. Once is enough: a path is asked about more than once.
void Announce(const fs::path& bundle)
{
    constexpr const char* kVariable = "AUDIO_COMPONENT_BUNDLES";
    const char* const value = std::getenv(kVariable);
    const std::string before = value != nullptr ? value : "";
    if ((':' + before + ':').find(':' + bundle.string() + ':') == std::string::npos)
    {
        setenv(kVariable, (bundle.string() + (before.empty() ? "" : ':' + before)).c_str(), 1);
    }
}

} // namespace

std::vector<PluginLocator> UnitsOf(const fs::path& bundle)
{
    std::vector<PluginLocator> units;
    zebcore::xml::XmlParser parser(std::make_unique<UnitReader>(units));
    if (parser.Parse(zebcore::filesupport::FromNativePath((bundle / "Contents" / "Info.plist").string())) != 0)
    {
        return {};
    }
    if (!units.empty())
    {
        Announce(bundle);
    }
    return units;
}

} // namespace zebhost
