#include "host/PluginTechnology.h"

#include "tests/host/CatalogueFixture.h"

#include <boost/function/function_base.hpp>
#include <gtest/gtest.h>

#include <algorithm>
#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Paths = std::vector<UTF16String>;
using TechnologyPtr = boost::intrusive_ptr<PluginTechnology>;

std::string Join(const Paths& paths)
{
    std::string text;
    for (const UTF16String& path : paths)
    {
        text += Text(path) + ",";
    }
    return text;
}

/// A technology that writes down its signals as "+added -removed =list", and what it is asked for.
class PluginTechnologyTest : public ::testing::Test
{
protected:
    TechnologyPtr Make(bool hasDirectories)
    {
        const auto collect = [this](const Dir& dir)
        {
            mLog.push_back("collect " + Text(dir.FullPath()));
            return std::vector<PluginLocator>{VST2(dir.FullPath() + u"/1"), VST2(dir.FullPath() + u"/2")};
        };
        const auto scanContext = [this](const std::vector<Dir>& dirs)
        {
            Paths paths;
            std::transform(dirs.begin(), dirs.end(), std::back_inserter(paths),
                           [](const Dir& dir) { return dir.FullPath(); });
            mLog.push_back("context " + Join(paths));
            return boost::intrusive_ptr<PluginScanContext>();
        };
        const TechnologyPtr technology = new PluginTechnology(
            kTechnologyVST, collect, scanContext,
            [] {
                return Paths{u"/std", u"/lib"};
            },
            [](const UTF16String& path) { return u"<" + path + u">"; }, hasDirectories);
        technology->GetDirectoriesChangedSignal().connect(
            [this](const TechnologyPtr& from, const Paths& added, const Paths& removed)
            { mLog.push_back("+" + Join(added) + " -" + Join(removed) + " =" + List(*from)); });
        return technology;
    }

    static std::string List(const PluginTechnology& technology)
    {
        return Join(Paths(technology.DirectoryBegin(), technology.DirectoryEnd()));
    }

    /// The log since the last call.
    std::vector<std::string> Log() { return std::exchange(mLog, {}); }

private:
    std::vector<std::string> mLog;
};

using Strings = std::vector<std::string>;

} // namespace

TEST_F(PluginTechnologyTest, AddingReportsTheWholeListIfAnyIsNew)
{
    const TechnologyPtr technology = Make(true);
    technology->AddPluginDirectories({u"/a", u"/a", u"/b"});
    EXPECT_EQ(Log(), Strings{"+/a,/a,/b, - =/a,/a,/b,"});
    technology->AddPluginDirectories({u"/b", u"/c"});
    EXPECT_EQ(Log(), Strings{"+/b,/c, - =/a,/a,/b,/c,"});
    technology->AddPluginDirectories({u"/a", u"/c"});
    technology->AddPluginDirectories({});
    EXPECT_EQ(Log(), Strings{});
}

TEST_F(PluginTechnologyTest, RemovingTakesOneEntryForEachItem)
{
    const TechnologyPtr technology = Make(true);
    technology->AddPluginDirectories({u"/a", u"/b", u"/a"});
    Log();
    technology->RemovePluginDirectories({u"/x", u"/a"});
    EXPECT_EQ(Log(), Strings{"+ -/x,/a, =/b,/a,"});
    technology->RemovePluginDirectories({u"/x"});
    EXPECT_EQ(Log(), Strings{});
    technology->RemoveAllPluginDirectories();
    EXPECT_EQ(Log(), Strings{"+ -/b,/a, ="});
    technology->RemoveAllPluginDirectories();
    EXPECT_EQ(Log(), Strings{});
}

TEST_F(PluginTechnologyTest, ResetAlwaysReportsTheOldList)
{
    const TechnologyPtr listed = Make(true);
    listed->AddPluginDirectories({u"/a"});
    Log();
    listed->ResetDirectoriesToDefault();
    EXPECT_EQ(Log(), (Strings{"+ -/a, =/a,", "+/std,/lib, - =/std,/lib,"}));

    const TechnologyPtr fixed = Make(false);
    fixed->ResetDirectoriesToDefault();
    EXPECT_EQ(Log(), Strings{"+ - ="});
    EXPECT_FALSE(fixed->HasDirectories());
}

TEST_F(PluginTechnologyTest, CollectsFromTheListOrFromItsOwnPlaces)
{
    const TechnologyPtr listed = Make(true);
    EXPECT_TRUE(listed->CollectPlugins().empty());
    EXPECT_EQ(Log(), Strings{});
    listed->AddPluginDirectories({u"/a", u"/b", u"/b"});
    Log();
    EXPECT_EQ(Texts(listed->CollectPlugins()), (Strings{"2:/a/1", "2:/a/2", "2:/b/1", "2:/b/2", "2:/b/1", "2:/b/2"}));
    EXPECT_EQ(Log(), (Strings{"collect /a", "collect /b", "collect /b"}));
    EXPECT_FALSE(listed->CreateScanContext());
    EXPECT_EQ(Log(), Strings{"context /a,/b,/b,"});

    const TechnologyPtr fixed = Make(false);
    fixed->AddPluginDirectories({u"/a", u"/b"});
    Log();
    EXPECT_EQ(Texts(fixed->CollectPlugins()), (Strings{"2:/1", "2:/2"}));
    EXPECT_EQ(Log(), Strings{"collect "});
}

TEST(PluginTechnologyWithoutFunctions, FallsBackOrThrows)
{
    const TechnologyPtr technology = new PluginTechnology(kTechnologyVST, {}, {}, {}, {}, true);
    technology->AddPluginDirectories({u"/a"});
    EXPECT_TRUE(technology->CollectPlugins().empty());
    EXPECT_THROW(technology->CreateScanContext(), boost::bad_function_call);
    EXPECT_EQ(Text(technology->GetPathDisplayString(u"/p")), "/p");
    technology->ResetDirectoriesToDefault();
    EXPECT_EQ(technology->DirectoryEnd() - technology->DirectoryBegin(), 1);
}

TEST_F(PluginTechnologyTest, DisplaysPathsThroughItsFunction)
{
    EXPECT_EQ(Text(Make(true)->GetPathDisplayString(u"/p")), "</p>");
}

} // namespace zebaudiofilterhost::testing
