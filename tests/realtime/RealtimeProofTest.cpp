// Filters of every technology at work: nothing on our side of the process path may allocate, free, lock, call the
// system, fault or give way. ZEB_REALTIME_BLOCKS says how many blocks each filter gets.
#include "tests/realtime/RealtimeProof.h"
#include "tests/realtime/OwnFilter.h"
#include "tests/realtime/Plants.h"
#include "tests/realtime/RealtimeRun.h"

#include <cstdlib>
#include <iostream>

namespace realtimeproof
{

void PrintTo(const Row& row, std::ostream* out)
{
    *out << row.name;
}

namespace
{

long BlockCount()
{
    constexpr long kUsual = 10000;
    constexpr long kUnwatched = 2000; // Sanitizers are slow, and the nets are off
    if (const char* wanted = std::getenv("ZEB_REALTIME_BLOCKS"))
        return std::atol(wanted);
    return realtimeguard::IsActive() ? kUsual : kUnwatched;
}

TEST_P(RealtimeProof, NothingOfOursDisturbsTheProcessThread)
{
    realtimeguard::AnnounceWhatIsMissing();
    const std::unique_ptr<Subject> subject = GetParam().make();
    ASSERT_TRUE(subject);
    RealtimeRun run(*subject, BlockCount());
    realtimeguard::Reset();
    run.Go();
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();

    const Traffic& traffic = run.GetTraffic();
    std::cout << traffic << '\n';
    EXPECT_EQ(traffic.smallest, 1);
    EXPECT_GT(traffic.largest, 1024) << "blocks must be longer than what plug-ins are given at once";
    EXPECT_TRUE(traffic.hasSounded);
    EXPECT_GE(traffic.messagesRun, traffic.messages);
    for (const long happened : {traffic.messages, traffic.mapEdits, traffic.presets, traffic.ticks, traffic.elsewhere,
                                traffic.heard.load()})
        EXPECT_GT(happened, 0) << traffic;
}

// One for each net, in the middle of a run.
TEST(RealtimeRun, ReportsWhatAFilterDoesInOneBlockOfMany)
{
    for (const realtimeguard::Plant& plant : realtimeguard::Plants())
    {
        if (!realtimeguard::CanSee(plant.violation))
            continue;
        constexpr long kBlocks = 400;
        OwnSubject subject;
        subject.Plant(RealtimeRun::kWarmUp + kBlocks / 2, plant.act);
        RealtimeRun run(subject, kBlocks);
        realtimeguard::Reset();
        run.Go();
        EXPECT_GT(realtimeguard::Count(plant.violation), 0U) << plant.name;
    }
    realtimeguard::Reset();
    if (!realtimeguard::IsActive())
        GTEST_SKIP() << "no net of the guard works in this build";
}

} // namespace
} // namespace realtimeproof
