#include "catalogue/PresetStore.h"

#include "catalogue/FileNames.h"
#include "catalogue/SettingsFolder.h"
#include "cli/Failure.h"
#include "cli/StartFolder.h"
#include "cli/WantOfRoom.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <foundation/zebcore/FileExceptions.h>
#include <foundation/zebcore/PropListUtils.h>

#include <algorithm>
#include <optional>

namespace zebhost
{

namespace fs = std::filesystem;

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::PresetData;
using zebcore::proplist::PropList;

namespace
{

constexpr unsigned int kStoreVersion = 1;
constexpr const char8_t* kVersionKey = u8"version";
constexpr const char8_t* kFilterIDKey = u8"filter_id";
constexpr const char8_t* kFilterNameKey = u8"filter_name";
constexpr const char8_t* kPresetKey = u8"preset";

std::string TextOf(const PropList& list, const char8_t* key)
{
    zebcore::UTF16String text;
    list.GetValue(key, text);
    return Printable(text);
}

// Nothing if the file is no preset of ours.
std::optional<PropList> ReadPreset(const fs::path& file)
{
    std::optional<PropList> list(std::in_place); // Filled where it stays: a preset may have megabytes
    unsigned int version = 0;
    const bool sound = zebcore::proplist::utils::LoadPropList(ToFile(file).FullPath(), *list, false) &&
                       list->GetValue(kVersionKey, version) && version == kStoreVersion &&
                       list->GetSubList(kPresetKey) != nullptr;
    if (!sound)
    {
        list.reset();
    }
    return list;
}

void WritePreset(AudioFilter& filter, const fs::path& file)
{
    PropList list;
    list.SetValue(kVersionKey, kStoreVersion);
    list.SetValue(kFilterIDKey, filter.GetID());
    list.SetValue(kFilterNameKey, filter.GetDisplayName());
    PresetData preset(list.GetOrCreateSubList(kPresetKey));
    filter.SaveSettings(preset);
    fs::create_directories(file.parent_path());
    zebcore::filesupport::File target = ToFile(file);
    zebcore::proplist::utils::SavePropList(target, list);
}

Failure FileTrouble(const fs::path& file, const std::string& what, int error)
{
    return Failure(ExitCode::FileTrouble,
                   what +
                       (IsWantOfRoom(error) ? ": make room" : ": make " + file.string() + " readable and writable"));
}

} // namespace

PresetStore::PresetStore(fs::path folder) : mFolder(std::move(folder))
{
}

bool PresetStore::IsFile(const std::string& preset)
{
    return preset.find('/') != std::string::npos || (preset.size() > 4 && Lowered(preset).ends_with(".xml"));
}

fs::path PresetStore::FileOf(const std::string& filterID, const std::string& preset) const
{
    if (IsFile(preset))
    {
        return fs::absolute(startfolder::Resolve(preset)).lexically_normal();
    }
    constexpr std::size_t kLongestName = 240;
    const std::string name = EncodeFileName(preset);
    if (name.empty() || name.size() > kLongestName)
    {
        throw Failure(ExitCode::Usage, "'" + preset + "' is no name for a preset: give a shorter one");
    }
    return mFolder / EncodeFileName(filterID) / (name + ".xml");
}

fs::path PresetStore::Save(AudioFilter& filter, const std::string& preset, bool overwrite)
{
    const fs::path file = FileOf(ToUTF8(filter.GetID()), preset);
    std::error_code error;
    if (!overwrite && fs::exists(fs::symlink_status(file, error)))
    {
        throw Failure(ExitCode::FileTrouble, file.string() + " exists: give --overwrite to replace it");
    }
    try
    {
        WritePreset(filter, file);
    }
    catch (const zebcore::filesupport::file_exception& trouble)
    {
        throw FileTrouble(file, trouble.what(), trouble.Error());
    }
    catch (const fs::filesystem_error& trouble)
    {
        throw FileTrouble(file, trouble.what(), trouble.code().value());
    }
    return file;
}

bool PresetStore::Has(const AudioFilter& filter, const std::string& preset) const
{
    std::error_code error;
    return fs::is_regular_file(FileOf(ToUTF8(filter.GetID()), preset), error);
}

void PresetStore::Load(AudioFilter& filter, const std::string& preset) const
{
    const fs::path file = FileOf(ToUTF8(filter.GetID()), preset);
    if (!Has(filter, preset))
    {
        throw Failure(ExitCode::NotFound, "there is no preset " + preset + " of " +
                                              Printable(filter.GetDisplayName()) + " (" + file.string() +
                                              "): 'zebhost preset list' shows what there is");
    }
    try
    {
        std::optional<PropList> list = ReadPreset(file);
        if (!list)
        {
            throw Failure(ExitCode::FileTrouble, file.string() + " is no preset, or is damaged: save it anew");
        }
        if (TextOf(*list, kFilterIDKey) != ToUTF8(filter.GetID()))
        {
            throw Failure(ExitCode::JobFailed, file.string() + " is a preset of another filter, " +
                                                   TextOf(*list, kFilterNameKey) + " [" +
                                                   TextOf(*list, kFilterIDKey) + "]: use it with that one");
        }
        if (!filter.LoadSettings(PresetData(list->GetOrCreateSubList(kPresetKey))))
        {
            throw Failure(ExitCode::JobFailed, Printable(filter.GetDisplayName()) + " refuses the preset " +
                                                   file.string() + ": it was saved by another version of it");
        }
    }
    catch (const zebcore::filesupport::file_exception& trouble)
    {
        throw FileTrouble(file, trouble.what(), trouble.Error());
    }
}

std::vector<PresetStore::Entry> PresetStore::List(const std::string& filterID) const
{
    std::vector<Entry> entries;
    const fs::path top = filterID.empty() ? mFolder : mFolder / EncodeFileName(filterID);
    std::error_code error;
    for (fs::recursive_directory_iterator at(top, fs::directory_options::skip_permission_denied, error), end;
         !error && at != end; at.increment(error))
    {
        const fs::directory_entry& each = *at;
        std::error_code isGone;
        if (!each.is_regular_file(isGone) || each.path().extension() != ".xml")
        {
            continue;
        }
        if (const std::optional<PropList> list = ReadPreset(each.path()))
        {
            entries.push_back({DecodeFileName(each.path().stem().string()), TextOf(*list, kFilterIDKey),
                               TextOf(*list, kFilterNameKey), each.path()});
        }
    }
    std::sort(entries.begin(), entries.end(),
              [](const Entry& a, const Entry& b)
              { return std::tie(a.filterName, a.name) < std::tie(b.filterName, b.name); });
    return entries;
}

} // namespace zebhost
