#pragma once

#include "catalogue/BinaryStamps.h"
#include "catalogue/BlockReasons.h"
#include "catalogue/SettingsFolder.h"
#include "output/Console.h"

#include <host/AudioFilterDescriptorManager.h>
#include <host/PluginLocator.h>

#include <set>
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

    const SettingsFolder& Folder() const { return mFolder; }

private:
    void LoadBlocks();
    void LiftFinishedBlocks();
    // Of the scan that blocked the plug-in while it was at hand.
    bool HasResult(const zebaudiofilterhost::PluginLocator& locator, const BlockReason& why) const;
    void SaveBlockList();
    bool IsSound(const std::filesystem::path& path, unsigned int version) const;
    void NoteDamaged(const std::filesystem::path& path);
    void SetAsideIfDamaged(const std::filesystem::path& path);

    const SettingsFolder& mFolder;
    Console& mConsole;
    BlockReasons mReasons;
    std::vector<zebaudiofilterhost::PluginLocator> mLifted; // whose reasons go when the list is saved without them
    BinaryStamps mStamps;
    std::set<std::filesystem::path> mDamaged;
};

} // namespace zebhost
