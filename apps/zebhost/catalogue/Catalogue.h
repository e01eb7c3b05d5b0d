#pragma once

#include "catalogue/BinaryStamps.h"
#include "catalogue/BlockReasons.h"
#include "catalogue/DamagedFiles.h"
#include "catalogue/ScanFact.h"
#include "catalogue/SettingsFolder.h"
#include "catalogue/SettingsJournal.h"
#include "output/Console.h"

#include <host/AudioFilterDescriptorManager.h>
#include <host/PluginLocator.h>

#include <cstdint>
#include <string>
#include <vector>

namespace zebhost
{

// The library's catalogue and block lists together with the files they live in. A file that is damaged, or of another
// version, counts as missing; the user is told, and it is kept under another name before a new one takes its place.
// File trouble ends the command with a Failure. [main]
class Catalogue
{
public:
    Catalogue(const SettingsFolder& folder, Console& console);

    // With what a scan that was killed, or is at work, has found out since it last saved the files.
    void Load();
    void Save();

    using Descriptor = zebaudiofilterhost::AudioFilterDescriptorManager::DescriptorPtr;
    // The effects that can be offered: of several descriptors with one ID, the one that look-up returns.
    std::vector<Descriptor> Effects() const;
    std::vector<Descriptor> EffectsOf(const zebaudiofilterhost::PluginLocator& locator) const;

    // On either list.
    bool IsBlocked(const zebaudiofilterhost::PluginLocator& locator) const;
    // "it was blocked on ... because ...".
    std::string BlockedBecause(const zebaudiofilterhost::PluginLocator& locator) const;
    // Both are saved at once, in such an order that no plug-in is ever blocked without a reason.
    void Block(const zebaudiofilterhost::PluginLocator& locator, const BlockReason& reason,
               LocatorTable::Saving saving = LocatorTable::Saving::Flushed);
    void Unblock(const zebaudiofilterhost::PluginLocator& locator);
    const BlockReasons& Reasons() const { return mReasons; }

    BinaryStamps& Stamps() { return mStamps; }
    const BinaryStamps& Stamps() const { return mStamps; }
    void SaveStamps(LocatorTable::Saving saving);

    // Of a scan. What it announces goes to the journal alone, and can be taken back for as long as nothing else was
    // noted: its result then counts as well.
    std::uintmax_t Announce(const ScanFact& fact);
    void TakeBack(std::uintmax_t announcement);
    // To the journal, and here too. Record and descriptors are in the library's catalogue already.
    void Note(const ScanFact& fact);
    // Saves what was noted in the files that it belongs to. Only for whoever has locked the settings.
    void SaveNoted();

    const SettingsFolder& Folder() const { return mFolder; }

private:
    struct Unsaved
    {
        bool records = false;
        bool blocks = false;
        bool stamps = false;
    };

    void LoadFiles();
    void Replay(const std::vector<std::string>& lines);
    void Take(const ScanFact& fact);
    void LoadBlocks();
    void LiftFinishedBlocks();
    // Of the scan that blocked the plug-in while it was at hand.
    bool HasResult(const zebaudiofilterhost::PluginLocator& locator, const BlockReason& why) const;
    void SaveBlockList();
    bool IsSound(const std::filesystem::path& path, unsigned int version) const;
    void SaveReasons(LocatorTable::Saving saving);
    void WriteStamps(LocatorTable::Saving saving);

    const SettingsFolder& mFolder;
    Console& mConsole;
    BlockReasons mReasons;
    std::vector<zebaudiofilterhost::PluginLocator> mLifted; // whose reasons go when the list is saved without them
    BinaryStamps mStamps;
    SettingsJournal mJournal;
    Unsaved mUnsaved; // of what stands in the journal
    DamagedFiles mDamaged;
};

} // namespace zebhost
