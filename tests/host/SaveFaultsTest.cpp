#include "tests/persistence/SaveFaults.h"
#include "audiofilter/PresetData.h"
#include "audiofilter/PresetList.h"
#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "tests/host/FakeTechnology.h"
#include "utility/PrivatePluginUtils.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <ostream>
#include <string>
#include <tuple>

#include <unistd.h>

namespace zebaudiofilterhost::testing
{

namespace
{

namespace fs = std::filesystem;
using zebcore::filesupport::file_delete_exception;
using zebcore::filesupport::file_exception;
using zebcore::filesupport::FileSystemCalls;
using zebcore::filesupport::ToNativePath;

/// A file that the library writes. Each round puts more into it.
struct SavedFile
{
    const char* name;
    void (*save)(File& file, int round);
    bool staysSilentlyWhenRefused;
};

void PrintTo(const SavedFile& file, std::ostream* out)
{
    *out << file.name;
}

UTF16String PathOfRound(int round)
{
    return u"/R&D/plug-in" + zebcore::utility::UTF16FromNarrow(std::to_string(round)) + u".vst3";
}

void SaveSettings(File& file, int round)
{
    PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(MakeInfo(VST3(PathOfRound(round))));
    PluginModuleInfoManager::GetInstance().SaveConfiguration(file, true);
}

void SaveBlockList(File& file, int round)
{
    BannedPluginManager::GetInstance().AddBannedPlugin(VST3(PathOfRound(round)));
    BannedPluginManager::GetInstance().SaveConfiguration(file);
}

void SavePresets(File& file, int round)
{
    PropList list;
    PresetList presets(list);
    presets.AppendPreset(u"warm")->SetParamList({0.5F, static_cast<float>(round)});
    zebcore::proplist::utils::SavePropList(file, list);
}

void SavePrivateConfiguration(File& file, int round)
{
    const UTF16String folder = file.FullPath() + u" plug-ins";
    const UTF16String path = folder + PathOfRound(round).substr(4);
    fs::create_directories(ToNativePath(path));
    FakeMachine::GetInstance().plugins.push_back({VST3(path), true, {{u"3:" + path}}});
    utility::BuildPrivatePluginConfig(file.FullPath(), u"", folder);
}

/// The permanent block list is not among them: it is only read.
const SavedFile kFiles[] = {
    {"settings", SaveSettings, true},
    {"dynamic block list", SaveBlockList, false},
    {"presets", SavePresets, false},
    {"private configuration", SavePrivateConfiguration, false},
};

class SaveFaultsFixture : public FakeTechnologyFixture
{
protected:
    SaveFaultsFixture() { Dir::SetPrefDir(Dir(PathInFolder("preferences"))); }
    ~SaveFaultsFixture() override { Dir::SetPrefDir(Dir()); }

    UTF8String Content() const { return zebcore::utility::FileUtils::SimpleReadStringFromFile(mFile.FullPath()); }

    bool IsWhole() const
    {
        PropList list;
        return zebcore::proplist::utils::LoadPropList(mFile.FullPath(), list, false) && !list.IsEmpty();
    }

    std::ptrdiff_t CountFiles() const
    {
        const fs::recursive_directory_iterator all(fs::path(ToNativePath(mFile.FullPath())).parent_path());
        return std::count_if(begin(all), end(all), [](const auto& entry) { return entry.is_regular_file(); });
    }

    File mFile = FileInFolder("Zeb & S\xc3\xb6hne.xml");
};

class SaveFaultsTest : public SaveFaultsFixture,
                       public ::testing::WithParamInterface<std::tuple<SavedFile, SaveFault>>
{
};

class WholeSaveTest : public SaveFaultsFixture, public ::testing::WithParamInterface<SavedFile>
{
};

} // namespace

TEST_P(SaveFaultsTest, OldFileStaysAndTheCallerIsTold)
{
    const auto& [file, fault] = GetParam();
    file.save(mFile, 1);
    const UTF8String old = Content();
    bool isTold = false;
    try
    {
        const InjectedFault injected(fault.mInject);
        file.save(mFile, 2);
    }
    catch (const file_exception& failure)
    {
        isTold = true;
        EXPECT_EQ(failure.Error(), fault.mError);
        EXPECT_EQ(dynamic_cast<const file_delete_exception*>(&failure) != nullptr, fault.mIsRefusal);
        EXPECT_NE(std::string(failure.what()).find("'" + ToNativePath(mFile.FullPath()) + "'"), std::string::npos)
            << failure.what();
    }
    EXPECT_EQ(isTold, !(fault.mIsRefusal && file.staysSilentlyWhenRefused));
    EXPECT_TRUE(Content() == old);
    EXPECT_EQ(CountFiles(), 1);

    // Nothing of the trouble lasts.
    file.save(mFile, 3);
    EXPECT_FALSE(Content() == old);
    EXPECT_TRUE(IsWhole());
    EXPECT_EQ(CountFiles(), 1);
}

TEST_P(SaveFaultsTest, OfAFirstSaveLeaveNothing)
{
    const auto& [file, fault] = GetParam();
    {
        const InjectedFault injected(fault.mInject);
        EXPECT_THROW(file.save(mFile, 1), file_exception);
    }
    EXPECT_EQ(CountFiles(), 0);
}

INSTANTIATE_TEST_SUITE_P(Each, SaveFaultsTest,
                         ::testing::Combine(::testing::ValuesIn(kFiles), ::testing::ValuesIn(SaveFaults())));

TEST_P(WholeSaveTest, ShortAndInterruptedWritesMakeTheNewFileWhole)
{
    GetParam().save(mFile, 1);
    const UTF8String old = Content();
    {
        int calls = 0;
        const InjectedFault injected(
            [&calls](FileSystemCalls& system)
            {
                system.mWrite = [&calls](int descriptor, const void* data, std::size_t size)
                {
                    if (++calls % 2 != 0)
                        return write(descriptor, data, std::min<std::size_t>(size, 3));
                    errno = EINTR;
                    return ssize_t{-1};
                };
            });
        GetParam().save(mFile, 2);
        EXPECT_GT(calls, 2);
    }
    EXPECT_FALSE(Content() == old);
    EXPECT_TRUE(IsWhole());
    EXPECT_EQ(CountFiles(), 1);
}

TEST_P(WholeSaveTest, NewFileThatMayNotLastIsToldOf)
{
    GetParam().save(mFile, 1);
    const UTF8String old = Content();
    {
        const InjectedFault injected([](FileSystemCalls& system)
                                     { system.mFlush = FailAfter(1, EIO, system.mFlush); });
        EXPECT_THROW(GetParam().save(mFile, 2), file_exception);
    }
    EXPECT_FALSE(Content() == old);
    EXPECT_TRUE(IsWhole());
    EXPECT_EQ(CountFiles(), 1);
}

INSTANTIATE_TEST_SUITE_P(Each, WholeSaveTest, ::testing::ValuesIn(kFiles));

} // namespace zebaudiofilterhost::testing
