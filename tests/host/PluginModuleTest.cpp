#include "host/PluginModule.h"
#include "host/PluginModuleManager.h"

#include "foundation/zebcore/StringConversion.h"
#include "tests/host/CatalogueFixture.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <string>

namespace zebaudiofilterhost::testing
{

namespace
{

using ModulePtr = boost::intrusive_ptr<PluginModule>;

UTF16String TestModulePath()
{
    return zebcore::utility::UTF16FromNarrow(ZEB_HOST_TEST_MODULE);
}

} // namespace

TEST(PluginModule, LoadsOnceAndComesBackAfterUnload)
{
    const ModulePtr module = new PluginModule(TestModulePath(), true);
    EXPECT_EQ(module->GetOSModule(), nullptr);
    ASSERT_TRUE(module->Load()) << Text(zebcore::utility::GetLastOSModuleError());
    const zebcore::utility::OSModuleRef loaded = module->GetOSModule();
    ASSERT_NE(loaded, nullptr);
    EXPECT_NE(zebcore::utility::GetFunctionPointerFromModuleImpl(loaded, "ZebTestModuleAnswer"), nullptr);
    EXPECT_TRUE(module->Load());
    EXPECT_EQ(module->GetOSModule(), loaded);
    module->Unload();
    EXPECT_EQ(module->GetOSModule(), nullptr);
    module->Unload();
    EXPECT_TRUE(module->Load());
}

TEST(PluginModule, DoesNotReleaseWhatItDoesNotOwn)
{
    const ModulePtr module = new PluginModule(TestModulePath(), false);
    ASSERT_TRUE(module->Load());
    const zebcore::utility::OSModuleRef loaded = module->GetOSModule();
    module->Unload();
    EXPECT_EQ(module->GetOSModule(), loaded);
    zebcore::utility::ReleaseOSModule(loaded);
}

TEST(PluginModule, MissingBundleFails)
{
    for (const UTF16String path : {u"/nowhere/at-all.vst3", u"", u"/tmp"})
    {
        const ModulePtr module = new PluginModule(path, true);
        EXPECT_FALSE(module->Load()) << Text(path);
        EXPECT_EQ(module->GetOSModule(), nullptr);
        EXPECT_TRUE(module->GetPath() == path);
    }
}

TEST(PluginModule, TellsPluginsLanguageAndTheme)
{
    EXPECT_STREQ(PluginModule::GetLocaleIdentifier(), "en_US");
    EXPECT_TRUE(PluginModule::GetThemeXML().empty());
    PluginModule::SetLocaleIdentifier(u"fr_\u00e9");
    PluginModule::SetThemeXML(u8"<theme/>");
    EXPECT_STREQ(PluginModule::GetLocaleIdentifier(), "fr_\xc3\xa9");
    EXPECT_TRUE(PluginModule::GetThemeXML() == u8"<theme/>");
    PluginModule::SetLocaleIdentifier(u"en_US");
    PluginModule::SetThemeXML(u8"");
}

TEST(PluginModuleManager, FirstModuleOfAPathStaysAndCaseCounts)
{
    PluginModuleManager<ModulePtr> manager;
    const ModulePtr first = new PluginModule(u"/a", true);
    const ModulePtr other = new PluginModule(u"/A", true);
    manager.AddPluginModule(first);
    manager.AddPluginModule(new PluginModule(u"/a", true));
    manager.AddPluginModule(other);
    EXPECT_EQ(manager.Find(u"/a"), first);
    EXPECT_EQ(manager.Find(u"/A"), other);
    EXPECT_EQ(manager.Find(u"/b"), nullptr);
    EXPECT_EQ(first->GetRefCount(), 2);
}

} // namespace zebaudiofilterhost::testing
