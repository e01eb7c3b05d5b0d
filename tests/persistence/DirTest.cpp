#include "foundation/zebcore/Dir.h"

#include "TempFolder.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include <optional>

using namespace zebcore;
using namespace zebcore::filesupport;

namespace
{

using Order = boost::function<bool(const UTF16String&, const UTF16String&)>;

// The paths below `dir` that a walk yields, each with a blank behind it.
std::string Walk(const Dir& dir, bool recursive = false, boost::function<bool()>* goOn = nullptr,
                 const boost::shared_ptr<Order>& order = {})
{
    std::string walked;
    for (Dir::DirIterator at = dir.BeginSubdirs(recursive, goOn, order); at != dir.EndSubdirs(); ++at)
    {
        EXPECT_TRUE((*at).Exists());
        walked += utility::NarrowFromUTF16((*at).FullPath().substr(dir.FullPath().size() + 1)) + ' ';
    }
    return walked;
}

class Environment
{
public:
    Environment(const char* name, const char* value) : mName(name)
    {
        if (const char* const before = std::getenv(name))
            mBefore = before;
        Set(value);
    }
    Environment(const Environment&) = delete;
    Environment& operator=(const Environment&) = delete;
    ~Environment() { Set(mBefore ? mBefore->c_str() : nullptr); }

private:
    void Set(const char* value) const { value == nullptr ? unsetenv(mName) : setenv(mName, value, 1); }

    const char* mName;
    std::optional<std::string> mBefore;
};

class DirTest : public testing::Test
{
protected:
    void Make(const std::string& name) const { std::filesystem::create_directories(mFolder.Path(name)); }
    void Link(const std::string& target, const std::string& name) const
    {
        std::filesystem::create_symlink(target, mFolder.Path(name));
    }

    const TempFolder mFolder;
};

} // namespace

TEST_F(DirTest, PathsAreJoinedAndTrimmed)
{
    const std::pair<Dir, UTF16String> samples[] = {
        {Dir(), u""},
        {Dir(u""), u""},
        {Dir(u"/a/b/"), u"/a/b"},
        {Dir(u"/a//"), u"/a"},
        {Dir(u"/"), u"/"},
        {Dir(u"///"), u"/"},
        {Dir(Dir(u"/a"), u"b"), u"/a/b"},
        {Dir(Dir(u"/a/"), u"/b/c/"), u"/a/b/c"},
        {Dir(Dir(u"/"), u"a"), u"/a"},
        {Dir(Dir(u"/a"), u""), u"/a"},
        {Dir(Dir(u"/a"), u"/"), u"/a"},
        {Dir(Dir(), u"a"), u"a"},
        {Dir(u"relative/x"), u"relative/x"},
    };
    for (const auto& [dir, path] : samples)
        EXPECT_TRUE(dir.FullPath() == path) << utility::NarrowFromUTF16(dir.FullPath());
}

TEST_F(DirTest, ExistsIsForDirectories)
{
    mFolder.Write("file", "x");
    Link("nowhere", "dangling");
    EXPECT_TRUE(mFolder.Dir().Exists());
    EXPECT_FALSE(Dir().Exists());
    for (const UTF16String name : {u"file", u"dangling", u"missing", u"file/below"})
        EXPECT_FALSE(Dir(mFolder.Dir(), name).Exists());
    EXPECT_FALSE(Dir(mFolder.Dir().FullPath() + UTF16String(u"\0x", 2)).Exists()) << "not cut at the zero unit";
}

TEST_F(DirTest, CreateMakesWhatIsMissing)
{
    const Dir deep(mFolder.Dir(), u"a/b/c");
    deep.Create();
    EXPECT_TRUE(deep.Exists());
    EXPECT_NO_THROW(deep.Create());
    mFolder.Write("file", "x");
    EXPECT_THROW(Dir(mFolder.Dir(), u"file").Create(), file_exception);
    EXPECT_THROW(Dir(mFolder.Dir(), u"file/below").Create(), file_exception);
    EXPECT_THROW(Dir().Create(), file_exception);
}

TEST_F(DirTest, WalkIsSortedAndOfDirectoriesOnly)
{
    for (const char* const name : {"b.vst3", "a", "B", "\u00e9", ".hidden", "a/inner"})
        Make(name);
    mFolder.Write("file.vst3", "x");
    EXPECT_EQ(Walk(mFolder.Dir()), ".hidden B a b.vst3 \u00e9 ");
    EXPECT_EQ(Walk(mFolder.Dir(), true), ".hidden B a a/inner b.vst3 \u00e9 ");
    const auto backwards =
        boost::make_shared<Order>([](const UTF16String& first, const UTF16String& second) { return first > second; });
    EXPECT_EQ(Walk(mFolder.Dir(), true, nullptr, backwards), "\u00e9 b.vst3 a a/inner B .hidden ");
}

