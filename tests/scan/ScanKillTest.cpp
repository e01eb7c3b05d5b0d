#include "tests/scan/support/ScanFolder.h"
#include "tests/scan/support/StartedProgram.h"

#include <algorithm>
#include <chrono>
#include <csignal>
#include <random>
#include <thread>

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;

class ScanKillTest : public ScanFolder
{
protected:
    ScanKillTest()
    {
        for (const char* name : {"a", "b", "c", "d", "e", "f"})
        {
            AddBundle(name);
            mAll.insert(name);
        }
    }

    // How long a scan of everything takes here and now, in microseconds.
    int TimeOfAScan() const
    {
        const auto start = std::chrono::steady_clock::now();
        Succeed({"scan", "--full", "--quiet"});
        return static_cast<int>(
            std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::steady_clock::now() - start).count());
    }

    // What the files hold once a command has taken over what stands in the journal.
    struct Books
    {
        std::set<std::string> records;
        std::map<std::string, std::string> blocks;
    };
    Books Read() const
    {
        std::map<std::string, std::string> blocks = Blocks();
        return {Records(), std::move(blocks)};
    }

    bool IsAllDone(const Books& books) const
    {
        std::set<std::string> done = books.records;
        for (const auto& [name, reason] : books.blocks)
        {
            done.insert(name);
        }
        return done == mAll;
    }

    // Something to do for the next scan: the rest, or all again in one of three ways.
    std::vector<std::string> NextScan(unsigned int round, Books& books) const
    {
        if (!IsAllDone(books))
        {
            return {"scan"};
        }
        switch (round % 3)
        {
        case 0:
            fs::remove_all(Settings());
            books = {};
            return {"scan"};
        case 1:
            return {"scan", "--full"};
        default:
            return {"scan", "--retry-blocked"};
        }
    }

    // The kill meets zebhost alone or its whole process group.
    void RunAndKill(const std::vector<std::string>& arguments, std::chrono::microseconds delay, bool group) const
    {
        StartedProgram scan(CommandLine(arguments), mVariables, mFolder);
        std::this_thread::sleep_for(delay);
        group ? scan.SignalGroup(SIGKILL) : scan.Signal(SIGKILL);
        scan.Wait();
    }

    // Returns how many plug-ins are blocked now that were not before.
    static std::size_t CheckBooks(const Books& before, const Books& after)
    {
        EXPECT_TRUE(
            std::includes(after.records.begin(), after.records.end(), before.records.begin(), before.records.end()))
            << "lost a record: " << testing::PrintToString(before.records) << " became "
            << testing::PrintToString(after.records);
        std::size_t fresh = 0;
        for (const auto& [name, reason] : after.blocks)
        {
            fresh += before.blocks.count(name) == 0 ? 1U : 0U;
            EXPECT_THAT(reason, HasSubstr("at hand in a scan that did not end"));
        }
        EXPECT_LE(fresh, 1U);
        return fresh;
    }

    void CheckThatNothingWasScannedTwice(const Books& before) const
    {
        for (const Load& load : Loads())
        {
            EXPECT_EQ(before.records.count(load.name), 0U) << "scanned twice: " << load.name;
        }
    }

    std::set<std::string> mAll;
};

unsigned int RandomStart()
{
    const char* const given = std::getenv("ZEB_RANDOM_START");
    const unsigned int start =
        given != nullptr ? static_cast<unsigned int>(std::stoul(given)) : std::random_device()();
    std::cout << "ZEB_RANDOM_START=" << start << "\n";
    return start;
}

// The kill falls anywhere between the start of the program and the end of a scan.
TEST_F(ScanKillTest, FiveHundredKillsLoseNothing)
{
    const unsigned int kills = Slowness() > 1 ? 60 : 500;
    std::mt19937 random(RandomStart());
    int timeOfAScan = TimeOfAScan();
    std::size_t blocksMade = 0;
    std::size_t recordsMade = 0;
    Books before = Read();
    for (unsigned int round = 0; round < kills && !HasFailure(); ++round)
    {
        const std::vector<std::string> arguments = NextScan(round, before);
        SCOPED_TRACE("round " + std::to_string(round) + " " + testing::PrintToString(arguments));
        ForgetLoads();
        std::uniform_int_distribution<int> delay(0, timeOfAScan);
        RunAndKill(arguments, std::chrono::microseconds(delay(random)), round % 2 == 0);
        Books after = Read();
        blocksMade += CheckBooks(before, after);
        recordsMade += after.records.size() - std::min(after.records.size(), before.records.size());
        if (arguments.size() == 1)
        {
            CheckThatNothingWasScannedTwice(before);
        }
        if (round % 20 == 19)
        {
            Succeed({"scan", "--quiet"});
            EXPECT_TRUE(IsAllDone(Read())) << "the next scan has to go on to the end";
            timeOfAScan = TimeOfAScan(); // Others may keep the machine busy
            after = Read();
        }
        before = std::move(after);
    }
    // Kills that met nothing would prove nothing.
    EXPECT_GT(blocksMade, kills / 40);
    EXPECT_GT(recordsMade, kills / 40);
    Succeed({"scan", "--retry-blocked", "--quiet"});
    EXPECT_EQ(Records(), mAll);
    EXPECT_TRUE(Blocks().empty());
}

} // namespace

} // namespace zebtest
