#include "catalogue/Catalogue.h"

#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"
#include "cli/WantOfRoom.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/FileExceptions.h>
#include <foundation/zebcore/PropListUtils.h>
#include <host/AudioFilterDescriptor.h>
#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

#include <algorithm>
#include <iterator>
#include <optional>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptorManager;
using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebcore::filesupport::File;
using zebcore::filesupport::file_exception;

namespace
{

constexpr unsigned int kSettingsVersion = 2;
constexpr unsigned int kBlockListVersion = 1;

std::string Remedy(int error)
{
    return std::string(IsWantOfRoom(error) ? ": make room" : ": make it readable and writable") +
           ", or name another folder with --settings";
}

// Runs a step on files of the settings folder; their trouble is the user's to mend.
template <typename Step>
void WithFiles(const Step& step)
{
    try
    {
        step();
    }
    catch (const file_exception& error)
    {
        throw Failure(ExitCode::FileTrouble, error.what() + Remedy(error.Error()));
    }
    catch (const std::filesystem::filesystem_error& error)
    {
        throw Failure(ExitCode::FileTrouble, error.what() + Remedy(error.code().value()));
    }
}

bool IsCatalogueEmpty()
{
    const PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    return infos.PluginInfoBegin() == infos.PluginInfoEnd() &&
           AudioFilterDescriptorManager::GetInstance().GetExternalInfos().empty();
}

bool IsOnPermanentList(const PluginLocator& locator)
{
    // The texts that a VST 3 scan looks its plug-ins up with.
    return BannedPluginManager::GetInstance().IsPluginBannedStatically(File(locator.GetPath()).GetName(), u"none",
                                                                       u"0");
}

} // namespace

Catalogue::Catalogue(const SettingsFolder& folder, Console& console)
    : mFolder(folder)
    , mConsole(console)
    , mReasons(folder.BlockReasons())
    , mStamps(folder.BinaryStamps())
    , mJournal(folder.Journal())
    , mDamaged(console)
{
}

// The journal is read first: a scan that ends meanwhile saves its files before it removes that, and to hear of
// something twice does no harm.
void Catalogue::Load()
{
    const std::vector<std::string> lines = mJournal.Lines();
    LoadBlocks();
    LoadFiles();
    Replay(lines);
    LiftFinishedBlocks();
}

void Catalogue::LoadFiles()
{
    WithFiles(
        [this]
        {
            File file = ToFile(mFolder.Catalogue());
            PluginModuleInfoManager::GetInstance().LoadConfiguration(file);
            // Only what came out empty can have been damaged, so a sound catalogue is read once.
            if (file.Exists() && IsCatalogueEmpty() && !IsSound(mFolder.Catalogue(), kSettingsVersion))
            {
                mDamaged.Note(mFolder.Catalogue());
            }
            if (!mStamps.Load())
            {
                mDamaged.Note(mFolder.BinaryStamps());
            }
        });
}

// A scan that was killed, or met a full disk, after it had saved what it found of a plug-in, and before it took the
// plug-in off the list, had nothing against it.
void Catalogue::LiftFinishedBlocks()
{
    BannedPluginManager& blocks = BannedPluginManager::GetInstance();
    const std::vector<PluginLocator> blocked(blocks.BannedBegin(), blocks.BannedEnd());
    for (const PluginLocator& locator : blocked)
    {
        const BlockReason why = mReasons.Get(locator);
        if (why.isAtHand && HasResult(locator, why))
        {
            blocks.RemoveBannedPlugin(locator);
            mLifted.push_back(locator);
        }
    }
}

bool Catalogue::HasResult(const PluginLocator& locator, const BlockReason& why) const
{
    const std::optional<BinaryStamps::Entry> last = mStamps.Find(locator);
    return (last && !why.visit.empty() && last->visit == why.visit) ||
           (!why.wasKnown && PluginModuleInfoManager::GetInstance().FindPluginInfo(locator) != nullptr);
}

void Catalogue::Replay(const std::vector<std::string>& lines)
{
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    for (const std::string& line : lines)
    {
        const std::optional<ScanFact> fact = ParseScanFact(line);
        if (fact && !fact->found.empty())
        {
            infos.RemovePluginLocators({fact->plugin});
            infos.AddConfiguration(fact->found, true);
        }
        if (fact)
        {
            Take(*fact);
        }
    }
}

void Catalogue::Take(const ScanFact& fact)
{
    BannedPluginManager& blocks = BannedPluginManager::GetInstance();
    if (fact.block)
    {
        blocks.AddBannedPlugin(fact.plugin);
        std::erase(mLifted, fact.plugin);
        mReasons.Set(fact.plugin, *fact.block);
        mUnsaved.blocks = true;
    }
    else if (blocks.IsPluginBanned(fact.plugin))
    {
        blocks.RemoveBannedPlugin(fact.plugin);
        mLifted.push_back(fact.plugin);
        mUnsaved.blocks = true;
    }
    if (fact.isForgotten)
    {
        PluginModuleInfoManager::GetInstance().RemovePluginLocators({fact.plugin});
        mStamps.Remove(fact.plugin);
    }
    if (fact.result)
    {
        mStamps.Set(fact.plugin, *fact.result);
    }
    mUnsaved.stamps = mUnsaved.stamps || fact.isForgotten || fact.result;
    mUnsaved.records = mUnsaved.records || fact.isForgotten || !fact.found.empty();
}

std::uintmax_t Catalogue::Announce(const ScanFact& fact)
{
    std::uintmax_t size = 0;
    WithFiles(
        [this, &fact, &size]
        {
            std::filesystem::create_directories(mFolder.Path());
            size = mJournal.Size();
            mJournal.Add(ToLine(fact));
        });
    return size;
}

