// What zebhost keeps, cut short at every byte: it goes on, and says what it lost.
#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

#include <algorithm>

namespace zebtest
{

namespace
{

// A run of an instrumented zebhost takes ten times as long; the readers themselves meet each length under sanitizers
// in the fuzzers' corpus test.
constexpr std::size_t kStep = ZEB_TRUNCATION_STEP;

namespace fs = std::filesystem;

constexpr const char* kPermanentList = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                                       "<pluginlist>\n"
                                       "  <plugin filename=\"Old Reverb.vst3\" uniqueid=\"\" version=\"\"/>\n"
                                       "</pluginlist>\n";

using Texts = std::map<fs::path, std::string>;

// Whether what is left of an XML or a JSON file has lost more than blanks at its end.
bool HasLost(const std::string& whole, const std::string& left)
{
    return left.size() <= whole.find_last_of(">}");
}

class TruncationTest : public ZebhostTest
{
protected:
    // One plug-in keeps the files, and so the number of runs, small.
    TruncationTest()
    {
        fs::create_directories(mFolder / "plugins");
        fs::copy(EffectBundle("ZebDelay"), mFolder / "plugins" / "ZebDelay.vst3", fs::copy_options::recursive);
        SearchIn(mFolder / "plugins");
        Succeed({"scan"});
    }

    Texts SettingsFiles() const
    {
        Texts texts;
        for (const fs::directory_entry& entry : fs::recursive_directory_iterator(Settings()))
        {
            if (entry.is_regular_file())
            {
                texts[entry.path()] = ReadText(entry.path());
            }
        }
        return texts;
    }

    // Leaves of each file what it has up to `length` bytes, in turn, and nothing beside them.
    Texts Cut(const Texts& wholes, std::size_t length) const
    {
        fs::remove_all(Settings());
        Texts lefts;
        for (const auto& [file, whole] : wholes)
        {
            fs::create_directories(file.parent_path());
            lefts[file] = whole.substr(0, length % (whole.size() + 1));
            WriteText(file, lefts[file]);
        }
        return lefts;
    }
};

TEST_F(TruncationTest, NoFileOfTheSettingsIsLostWithoutAWord)
{
    Succeed({"block", EffectBundle("ZebGain").string(), "--reason", "loud"});
    WriteText(Settings() / "PermanentAudioPlugInBlacklist.xml", kPermanentList);
    const Texts wholes = SettingsFiles();
    const std::size_t filters = Succeed({"list", "--json"}).Json().at("filters").size();
    ASSERT_GT(filters, 0U);
    std::size_t longest = 0;
    for (const auto& [file, whole] : wholes)
    {
        longest = std::max(longest, whole.size());
    }

    for (std::size_t length = 0; length <= longest && !HasFailure(); length += kStep)
    {
        const Texts lefts = Cut(wholes, length);
        const RunResult listed = Run({"list", "--json"});
        ASSERT_EQ(listed.code, 0) << length << listed.err;
        const bool isWhole = listed.Json().at("filters").size() == filters;
        EXPECT_EQ(isWhole, !HasLost(wholes.at(CatalogueFile()), lefts.at(CatalogueFile()))) << length;
        for (const auto& [file, left] : lefts)
        {
            const bool lost = HasLost(wholes.at(file), left);
            EXPECT_EQ(listed.err.find(file.string()) != std::string::npos, lost) << length << listed.err;
        }
    }
}

TEST_F(TruncationTest, APresetThatLostSomethingIsNotLoaded)
{
    Succeed({"preset", "save", "Zeb Delay", Path("warm.xml"), "--set", "Mix=30"});
    const std::string whole = ReadText(Path("warm.xml"));
    for (std::size_t length = 0; length <= whole.size() && !HasFailure(); length += kStep)
    {
        WriteText(Path("warm.xml"), whole.substr(0, length));
        const RunResult loaded = Run({"preset", "load", "Zeb Delay", Path("warm.xml")});
        const bool lost = HasLost(whole, whole.substr(0, length));
        EXPECT_EQ(loaded.code, lost ? 7 : 0) << length << loaded.err;
        EXPECT_EQ(loaded.err.find("damaged") != std::string::npos, lost) << length << loaded.err;
    }
}

} // namespace

} // namespace zebtest
