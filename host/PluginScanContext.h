#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost
{

/// A technology's cursor over the plug-ins of one scan. One step loads at most one plug-in or makes one filter.
/// All operations: [main]
class ZEB_EXPORT PluginScanContext : public virtual zebcore::utility::RefCountedObject
{
public:
    ~PluginScanContext() override;

    /// Starts over with this list, and drops what is in progress. With `skipCategory` plug-ins are not asked for
    /// their category, and descriptors carry kCategoryNotQueried; VST 3 instruments get descriptors, too.
    virtual void SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory) = 0;

    /// False, with nothing written, once the list is finished. Otherwise what the next Continue works on: the
    /// plug-in, its index from 0, and `detail`, which is " (2/3)" for the second of three filters and empty for a
    /// plug-in that is not loaded yet or has fewer than two.
    virtual bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const = 0;

    /// One step; returns whether anything remains.
    virtual bool Continue() = 0;
};

} // namespace zebaudiofilterhost
