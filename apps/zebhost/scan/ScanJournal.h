#pragma once

#include "catalogue/Catalogue.h"
#include "catalogue/IScanObserver.h"

#include <optional>
#include <string>

namespace zebhost
{

// What a scan writes down around each plug-in, so that nothing is lost whenever the process ends: the plug-in is on
// the block list while it is at hand, and the catalogue is saved before it comes off. Files that cannot be written
// end the scan with a Failure, and then too the plug-in is taken off the list if that can be done. [main]
class ScanJournal
{
public:
    explicit ScanJournal(Catalogue& catalogue);

    // The plug-in is the next to be touched.
    void Announce(const zebaudiofilterhost::PluginLocator& locator);
    // It was scanned, or could not be loaded; the library's catalogue knows it, or does not.
    void Conclude(const zebaudiofilterhost::PluginLocator& locator, const std::string& problem);
    // It ended its process, or had to be ended: it stays blocked, and leaves the catalogue.
    void Condemn(const zebaudiofilterhost::PluginLocator& locator, const std::string& reason);
    // It was not touched, or not to its end, through no fault of its own: all is as before.
    void Release(const zebaudiofilterhost::PluginLocator& locator);
    // The same while something else is thrown: throws nothing itself.
    void ReleaseAfterFailure(const zebaudiofilterhost::PluginLocator& locator);

private:
    void Record(const zebaudiofilterhost::PluginLocator& locator, const std::string& problem);
    BinaryStamps::Entry ResultOf(const zebaudiofilterhost::PluginLocator& locator, const std::string& problem) const;

    Catalogue& mCatalogue;
    // Of the plug-in at hand:
    bool mWasKnown = false;
    BinaryStamp mBinary;
    std::string mVisit;
    std::optional<BlockReason> mBlockedBefore;
};

} // namespace zebhost
