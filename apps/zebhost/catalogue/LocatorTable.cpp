#include "catalogue/LocatorTable.h"

#include "catalogue/SettingsFolder.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/FileExceptions.h>
#include <foundation/zebcore/FileUtils.h>
#include <foundation/zebcore/SafeSave.h>
#include <foundation/zebcore/XmlUtils.h>

#include <cerrno>
#include <fstream>
#include <optional>
#include <sstream>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
namespace FileUtils = zebcore::utility::FileUtils;

namespace
{

constexpr int kTableVersion = 1;

std::string Key(const PluginLocator& locator)
{
    // Bytes that are no UTF-8 can't stand in JSON; escaped they can.
    zebcore::UTF16String key;
    zebcore::xml::utils::EncodeReservedCharacters(locator.ToString(), key);
    return ToUTF8(key);
}

// Nothing if there is no such file.
std::optional<std::string> TextOf(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    const int error = stream ? 0 : errno;
    if (error == ENOENT || error == ENOTDIR)
    {
        return std::nullopt;
    }
    if (error != 0)
    {
        throw zebcore::filesupport::file_exception("cannot read", ToFile(file).FullPath(), error);
    }
    std::ostringstream text;
    text << stream.rdbuf();
    return text.str();
}

} // namespace

LocatorTable::LocatorTable(std::filesystem::path file, std::string section)
    : mFile(std::move(file)), mSection(std::move(section))
{
}

bool LocatorTable::Load()
{
    mEntries.clear();
    const std::optional<std::string> text = TextOf(mFile);
    if (!text)
    {
        return true;
    }
    const Json document = Json::parse(*text, nullptr, false);
    if (!document.is_object() || document.value("version", Json()) != kTableVersion || !document.contains(mSection) ||
        !document[mSection].is_object())
    {
        return false;
    }
    bool isSound = true;
    for (const auto& [key, entry] : document[mSection].items())
    {
        if (entry.is_object())
        {
            mEntries[key] = entry;
        }
        isSound = isSound && entry.is_object();
    }
    return isSound;
}

void LocatorTable::Save(Saving saving) const
{
    Json entries = Json::object();
    for (const auto& [key, entry] : mEntries)
    {
        entries[key] = entry;
    }
    const std::string text = ToText(Json{{"version", kTableVersion}, {mSection, entries}});
    std::filesystem::create_directories(mFile.parent_path());
    if (saving == Saving::Quick)
    {
        SaveQuickly(text);
        return;
    }
    zebcore::filesupport::File target = ToFile(mFile);
    zebcore::filesupport::SafeSave save(target);
    FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), {text.begin(), text.end()});
    save.Commit();
}

// One fixed name, so that killed saves leave one file at most.
void LocatorTable::SaveQuickly(const std::string& text) const
{
    std::filesystem::path fresh = mFile;
    fresh += ".new";
    try
    {
        FileUtils::SimpleWriteStringToFile(ToFile(fresh).FullPath(), {text.begin(), text.end()});
        std::error_code error;
        std::filesystem::rename(fresh, mFile, error);
        if (error)
        {
            throw zebcore::filesupport::file_exception("cannot replace", ToFile(mFile).FullPath(), error.value());
        }
    }
    catch (...)
    {
        std::error_code ignored;
        std::filesystem::remove(fresh, ignored);
        throw;
    }
}

const Json* LocatorTable::Find(const PluginLocator& locator) const
{
    const auto found = mEntries.find(Key(locator));
    return found == mEntries.end() ? nullptr : &found->second;
}

void LocatorTable::Set(const PluginLocator& locator, Json entry)
{
    mEntries[Key(locator)] = std::move(entry);
}

void LocatorTable::Remove(const PluginLocator& locator)
{
    mEntries.erase(Key(locator));
}

std::string TextIn(const Json& entry, const char* name)
{
    const auto found = entry.find(name);
    return found != entry.end() && found->is_string() ? found->get<std::string>() : std::string();
}

} // namespace zebhost
