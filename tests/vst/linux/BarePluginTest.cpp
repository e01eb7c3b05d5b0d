// Plug-ins that are hardly any: one without functions, which needs a library with an entry point of its own, and one
// that never stops to list its members.

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTPluginFiles.h"
#include "host/src/VST/src/VSTPluginModule.h"
#include "module/Module.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace zebaudiofilterhost::vst
{

namespace
{

class BarePlugin : public testing::Test
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }

    UTF16String mPath = zebcore::filesupport::FromNativePath(ZEB_BARE_PLUGIN);
};

TEST_F(BarePlugin, IsEnteredThroughItsOwnFunction)
{
    EXPECT_THAT(FindEntryPoints(mPath), testing::ElementsAre(testing::StrEq("main")));
    EXPECT_TRUE(FindEntryPoints(mPath + u"x").empty());
    const auto module = GetVSTPlugin(mPath);
    ASSERT_NE(module, nullptr);
    EXPECT_NE(module->CreateAudioFilter(u"2:77"), nullptr) << "the library's function gives none";
}

TEST_F(BarePlugin, IsRefusedSinceItDoesNotAnswer)
{
    const auto module = GetVSTPlugin(mPath);
    ASSERT_NE(module, nullptr);
    std::vector<UTF16String> ids = {u"old"};
    EXPECT_EQ(module->GetPluginInfo(ids), nullptr);
    EXPECT_TRUE(ids.empty());
    EXPECT_THAT(zebcore::utility::NarrowFromUTF16(PluginModule::GetLoadProblem(mPath)),
                testing::EndsWith(" is made for an interface older than VST 2.3."));
}

TEST_F(BarePlugin, AShellWithoutEndIsCutOff)
{
    const auto module = GetVSTPlugin(zebcore::filesupport::FromNativePath(ZEB_ENDLESS_PLUGIN));
    ASSERT_NE(module, nullptr);
    std::vector<UTF16String> ids;
    const auto info = module->GetPluginInfo(ids);
    ASSERT_NE(info, nullptr);
    EXPECT_TRUE(info->IsShell());
    ASSERT_EQ(ids.size(), 65536U);
    EXPECT_TRUE(ids.back().starts_with(u"2:65536 "));
}

TEST_F(BarePlugin, AShellThatBeginsAgainHasEachMemberOnce)
{
    const auto module = GetVSTPlugin(zebcore::filesupport::FromNativePath(ZEB_ROUND_PLUGIN));
    ASSERT_NE(module, nullptr);
    std::vector<UTF16String> ids;
    ASSERT_NE(module->GetPluginInfo(ids), nullptr);
    ASSERT_EQ(ids.size(), 3U);
    EXPECT_TRUE(ids[0].starts_with(u"2:1 ") && ids[1].starts_with(u"2:2 ") && ids[2].starts_with(u"2:3 "));
}

} // namespace

} // namespace zebaudiofilterhost::vst
