#include "catalogue/BlockReasons.h"

#include "catalogue/SettingsFolder.h"
#include "output/JsonDocument.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/FileUtils.h>
#include <foundation/zebcore/NativePath.h>
#include <foundation/zebcore/SafeSave.h>
#include <foundation/zebcore/XmlUtils.h>

#include <array>
#include <ctime>
#include <fstream>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

constexpr int kVersion = 1;

std::string Key(const PluginLocator& locator)
{
    // Bytes that are no UTF-8 can't stand in JSON; escaped they can.
    zebcore::UTF16String key;
    zebcore::xml::utils::EncodeReservedCharacters(locator.ToString(), key);
    return ToUTF8(key);
}

std::string TimeOfNow()
{
    const std::time_t now = std::time(nullptr);
    std::tm parts{};
    gmtime_r(&now, &parts);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%SZ", &parts);
    return text.data();
}

std::string TextOf(const Json& entry, const char* key)
{
    const auto found = entry.find(key);
    return found != entry.end() && found->is_string() ? found->get<std::string>() : std::string();
}

} // namespace

BlockReasons::BlockReasons(std::filesystem::path file) : mFile(std::move(file))
{
}

void BlockReasons::Load()
{
    mReasons.clear();
    std::ifstream stream(mFile, std::ios::binary);
    const Json document = Json::parse(stream, nullptr, false);
    if (!document.is_object() || document.value("version", Json()) != kVersion || !document.contains("blocked") ||
        !document["blocked"].is_object())
    {
        return;
    }
    for (const auto& [key, entry] : document["blocked"].items())
    {
        if (entry.is_object())
        {
            mReasons[key] = {TextOf(entry, "reason"), TextOf(entry, "since")};
        }
    }
}

void BlockReasons::Save() const
{
    Json blocked = Json::object();
    for (const auto& [key, reason] : mReasons)
    {
        blocked[key] = Json{{"reason", reason.reason}, {"since", reason.since}};
    }
    const std::string text = ToText(Json{{"version", kVersion}, {"blocked", blocked}});
    std::filesystem::create_directories(mFile.parent_path());
    zebcore::filesupport::File target = ToFile(mFile);
    zebcore::filesupport::SafeSave save(target);
    zebcore::utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), {text.begin(), text.end()});
    save.Commit();
}

void BlockReasons::Set(const PluginLocator& locator, const std::string& reason)
{
    mReasons[Key(locator)] = {reason, TimeOfNow()};
}

void BlockReasons::Remove(const PluginLocator& locator)
{
    mReasons.erase(Key(locator));
}

BlockReason BlockReasons::Get(const PluginLocator& locator) const
{
    const auto found = mReasons.find(Key(locator));
    return found == mReasons.end() ? BlockReason() : found->second;
}

} // namespace zebhost
