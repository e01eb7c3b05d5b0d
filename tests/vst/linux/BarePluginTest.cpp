// A plug-in that is hardly one, and needs a library with an entry point of its own.

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

} // namespace

} // namespace zebaudiofilterhost::vst
