// Which files of a folder are taken for VST 2 plug-ins, with nothing loaded to find out.
#include "foundation/zebcore/NativePath.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/VST/src/VSTPluginSearch.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

#include <dlfcn.h>
#include <set>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

std::multiset<std::string> FoundIn(const std::filesystem::path& folder)
{
    std::multiset<std::string> names;
    for (const PluginLocator& locator :
         vst::GetPotentialPluginLocators(Dir(zebcore::filesupport::FromNativePath(folder.string()))))
        names.insert(std::filesystem::path(zebcore::filesupport::ToNativePath(locator.GetPath())).filename());
    return names;
}

TEST_F(HostedVST2, TheSearchFindsPluginsInEveryFormAndLoadsNone)
{
    const auto fixtures = FoundIn(VST2FixtureFolder());
    for (const char* name : {"Normal.so", "MachoEntry.so", "BothEntries.so", "Bundled.vst", "Flat.vst",
                             "Suffixed.vst", "Nested.so", "NullEntry.so", "OldMain.so"})
        EXPECT_EQ(fixtures.count(name), 1U) << name;
    // No entry point; and what lies inside of bundles.
    for (const char* name : {"Helper.so", "Bundled.so", "Flat.so", "Suffixed-vst.so"})
        EXPECT_EQ(fixtures.count(name), 0U) << name;

    const auto hazards = FoundIn(VST2HazardFolder());
    EXPECT_EQ(hazards.count("CrashOnLoad.so"), 1U); // and this process is still here
    EXPECT_EQ(FoundIn(VST2EffectFolder()),
              (std::multiset<std::string>{"ZebEcho2.vst", "ZebGain2.vst", "ZebGain2Plain.so", "ZebPanel2.so",
                                          "ZebShell2.so"}));
}

TEST_F(HostedVST2, ALibraryBesideThePluginsIsNeverLoaded)
{
    const auto helper = VST2Fixture("Helper");
    FoundIn(VST2FixtureFolder());
    EXPECT_FALSE(vst::IsVSTPlugin(zebcore::filesupport::FromNativePath(helper.string())));
    EXPECT_TRUE(Scan(helper).empty());
    EXPECT_EQ(dlopen(helper.c_str(), RTLD_LAZY | RTLD_NOLOAD), nullptr);
}

TEST_F(HostedVST2, OfTwoEntryPointsTheNewerOneIsCalled)
{
    for (const auto& [name, entry] : {std::pair{"BothEntries", "VSTPluginMain 1"}, {"MachoEntry", "main_macho 1"}})
    {
        ASSERT_NE(Make(name), nullptr);
        EXPECT_EQ(Recorder().Calls().front(), entry);
    }
}

} // namespace
