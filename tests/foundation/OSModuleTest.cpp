#include "foundation/zebcore/OSModule.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

#include <dlfcn.h>
#include <sys/utsname.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

using namespace zebcore;
using namespace zebcore::utility;

namespace fs = std::filesystem;

namespace
{

std::string NativeFolder()
{
    utsname name{};
    uname(&name);
    return std::string(name.machine) + "-linux";
}

class OSModuleTest : public testing::Test
{
protected:
    OSModuleTest()
    {
        std::string name = (fs::temp_directory_path() / "zeb-module-XXXXXX").string();
        mFolder = mkdtemp(name.data());
    }
    ~OSModuleTest() override { fs::remove_all(mFolder); }

    /// Puts the test binary where the bundle's parts lead to.
    void Install(const std::string& relativePath)
    {
        fs::create_directories((mFolder / relativePath).parent_path());
        fs::copy_file(ZEB_TEST_MODULE, mFolder / relativePath);
    }
    void Write(const std::string& relativePath, const std::string& content)
    {
        fs::create_directories((mFolder / relativePath).parent_path());
        std::ofstream(mFolder / relativePath, std::ios::binary) << content;
    }
    UTF16String Path(const std::string& name) const { return filesupport::FromNativePath((mFolder / name).string()); }

    static bool LastErrorHolds(const std::string& text)
    {
        return NarrowFromUTF16(GetLastOSModuleError()).find(text) != std::string::npos;
    }

    fs::path mFolder;
};

TEST_F(OSModuleTest, LoadsBundlesAndPlainFiles)
{
    const std::string inBundle = "/Contents/" + NativeFolder();
    struct Case
    {
        std::string mBinary;
        std::string mLoadedAs;
    };
    const Case cases[] = {
        {"A.vst3" + inBundle + "/A.so", "A.vst3"},
        {"B two.1.vst3" + inBundle + "/B two.1.so", "B two.1.vst3/"},
        {"C.vst" + inBundle + "/C.so", "C.vst"},
        {"D.vst/D.so", "D.vst"},
        {"E.vst/E-vst.so", "E.vst"},
        {"F.so", "F.so"},
        {"\xFF\xC3.vst3" + inBundle + "/\xFF\xC3.so", "\xFF\xC3.vst3"},
    };
    for (const Case& bundle : cases)
    {
        Install(bundle.mBinary);
        OSModuleRef module = LoadOSModule(Path(bundle.mLoadedAs));
        ASSERT_NE(nullptr, module) << NarrowFromUTF16(GetLastOSModuleError());
        EXPECT_TRUE(GetOSModuleBinaryPath(module) == Path(bundle.mBinary));
        EXPECT_TRUE(FindOSModuleBinary(Path(bundle.mLoadedAs)) == Path(bundle.mBinary));

        const ModuleFunction answer = GetFunctionPointerFromModuleImpl(module, "TestModuleAnswer");
        ASSERT_NE(nullptr, answer);
        EXPECT_EQ(42, reinterpret_cast<int (*)()>(answer)());
        EXPECT_EQ(nullptr, GetFunctionPointerFromModuleImpl(module, "NoSuchFunction"));
        EXPECT_EQ(reinterpret_cast<void*>(answer), dlsym(GetOSModuleHandle(module), "TestModuleAnswer"));
        ReleaseOSModule(module);
    }
}

TEST_F(OSModuleTest, AReleasedModuleStaysMapped)
{
    Install("A.so");
    OSModuleRef module = LoadOSModule(Path("A.so"));
    const ModuleFunction answer = GetFunctionPointerFromModuleImpl(module, "TestModuleAnswer");
    ASSERT_NE(nullptr, answer);
    ReleaseOSModule(module);
    EXPECT_EQ(42, reinterpret_cast<int (*)()>(answer)());
}

TEST_F(OSModuleTest, AFailureSaysWhatIsWrongWithWhichFile)
{
    Write("Windows.vst3/Contents/x86_64-win/Windows.vst3", "MZ");
    Write("Windows.vst3/Contents/MacOS/Windows", "");
    Write("Misnamed.vst3/Contents/" + NativeFolder() + "/Other.so", "");
    Write("Folder.vst3/readme.txt", "");
    Write("Text.vst3", "no binary");
    Write("PE.vst3", "MZ binary");
    Install("NotVst2.vst3/NotVst2.so");

    struct Case
    {
        std::string mName;
        std::string mReason;
    };
    const Case cases[] = {
        {"Missing.vst3", "does not exist"},          {"Windows.vst3", "only for MacOS and x86_64-win"},
        {"Misnamed.vst3", "no Misnamed.so in it"},   {"Folder.vst3", "is not a plug-in bundle"},
        {"Text.vst3", "could not be loaded"},        {"PE.vst3", "Windows binary"},
        {"NotVst2.vst3", "is not a plug-in bundle"},
    };
    for (const Case& bundle : cases)
    {
        EXPECT_EQ(nullptr, LoadOSModule(Path(bundle.mName)));
        EXPECT_TRUE(LastErrorHolds(bundle.mReason)) << NarrowFromUTF16(GetLastOSModuleError());
        EXPECT_TRUE(LastErrorHolds(bundle.mName)) << NarrowFromUTF16(GetLastOSModuleError());
    }
}

TEST_F(OSModuleTest, ANullModuleHasNothing)
{
    ReleaseOSModule(nullptr);
    EXPECT_EQ(nullptr, GetOSModuleHandle(nullptr));
    EXPECT_EQ(nullptr, GetFunctionPointerFromModuleImpl(nullptr, "TestModuleAnswer"));
    EXPECT_TRUE(GetOSModuleBinaryPath(nullptr).empty());
    EXPECT_EQ(nullptr, LoadOSModule(UTF16String()));
    EXPECT_EQ(nullptr, LoadOSModule(UTF16String{char16_t(0xD800), u'\0', u'x'}));
}

} // namespace
