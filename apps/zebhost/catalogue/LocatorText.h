#pragma once

#include <host/PluginLocator.h>

#include <optional>
#include <string>

namespace zebhost
{

// A locator as text that JSON can hold, whatever its path is made of.
std::string LocatorText(const zebaudiofilterhost::PluginLocator& locator);
std::optional<zebaudiofilterhost::PluginLocator> ParseLocatorText(const std::string& text);

} // namespace zebhost
