#pragma once

#include "catalogue/IScanObserver.h"

#include <functional>

namespace zebhost
{

// Scans one plug-in in this process, into the library's catalogue. What that knew of it stays only if it cannot be
// loaded. `beforeStep` is told which of its filters is next. What the plug-in throws becomes the outcome's problem.
// [main]
IScanObserver::Outcome ScanPlugin(const zebaudiofilterhost::PluginLocator& locator, bool skipCategory,
                                  const std::function<void(const std::string& detail)>& beforeStep);

} // namespace zebhost
