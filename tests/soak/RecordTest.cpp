#include "Record.h"
#include "Ledger.h"

#include <gmock/gmock.h>

#include <functional>

namespace soak
{
namespace
{

using testing::ElementsAre;

constexpr int kSamples = 120;
constexpr double kMega = 1e6;

// A run of two minutes that holds what `change` makes of 100 MB, 10 descriptors and 3 threads at each second.
std::vector<Check::Outcome> OutcomesOf(const std::function<void(int, Resources&)>& change, int samples = kSamples)
{
    std::vector<Sample> row;
    for (int second = 0; second <= samples; ++second)
    {
        Resources resources{static_cast<std::size_t>(100 * kMega), static_cast<std::size_t>(50 * kMega), 10, 3};
        change(second, resources);
        row.push_back({static_cast<double>(second), resources});
    }
    std::vector<Check::Outcome> outcomes;
    for (const Check& check : JudgeResources(row))
    {
        outcomes.push_back(check.outcome);
    }
    return outcomes;
}

constexpr auto kHolds = Check::Outcome::Holds;
constexpr auto kFails = Check::Outcome::Fails;

TEST(RecordTest, TellsSteadyGrowthFromNoise)
{
    EXPECT_THAT(OutcomesOf([](int, Resources&) {}), ElementsAre(kHolds, kHolds, kHolds, kHolds));
    // A single peak at the end is no growth, nor is a fifth more for a moment ahead of the last quarter.
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources)
                           { resources.resident += second % 15 == 14 || second == 80 ? 20000000U : 0U; }),
                ElementsAre(kHolds, kHolds, kHolds, kHolds));
    // From the middle of the first quarter to that of the last are 90 s: 6 % are too much, 4 % are not.
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources)
                           { resources.resident += static_cast<std::size_t>(second * 0.06 / 90 * 101 * kMega); }),
                ElementsAre(kFails, kHolds, kHolds, kHolds));
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources)
                           { resources.inUse += static_cast<std::size_t>(second * 0.06 / 90 * 51 * kMega); }),
                ElementsAre(kHolds, kFails, kHolds, kHolds));
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources)
                           { resources.inUse += static_cast<std::size_t>(second * 0.04 / 90 * 50 * kMega); }),
                ElementsAre(kHolds, kHolds, kHolds, kHolds));
}

TEST(RecordTest, CountsAtBothEnds)
{
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources) { resources.descriptors += second == kSamples; }),
                ElementsAre(kHolds, kHolds, kFails, kHolds));
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources) { resources.threads += second == kSamples; }),
                ElementsAre(kHolds, kHolds, kHolds, kFails));
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources) { resources.threads += second == kSamples / 2; }),
                ElementsAre(kHolds, kHolds, kHolds, kHolds));
}

TEST(RecordTest, JudgesNoMemoryOfAShortRun)
{
    EXPECT_THAT(OutcomesOf([](int second, Resources& resources)
                           { resources.inUse *= static_cast<std::size_t>(1 + second); },
                           30),
                ElementsAre(Check::Outcome::NotJudged, Check::Outcome::NotJudged, kHolds, kHolds));
}

TEST(RecordTest, DoesNotPassARunThatTestedNothing)
{
    EXPECT_EQ(JudgeSubjects(0).outcome, kFails);
    EXPECT_EQ(JudgeSubjects(1).outcome, kHolds);
    EXPECT_EQ(JudgeEnd(true).outcome, kFails);
    EXPECT_EQ(JudgeEnd(false).outcome, kHolds);
    EXPECT_EQ(JudgeProbes(0, 0).outcome, Check::Outcome::NotJudged);
    EXPECT_EQ(JudgeProbes(2, 0).outcome, kHolds);
    EXPECT_EQ(JudgeProbes(2, 1).outcome, kFails);

    EXPECT_EQ(JudgeThrows(3, 0, 7).outcome, kHolds);
    EXPECT_EQ(JudgeThrows(3, 1, 0).outcome, kFails);

    EXPECT_FALSE(AllHold({}));
    EXPECT_FALSE(AllHold({JudgeProbes(0, 0)}));
    EXPECT_TRUE(AllHold({JudgeProbes(0, 0), JudgeEnd(false)}));
    EXPECT_FALSE(AllHold({JudgeSubjects(3), JudgeEnd(true)}));
}

TEST(LedgerTest, PutsWhatStaysDownToItsEffect)
{
    Ledger ledger({"tight", "leaks", "leaks more", "keeps a descriptor", "maps memory"});
    const Resources before{5000, 1000, 10, 3};
    ledger.AddTurn(0, 5, 1, before, before);
    ledger.AddTurn(1, 5, 1, before, {5000, 1050, 10, 3});
    ledger.AddTurn(1, 5, 1, before, {5000, 1050, 10, 3});
    ledger.AddTurn(2, 5, 1, before, {5800, 1900, 10, 3});
    ledger.AddTurn(3, 5, 1, before, {4900, 990, 11, 3});
    ledger.AddTurn(4, 5, 1, before, {9000, 980, 10, 3});
    const auto worst = [&ledger](std::size_t most, std::ptrdiff_t Ledger::Account::*kind)
    {
        std::vector<std::string> names;
        for (const Ledger::Account& account : ledger.Worst(most, kind))
        {
            names.push_back(account.name);
        }
        return names;
    };
    EXPECT_THAT(worst(5, &Ledger::Account::growth),
                ElementsAre("leaks more", "leaks", "keeps a descriptor", "maps memory"));
    EXPECT_THAT(worst(2, &Ledger::Account::resident), ElementsAre("maps memory", "leaks more"));
    EXPECT_EQ(ledger.Accounts()[1].PerLife(), 10.0);
}

} // namespace
} // namespace soak
