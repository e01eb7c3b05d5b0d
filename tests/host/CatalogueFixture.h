#pragma once

#include "host/AudioFilterDescriptor.h"
#include "host/PluginLocator.h"
#include "host/PluginModuleInfo.h"
#include "utility/CommonTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace zebaudiofilterhost::testing
{

/// Each test starts with an empty catalogue, empty block lists and a folder of its own.
class CatalogueFixture : public ::testing::Test
{
protected:
    CatalogueFixture();
    ~CatalogueFixture() override;

    UTF16String PathInFolder(std::string_view name) const;
    File FileInFolder(std::string_view name) const;
    /// Writes a file into the folder and names it.
    File WriteFile(std::string_view name, std::u8string_view text) const;

private:
    std::filesystem::path mFolder;
};

using DescriptorPtr = boost::intrusive_ptr<AudioFilterDescriptor>;
using InfoPtr = boost::intrusive_ptr<PluginModuleInfo>;

PluginLocator VST2(const UTF16String& path);
PluginLocator VST3(const UTF16String& path);
PluginLocator AudioUnit(const UTF16String& path);

DescriptorPtr MakeExternal(const PluginLocator& locator, const UTF16String& id, const Guid& guid = Guid());
DescriptorPtr MakeInternal(const UTF16String& id, const Guid& guid = Guid());
InfoPtr MakeInfo(const PluginLocator& locator, bool enabled = true);

/// What GoogleTest can print.
std::string Text(const UTF16String& text);
std::string Text(const PluginLocator& locator);
std::vector<std::string> Texts(const std::vector<PluginLocator>& locators);
/// All entries of a list in order, as "key type", to compare layouts.
std::vector<std::string> Layout(const PropList& list);

/// The catalogue as it stands: the unique IDs in order of arrival, and the paths of the records.
std::vector<std::string> CatalogueIDs();
std::vector<std::string> RecordPaths();

} // namespace zebaudiofilterhost::testing
