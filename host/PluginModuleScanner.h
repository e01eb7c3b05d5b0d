#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "host/PluginLocator.h"
#include "host/PluginScanContext.h"
#include "host/PluginTechnology.h"
#include "utility/CommonTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost
{

/// A cursor over the work of a scan, which the caller moves on step by step: make the scanner, BeginScan,
/// ContinueScan while GetCurrentProgressInfo returns true, EndScan. What a step found is in the catalogue once its
/// plug-in is done. Good for one pass, and may be dropped at any step. A crash of a plug-in is not caught: an
/// application that wants to survive the next start bans the announced locator around each step
/// (BannedPluginManager). All operations: [main]
class ZEB_EXPORT PluginModuleScanner : public virtual zebcore::utility::RefCountedObject
{
public:
    /// One technology's share.
    struct ScanItem
    {
        boost::intrusive_ptr<PluginTechnology> technology;
        boost::intrusive_ptr<PluginScanContext> context;
        unsigned long count = 0; // how many locators the context has
    };

    /// Loads nothing yet. Work goes technology by technology, within one in the order of `locators`; those of an
    /// unknown technology are ignored. With `skipCategory` descriptors carry kCategoryNotQueried, which saves asking;
    /// VST 3 instruments are then not told from effects, and enter the catalogue.
    PluginModuleScanner(const std::vector<PluginLocator>& locators, bool skipCategory);
    ~PluginModuleScanner() override;

    PluginModuleScanner(const PluginModuleScanner&) = delete;
    PluginModuleScanner& operator=(const PluginModuleScanner&) = delete;

    void BeginScan();
    /// False, with nothing written, when the scan is finished. Otherwise the plug-in that the next ContinueScan
    /// touches, its number from 1 to `total`, and in `detail` which of its filters.
    bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, int& current, int& total) const;
    /// One step: at most one plug-in load or one filter. A call that finds its technology finished goes on with the
    /// first step of the next one, whose plug-in GetCurrentProgressInfo has not announced. Returns whether anything
    /// remains. Exceptions of a context pass through, and the scan stays where it was:
    /// the same step would run again, so drop the scanner and make one for the plug-ins that are left.
    bool ContinueScan();
    /// Enables again what was enabled when the scanner was made.
    void EndScan();

private:
    bool mSkipCategory;
    unsigned long mCurrentItem = 0;
    unsigned long mItemsDone = 0;
    unsigned long mTotal = 0;
    std::vector<PluginLocator> mEnabledBefore;
    std::vector<ScanItem> mItems;
};

} // namespace zebaudiofilterhost
