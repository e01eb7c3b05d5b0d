#include "catalogue/SettingsFolder.h"

#include <foundation/zebcore/Dir.h>
#include <foundation/zebcore/NativePath.h>
#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebcore::filesupport::Dir;
using zebcore::filesupport::FromNativePath;
using zebcore::filesupport::ToNativePath;

SettingsFolder::SettingsFolder(const std::string& folder)
{
    if (!folder.empty())
    {
        Dir::SetPrefDir(Dir(FromNativePath(std::filesystem::absolute(folder).lexically_normal().string())));
    }
    mPath = ToNativePath(Dir::PrefDir().FullPath());
}

std::filesystem::path SettingsFolder::Catalogue() const
{
    return mPath / ToNativePath(PluginModuleInfoManager::GetInstance().GetSettingsFileName());
}

std::filesystem::path SettingsFolder::BinaryStamps() const
{
    return Catalogue().replace_extension(".binaries.json");
}

std::filesystem::path SettingsFolder::Journal() const
{
    return Catalogue().replace_extension(".journal");
}

std::filesystem::path SettingsFolder::Blocks() const
{
    return mPath / ToNativePath(BannedPluginManager::GetInstance().GetSettingsFileName());
}

std::filesystem::path SettingsFolder::BlockReasons() const
{
    return Blocks().replace_extension(".reasons.json");
}

std::filesystem::path SettingsFolder::PermanentBlocks() const
{
    return mPath / ToNativePath(BannedPluginManager::GetInstance().GetPermanentBannedSettingsFileName());
}

std::filesystem::path SettingsFolder::Presets() const
{
    return mPath / "Presets";
}

zebcore::filesupport::File ToFile(const std::filesystem::path& path)
{
    return zebcore::filesupport::File(FromNativePath(path.string()));
}

} // namespace zebhost
