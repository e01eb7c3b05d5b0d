#pragma once

#include "host/PluginScanContext.h"

#include <vector>

namespace zebaudiofilterhost::xau
{

/// Steps through units, one a step. [main]
class XAUScanContext : public PluginScanContext
{
public:
    void SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory) override;
    bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const override;
    bool Continue() override;

private:
    std::vector<PluginLocator> mLocators;
    std::size_t mLocatorIndex = 0;
};

} // namespace zebaudiofilterhost::xau
