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

    bool IsAllDone() const
    {
        std::set<std::string> done = Records();
        for (const auto& [name, reason] : Blocks())
        {
            done.insert(name);
        }
        return done == mAll;
    }

    // Something to do for the next scan: the rest, or all again in one of three ways.
    std::vector<std::string> NextScan(unsigned int round) const
    {
        if (!IsAllDone())
        {
            return {"scan"};
        }
        switch (round % 3)
        {
        case 0:
            fs::remove_all(Settings());
            return {"scan"};
        case 1:
            return {"scan", "--full"};
        default:
            return {"scan", "--retry-blocked"};
        }
    }

    std::set<std::string> mAll;
};

// The kill falls anywhere between the start of the program and a time at which some plug-ins are done.
TEST_F(ScanKillTest, FiveHundredKillsLoseNothing)
{
    const unsigned int seed = std::getenv("ZEB_SEED") != nullptr
                                  ? static_cast<unsigned int>(std::stoul(std::getenv("ZEB_SEED")))
                                  : std::random_device()();
    std::cout << "ZEB_SEED=" << seed << "\n";
    const unsigned int kills = Slowness() > 1 ? 60 : 500;
    std::mt19937 random(seed);
    std::uniform_int_distribution<int> microseconds(0, static_cast<int>(60000 * Slowness()));
    std::size_t blocksMade = 0;
    std::size_t recordsMade = 0;
    for (unsigned int round = 0; round < kills && !HasFailure(); ++round)
    {
        const std::vector<std::string> arguments = NextScan(round);
        const std::set<std::string> recordsBefore = Records();
        const std::map<std::string, std::string> blocksBefore = Blocks();
        ForgetLoads();
        {
            StartedProgram scan(CommandLine(arguments), mVariables, mFolder);
            std::this_thread::sleep_for(std::chrono::microseconds(microseconds(random)));
            round % 2 == 0 ? scan.SignalGroup(SIGKILL) : scan.Signal(SIGKILL);
            scan.Wait();
        }
        const std::set<std::string> records = Records();
        const std::map<std::string, std::string> blocks = Blocks();
        const auto context = testing::Message() << "round " << round << testing::PrintToString(arguments);
        EXPECT_TRUE(std::includes(records.begin(), records.end(), recordsBefore.begin(), recordsBefore.end()))
            << context << " lost a record: " << testing::PrintToString(recordsBefore) << " became "
            << testing::PrintToString(records);
        std::size_t fresh = 0;
        for (const auto& [name, reason] : blocks)
        {
            fresh += blocksBefore.count(name) == 0 ? 1U : 0U;
            EXPECT_THAT(reason, HasSubstr("at hand in a scan that did not end")) << context;
        }
        EXPECT_LE(fresh, 1U) << context;
        if (arguments.size() == 1)
        {
            for (const Load& load : Loads())
            {
                EXPECT_EQ(recordsBefore.count(load.name), 0U) << context << " scanned twice: " << load.name;
            }
        }
        blocksMade += fresh;
        recordsMade += records.size() - std::min(records.size(), recordsBefore.size());
        if (round % 20 == 19)
        {
            Succeed({"scan", "--quiet"});
            EXPECT_TRUE(IsAllDone()) << context << ": the next scan has to go on to the end";
        }
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
