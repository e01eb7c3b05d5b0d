#include "tests/host/CatalogueFixture.h"

#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/PropListVisitor.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterRegistrar.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"

#include <unistd.h>

#include <algorithm>
#include <iterator>

namespace zebaudiofilterhost::testing
{

namespace
{

using zebcore::utility::NarrowFromUTF16;
using zebcore::utility::UTF16FromNarrow;

class LayoutVisitor : public zebcore::proplist::PropListVisitor
{
public:
    explicit LayoutVisitor(std::vector<std::string>& entries) : mEntries(entries) {}

    using PropListVisitor::VisitValue;
    void VisitValue(const UTF8String& key, const UTF16String&) override { Add(key, "text"); }
    void VisitValue(const UTF8String& key, bool) override { Add(key, "bool"); }
    void VisitValue(const UTF8String& key, unsigned int) override { Add(key, "unsigned"); }
    void VisitValue(const UTF8String& key, int) override { Add(key, "int"); }
    void VisitSubList(const UTF8String& key, const PropList&) override { Add(key, "list"); }

private:
    void Add(const UTF8String& key, const std::string& type)
    {
        mEntries.push_back(zebcore::utility::NarrowFromUTF8(key) + " " + type);
    }

    std::vector<std::string>& mEntries;
};

void EmptyCatalogue()
{
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    infos.SetPrivatePluginConfiguration(u8"");
    infos.ClearAll(true);
    for (const auto& technology : infos.GetPluginTechnologies())
    {
        technology->RemoveAllPluginDirectories();
    }
    AudioFilterDescriptorManager::GetInstance().ClearInfosForLocator(
        PluginLocator(kTechnologyInternal, UTF16String()));
    AudioFilterRegistrar::GetFactoryVector().clear();
    BannedPluginManager::GetInstance().ReadBannedPlugins(PropList());
}

std::filesystem::path MakeFolder()
{
    std::string pattern = (std::filesystem::temp_directory_path() / "zeb-host-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr)
    {
        throw std::runtime_error("cannot make " + pattern);
    }
    return pattern;
}

} // namespace

CatalogueFixture::CatalogueFixture() : mFolder(MakeFolder())
{
    EmptyCatalogue();
}

CatalogueFixture::~CatalogueFixture()
{
    EmptyCatalogue();
    std::error_code ignored;
    std::filesystem::remove_all(mFolder, ignored);
}

UTF16String CatalogueFixture::PathInFolder(std::string_view name) const
{
    return UTF16FromNarrow((mFolder / name).string());
}

File CatalogueFixture::FileInFolder(std::string_view name) const
{
    return File(PathInFolder(name));
}

File CatalogueFixture::WriteFile(std::string_view name, std::u8string_view text) const
{
    zebcore::utility::FileUtils::SimpleWriteStringToFile(PathInFolder(name), UTF8String(text));
    return FileInFolder(name);
}

PluginLocator VST2(const UTF16String& path)
{
    return {kTechnologyVST, path};
}

PluginLocator VST3(const UTF16String& path)
{
    return {kTechnologyVST3, path};
}

PluginLocator AudioUnit(const UTF16String& path)
{
    return {kTechnologyAudioUnit, path};
}

DescriptorPtr MakeExternal(const PluginLocator& locator, const UTF16String& id, const Guid& guid)
{
    return new AudioFilterDescriptor(locator, u"Name", u"Vendor", 1, kCategoryEffect, id, guid, false);
}

DescriptorPtr MakeInternal(const UTF16String& id, const Guid& guid)
{
    return new AudioFilterDescriptor(u"Built in", 1, kCategoryEffect, id, guid, false);
}

InfoPtr MakeInfo(const PluginLocator& locator, bool enabled)
{
    return new PluginModuleInfo(locator, u"Name", u"Vendor", 1, locator.GetTechnologyType(), enabled, false);
}

std::string Text(const UTF16String& text)
{
    return NarrowFromUTF16(text);
}

std::string Text(const PluginLocator& locator)
{
    return NarrowFromUTF16(locator.ToString());
}

std::vector<std::string> Texts(const std::vector<PluginLocator>& locators)
{
    std::vector<std::string> texts;
    std::transform(locators.begin(), locators.end(), std::back_inserter(texts),
                   [](const PluginLocator& locator) { return Text(locator); });
    return texts;
}

std::vector<std::string> Layout(const PropList& list)
{
    std::vector<std::string> entries;
    LayoutVisitor visitor(entries);
    list.Visit(visitor);
    return entries;
}

std::vector<std::string> CatalogueIDs()
{
    const AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    std::vector<std::string> ids;
    std::transform(manager.InfoBegin(), manager.InfoEnd(), std::back_inserter(ids),
                   [](const DescriptorPtr& descriptor) { return Text(descriptor->GetUniqueID()); });
    return ids;
}

std::vector<std::string> RecordPaths()
{
    const PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    std::vector<std::string> paths;
    std::transform(manager.PluginInfoBegin(), manager.PluginInfoEnd(), std::back_inserter(paths),
                   [](const InfoPtr& info) { return Text(info->GetLocator().GetPath()); });
    return paths;
}

} // namespace zebaudiofilterhost::testing