void Catalogue::TakeBack(std::uintmax_t announcement)
{
    WithFiles([this, announcement] { mJournal.CutTo(announcement); });
}

void Catalogue::Note(const ScanFact& fact)
{
    WithFiles([this, &fact] { mJournal.Add(ToLine(fact)); });
    Take(fact);
}

void Catalogue::SaveNoted()
{
    if (!mJournal.Exists())
    {
        return;
    }
    if (mUnsaved.records)
    {
        Save();
    }
    WithFiles(
        [this]
        {
            if (mUnsaved.stamps)
            {
                WriteStamps(LocatorTable::Saving::Flushed);
            }
            if (mUnsaved.blocks)
            {
                SaveBlockList();
                SaveReasons(LocatorTable::Saving::Flushed);
            }
            // Up to here it speaks for what is half saved.
            mJournal.Remove();
        });
    mUnsaved = {};
}

void Catalogue::LoadBlocks()
{
    WithFiles(
        [this]
        {
            BannedPluginManager& blocks = BannedPluginManager::GetInstance();
            File dynamic = ToFile(mFolder.Blocks());
            blocks.LoadConfiguration(dynamic);
            if (dynamic.Exists() && !IsSound(mFolder.Blocks(), kBlockListVersion))
            {
                mDamaged.Note(mFolder.Blocks());
            }
            File permanent = ToFile(mFolder.PermanentBlocks());
            if (permanent.Exists() && !blocks.LoadStaticConfiguration(permanent))
            {
                mConsole.Warn("zebhost: " + mFolder.PermanentBlocks().string() +
                              " is damaged and was ignored: mend or "
                              "remove it");
            }
            if (!mReasons.Load())
            {
                mDamaged.Note(mFolder.BlockReasons());
            }
        });
}

bool Catalogue::IsSound(const std::filesystem::path& path, unsigned int version) const
{
    zebcore::proplist::PropList list;
    unsigned int found = 0;
    return zebcore::proplist::utils::LoadPropList(ToFile(path).FullPath(), list, false) &&
           list.GetValue(u8"version", found) && found == version;
}

void Catalogue::Save()
{
    WithFiles(
        [this]
        {
            std::filesystem::create_directories(mFolder.Path());
            mDamaged.SetAside(mFolder.Catalogue());
            // Not SaveConfiguration, which keeps silent when the system refuses to give up the old file.
            zebcore::proplist::PropList list;
            PluginModuleInfoManager::GetInstance().BuildConfigurationPropList(list, true);
            File file = ToFile(mFolder.Catalogue());
            zebcore::proplist::utils::SavePropList(file, list);
        });
}

void Catalogue::SaveBlockList()
{
    std::filesystem::create_directories(mFolder.Path());
    mDamaged.SetAside(mFolder.Blocks());
    File file = ToFile(mFolder.Blocks());
    BannedPluginManager::GetInstance().SaveConfiguration(file);
    for (const PluginLocator& locator : mLifted)
    {
        mReasons.Remove(locator);
    }
    mLifted.clear();
}

void Catalogue::SaveStamps(LocatorTable::Saving saving)
{
    WithFiles([this, saving] { WriteStamps(saving); });
}

void Catalogue::WriteStamps(LocatorTable::Saving saving)
{
    mDamaged.SetAside(mFolder.BinaryStamps());
    mStamps.Save(saving);
}

void Catalogue::SaveReasons(LocatorTable::Saving saving)
{
    mDamaged.SetAside(mFolder.BlockReasons());
    mReasons.Save(saving);
}

std::vector<Catalogue::Descriptor> Catalogue::Effects() const
{
    const AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    std::vector<Descriptor> effects;
    std::copy_if(manager.InfoBegin(), manager.InfoEnd(), std::back_inserter(effects),
                 [&manager](const Descriptor& each)
                 { return each == manager.GetComponentDescriptorForID(each->GetUniqueID()); });
    return effects;
}

std::vector<Catalogue::Descriptor> Catalogue::EffectsOf(const PluginLocator& locator) const
{
    std::vector<Descriptor> effects = Effects();
    std::erase_if(effects, [&locator](const Descriptor& each) { return each->GetLocator() != locator; });
    return effects;
}

bool Catalogue::IsBlocked(const PluginLocator& locator) const
{
    return BannedPluginManager::GetInstance().IsPluginBanned(locator) || IsOnPermanentList(locator);
}

std::string Catalogue::BlockedBecause(const PluginLocator& locator) const
{
    const std::string place = PlaceOf(locator);
    if (!BannedPluginManager::GetInstance().IsPluginBanned(locator))
    {
        return place + " is on the permanent block list, " + mFolder.PermanentBlocks().string() +
               ": it is not used; take it off that list if you must";
    }
    const BlockReason why = mReasons.Get(locator);
    return place + " is blocked" + (why.since.empty() ? "" : " since " + why.since) +
           (why.reason.empty() ? "" : " (" + why.reason + ")") + ": 'zebhost unblock " + SelectorWord(locator) +
           "' lets it be used again";
}

void Catalogue::Block(const PluginLocator& locator, const BlockReason& reason, LocatorTable::Saving saving)
{
    BannedPluginManager::GetInstance().AddBannedPlugin(locator);
    std::erase(mLifted, locator);
    mReasons.Set(locator, reason);
    WithFiles(
        [this, saving]
        {
            SaveReasons(saving);
            SaveBlockList();
        });
}

void Catalogue::Unblock(const PluginLocator& locator)
{
    BannedPluginManager::GetInstance().RemoveBannedPlugin(locator);
    mLifted.push_back(locator);
    WithFiles(
        [this]
        {
            SaveBlockList();
            SaveReasons(LocatorTable::Saving::Quick);
        });
}

} // namespace zebhost