TEST_F(DirTest, WalkOfNothing)
{
    mFolder.Write("file", "x");
    EXPECT_EQ(Walk(mFolder.Dir()), "");
    EXPECT_EQ(Walk(Dir()), "");
    EXPECT_EQ(Walk(Dir(mFolder.Dir(), u"missing")), "");
    EXPECT_EQ(Walk(Dir(mFolder.Dir(), u"file")), "");
    Dir::DirIterator end = mFolder.Dir().EndSubdirs();
    ++end;
    EXPECT_TRUE((*end).FullPath().empty());
}

TEST_F(DirTest, WalkIsASnapshot)
{
    Make("a");
    Make("b");
    Dir::DirIterator at = mFolder.Dir().BeginSubdirs(false, nullptr, {});
    std::filesystem::remove_all(mFolder.Path("a"));
    ++at;
    EXPECT_TRUE((*at).FullPath() == mFolder.File("b").FullPath());
}

TEST_F(DirTest, LinksAreFollowedUnlessTheyLeadBack)
{
    Make("outside/x.vst3");
    Make("plugins/deep");
    Link(mFolder.Path("outside").string(), "plugins/away");
    Link("x.vst3", "outside/same.vst3");
    Link("..", "plugins/up");
    Link(".", "plugins/here");
    Link("../../plugins", "plugins/deep/back");
    Link("nowhere", "plugins/dangling");
    Link("../plugins", "outside/round");
    EXPECT_EQ(Walk(Dir(mFolder.Dir(), u"plugins")), "away deep ");
    EXPECT_EQ(Walk(Dir(mFolder.Dir(), u"plugins"), true), "away away/same.vst3 away/x.vst3 deep ");
}

TEST_F(DirTest, WalkIsEndedWhenAsked)
{
    for (const char* const name : {"a/x", "b", "c"})
        Make(name);
    int left = 2;
    boost::function<bool()> goOn = [&left]
    {
        return left-- > 0;
    };
    EXPECT_EQ(Walk(mFolder.Dir(), true, &goOn), "a a/x ");
}

TEST_F(DirTest, NamesThatAreNotUTF8CanBeFoundAndOpened)
{
    Make("\xFF\xC3.vst3");
    const Dir::DirIterator at = mFolder.Dir().BeginSubdirs(false, nullptr, {});
    ASSERT_TRUE(at != mFolder.Dir().EndSubdirs());
    EXPECT_TRUE((*at).Exists());
    EXPECT_TRUE((*at).FullPath().ends_with(u".vst3"));
    for (const std::string& path : {std::string("/\xFF\x80\xED\xA0\x80/\u00e9/\U0001F3B5"), std::string("\xF0\x9F")})
        EXPECT_EQ(ToNativePath(FromNativePath(path)), path);
}

#ifdef __linux__
TEST_F(DirTest, PreferenceDirectoryFollowsTheDesktopRules)
{
    const Environment home("HOME", "/home/somebody");
    {
        const Environment config("XDG_CONFIG_HOME", "/config/");
        EXPECT_TRUE(Dir::PrefDir().FullPath() == u"/config//zebaudiofilterhost");
    }
    for (const char* const ignored : {static_cast<const char*>(nullptr), "", "relative"})
    {
        const Environment config("XDG_CONFIG_HOME", ignored);
        EXPECT_TRUE(Dir::PrefDir().FullPath() == u"/home/somebody/.config/zebaudiofilterhost");
    }
}
#endif

TEST_F(DirTest, PreferenceDirectoryCanBeSet)
{
    const UTF16String own = Dir::PrefDir().FullPath();
    Dir::SetPrefDir(mFolder.Dir());
    EXPECT_TRUE(Dir::PrefDir().FullPath() == mFolder.Dir().FullPath());
    Dir::SetPrefDir(Dir());
    EXPECT_TRUE(Dir::PrefDir().FullPath() == own);
}

TEST_F(DirTest, ApplicationDirectoryHoldsThisProgram)
{
    const Dir application = Dir::AppDir();
    EXPECT_TRUE(File(application, u"persistence_tests").Exists()) << utility::NarrowFromUTF16(application.FullPath());
}
