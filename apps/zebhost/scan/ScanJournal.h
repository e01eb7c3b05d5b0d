#pragma once

#include "catalogue/Catalogue.h"
#include "catalogue/IScanObserver.h"

#include <chrono>
#include <cstdint>
#include <string>

namespace zebhost
{

// What a scan writes down around each plug-in, so that nothing is lost whenever the process ends: that the plug-in is
// at hand, for which it counts as blocked, and then what became of it. The settings files themselves are saved now
// and then, and at the end. Files that cannot be written end the scan with a Failure, and then too the plug-in at
// hand is not blocked if that can be done. [main]
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
    void Release();
    // The same while something else is thrown: throws nothing itself.
    void ReleaseAfterFailure();
    // The scan has come to its end.
    void Finish();

private:
    void Note(const ScanFact& fact);
    BinaryStamps::Entry ResultOf(const zebaudiofilterhost::PluginLocator& locator, const std::string& problem) const;

    Catalogue& mCatalogue;
    std::chrono::steady_clock::time_point mLastSave; // of the files, or the start
    // Of the plug-in at hand:
    std::uintmax_t mAnnouncement = 0;
    BinaryStamp mBinary;
    std::string mVisit;
};

} // namespace zebhost
