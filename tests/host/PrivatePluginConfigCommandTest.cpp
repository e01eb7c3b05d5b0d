#include "console/AudioFilterConsoleCommands.h"

#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/CommandRegistry.h"
#include "foundation/zebcore/NativePath.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "module/Module.h"
#include "tests/host/CatalogueFixture.h"
#include "tests/plugins/FixturePaths.h"
#include "utility/EffectUtils.h"
#include "utility/PrivatePluginUtils.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using console::BuildPrivatePluginConfigCmd;
using zebcore::console::CommandRegistry;
using zebcore::filesupport::ToNativePath;

constexpr const char* kUsage =
    "zebaudiofilterhost.BuildPrivatePluginConfig <path of result file>,<VST3 directory>,[VST2 directory]\n";

/// The whole library, with its preferences in the test's folder.
class PrivatePluginConfigCommandTest : public CatalogueFixture
{
protected:
    PrivatePluginConfigCommandTest() { Dir::SetPrefDir(Dir(PathInFolder("preferences"))); }
    ~PrivatePluginConfigCommandTest() override { Dir::SetPrefDir(Dir()); }

    /// What the command writes; "no command" if there is none.
    static std::string Run(const UTF16String& arguments)
    {
        zebcore::utility::oUTF16StringStream output;
        const bool ran = CommandRegistry::ExecuteCommand(BuildPrivatePluginConfigCmd::kName, arguments, output);
        return ran ? Text(output.str()) : "no command";
    }

    static bool Exists(const UTF16String& path) { return std::filesystem::exists(ToNativePath(path)); }
};

class InitializedCommandTest : public PrivatePluginConfigCommandTest
{
protected:
    InitializedCommandTest() { Initialize(); }
    ~InitializedCommandTest() override { Terminate(); }
};

} // namespace

TEST_F(PrivatePluginConfigCommandTest, IsThereFromTheFirstInitializeToTheLastTerminate)
{
    EXPECT_EQ(Run(u""), "no command");
    for (int round = 0; round < 2; ++round)
    {
        Initialize();
        Initialize();
        const auto commands = CommandRegistry::GetCommands();
        ASSERT_EQ(commands.size(), 1u);
        EXPECT_EQ(Text(commands.front().first), "zebaudiofilterhost.BuildPrivatePluginConfig");
        EXPECT_EQ(Text(commands.front().second), "zebaudiofilterhost.BuildPrivatePluginConfig - Build the private "
                                                 "plug-in configuration used by zebaudiofilterhost.");
        Terminate();
        EXPECT_EQ(Run(u""), kUsage);
        Terminate();
        EXPECT_EQ(Run(u""), "no command");
    }
}

TEST_F(InitializedCommandTest, TellsItsUsageUnlessThereAreTwoOrThreeFields)
{
    const UTF16String result = PathInFolder("result");
    for (const UTF16String& arguments :
         {UTF16String(), result, result + u",", result + u",,/vst", result + u",/3,/2,/1", u"," + result + u",/3"})
    {
        SCOPED_TRACE(Text(arguments));
        EXPECT_EQ(Run(arguments), kUsage);
        EXPECT_FALSE(Exists(result));
    }
    for (const UTF16String& arguments : {result + u",/none", result + u",/none,", result + u",/none,/none"})
    {
        SCOPED_TRACE(Text(arguments));
        EXPECT_EQ(Run(arguments), "Done.\n");
        EXPECT_TRUE(Exists(result));
        std::filesystem::remove(ToNativePath(result));
    }
}

TEST_F(InitializedCommandTest, EffectsInsideAnApplicationWorkWhereverItIsMoved)
{
    namespace fs = std::filesystem;
    const UTF16String built = PathInFolder("R&D's \"vst3\" Gr\xc3\xb6\xc3\x9f"
                                           "e");
    const UTF16String installed = PathInFolder("Applications/Zeb & <Sons>");
    const UTF16String resource = PathInFolder("PrivatePluginConfig.txt");
    for (const char* const name : {"ZebGain", "ZebTrio"})
    {
        const fs::path bundle = zebtest::EffectBundle(name);
        fs::create_directories(ToNativePath(built));
        fs::copy(bundle, ToNativePath(built) / bundle.filename(), fs::copy_options::recursive);
    }

    // At production time.
    ASSERT_EQ(Run(resource + u"," + built), "Done.\n");
    const std::vector<std::string> ids = CatalogueIDs();
    ASSERT_EQ(ids.size(), 4u) << "an instrument counts as an effect as long as nobody asks it";

    // On the user's machine. A copy, since this process has the first binaries loaded.
    fs::create_directories(fs::path(ToNativePath(installed)).parent_path());
    fs::copy(ToNativePath(built), ToNativePath(installed), fs::copy_options::recursive);
    fs::remove_all(ToNativePath(built));
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    manager.SetPrivatePluginConfiguration(u8"");
    manager.ClearAll(true);
    utility::SetPrivatePluginConfigFromFile(resource, installed, u"");
    File settings(Dir::PrefDir(), manager.GetSettingsFileName());
    manager.LoadConfiguration(settings);

    EXPECT_EQ(CatalogueIDs(), ids);
    EXPECT_TRUE(RecordPaths().empty()) << "private plug-ins have descriptors and no records";
    const AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    for (auto it = descriptors.InfoBegin(); it != descriptors.InfoEnd(); ++it)
    {
        const UTF16String id = (*it)->GetUniqueID();
        SCOPED_TRACE(Text(id));
        EXPECT_TRUE((*it)->GetLocator().GetPath().starts_with(installed + u"/Zeb"));
        EXPECT_EQ((*it)->GetCategory(), kCategoryNotQueried);
        const boost::intrusive_ptr<AudioFilter> filter = utility::CreateAudioFilter(id);
        ASSERT_TRUE(filter);
        EXPECT_TRUE(filter->GetDisplayName() == (*it)->GetName());
        EXPECT_GT(filter->GetParameterCount(), 0);
    }
}

} // namespace zebaudiofilterhost::testing
