#include "host/BannedPluginManager.h"

#include "foundation/zebcore/CaseInsensitive.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/XmlParser.h"
#include "host/src/IndexedKeys.h"
#include "host/src/UnsupportedVSTParseHandler.h"

#include <algorithm>
#include <exception>
#include <memory>

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_BlockListVersion = u8"version";
const UTF8String kKey_NumBannedPluginFiles = u8"num_banned_plugin_files";
const UTF8String kKey_BannedPluginFiles = u8"banned_plugin_files";

constexpr unsigned int kBlockListVersion = 1;

using zebcore::utility::CaseInsensitive::Equal;

bool IsEmptyOrEqual(const UTF16String& wanted, const UTF16String& text)
{
    return wanted.empty() || Equal(wanted, text);
}

} // namespace

BannedPluginManager& BannedPluginManager::GetInstance()
{
    static BannedPluginManager sInstance;
    return sInstance;
}

BannedPluginManager::BannedPluginManager()
    : mSettingsFileName(u"DynamicAudioPlugInBlacklist.xml")
    , mPermanentBannedSettingsFileName(u"PermanentAudioPlugInBlacklist.xml")
{
}

BannedPluginManager::~BannedPluginManager() = default;

void BannedPluginManager::LoadConfiguration(File& file)
{
    if (!file.Exists())
    {
        return;
    }
    PropList list;
    zebcore::proplist::utils::LoadPropList(file.FullPath(), list, false);
    unsigned int version = 0;
    list.GetValue(kKey_BlockListVersion, version);
    if (version == kBlockListVersion)
    {
        ReadBannedPlugins(list);
    }
}

void BannedPluginManager::SaveConfiguration(File& file) const
{
    PropList list;
    list.SetValue(kKey_BlockListVersion, kBlockListVersion);
    WriteBannedPlugins(list);
    zebcore::proplist::utils::SavePropList(file, list);
}

void BannedPluginManager::ReadBannedPlugins(const PropList& list)
{
    int count = 0;
    list.GetValue(kKey_NumBannedPluginFiles, count);
    std::set<PluginLocator> banned;
    for (const std::size_t index : PresentIndices(list, kKey_BannedPluginFiles, count))
    {
        UTF16String text;
        list.GetValue(IndexedKey(kKey_BannedPluginFiles, index), text);
        if (!text.empty())
        {
            PluginLocator locator;
            locator.FromString(text);
            banned.insert(locator);
        }
    }
    mBannedPlugins.swap(banned);
}

void BannedPluginManager::WriteBannedPlugins(PropList& list) const
{
    list.SetValue(kKey_NumBannedPluginFiles, static_cast<int>(mBannedPlugins.size()));
    std::size_t index = 0;
    for (const PluginLocator& locator : mBannedPlugins)
    {
        list.SetValue(IndexedKey(kKey_BannedPluginFiles, index), locator.ToString());
        ++index;
    }
}

bool BannedPluginManager::LoadStaticConfiguration(File& file)
{
    try
    {
        if (!file.Exists())
        {
            return false;
        }
        std::vector<StaticBanEntry> entries;
        std::unique_ptr<zebcore::xml::AbstractParseHandler> handler =
            std::make_unique<UnsupportedVSTParseHandler>(entries);
        const auto parser = zebcore::xml::GetParser(handler);
        if (parser->Parse(file.FullPath()) != 0)
        {
            return false;
        }
        mStaticEntries.swap(entries);
        return true;
    }
    catch (const std::exception&)
    {
        return false;
    }
}

void BannedPluginManager::AddBannedPlugin(const PluginLocator& locator)
{
    mBannedPlugins.insert(locator);
}

void BannedPluginManager::RemoveBannedPlugin(const PluginLocator& locator)
{
    mBannedPlugins.erase(locator);
}

bool BannedPluginManager::IsPluginBanned(const PluginLocator& locator) const
{
    return mBannedPlugins.contains(locator);
}

bool BannedPluginManager::IsPluginBannedStatically(const UTF16String& fileName, const UTF16String& uniqueID,
                                                   const UTF16String& version) const
{
    return std::any_of(mStaticEntries.begin(), mStaticEntries.end(),
                       [&](const StaticBanEntry& entry)
                       {
                           return Equal(entry.fileName, fileName) && IsEmptyOrEqual(entry.uniqueID, uniqueID) &&
                                  IsEmptyOrEqual(entry.version, version);
                       });
}

BannedPluginManager::BannedIterator BannedPluginManager::BannedBegin() const
{
    return mBannedPlugins.begin();
}

BannedPluginManager::BannedIterator BannedPluginManager::BannedEnd() const
{
    return mBannedPlugins.end();
}

void BannedPluginManager::SetSettingsFileName(const UTF16String& name)
{
    mSettingsFileName = name;
}

UTF16String BannedPluginManager::GetSettingsFileName() const
{
    return mSettingsFileName;
}

void BannedPluginManager::SetPermanentBannedSettingsFileName(const UTF16String& name)
{
    mPermanentBannedSettingsFileName = name;
}

UTF16String BannedPluginManager::GetPermanentBannedSettingsFileName() const
{
    return mPermanentBannedSettingsFileName;
}

} // namespace zebaudiofilterhost
