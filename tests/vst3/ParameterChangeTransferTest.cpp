#include "host/src/VST3/src/ParameterChangeTransfer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::int32;
using Steinberg::Vst::ParamID;

std::vector<double> TakeValues(ParameterChangeTransfer& transfer, ParamID id)
{
    std::vector<double> values;
    double value = 0;
    for (int32 offset = 0; transfer.GetNextChange(id, value, offset);)
        values.push_back(value);
    return values;
}

void AddPoint(ParameterChanges& changes, ParamID id, int32 offset, double value)
{
    int32 index = 0;
    changes.addParameterData(id, index)->addPoint(offset, value, index);
}

TEST(ParameterChangeTransfer, FoldsChangesOfOneOffsetIntoTheNewest)
{
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({4});
    for (const double value : {.1, .2, .3})
        transfer.AddChange(4, value, 0);
    ParameterChanges changes;
    EXPECT_TRUE(transfer.TransferChangesTo(changes));
    ASSERT_EQ(changes.getParameterCount(), 1);
    ASSERT_EQ(changes.getParameterData(0)->getPointCount(), 1);
    int32 offset = -1;
    double value = 0;
    changes.getParameterData(0)->getPoint(0, offset, value);
    EXPECT_EQ(offset, 0);
    EXPECT_EQ(value, .3);
    EXPECT_FALSE(transfer.TransferChangesTo(changes));
}

TEST(ParameterChangeTransfer, MovesToChangesThatHoldSomeAlready)
{
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({4, 5});
    transfer.AddChange(4, .1, 0);
    ParameterChanges changes;
    AddPoint(changes, 5, 7, .7);
    AddPoint(changes, 4, 0, .9);
    EXPECT_TRUE(transfer.TransferChangesTo(changes));
    transfer.SetParameterIDs({5, 6});
    EXPECT_FALSE(transfer.TransferChangesTo(changes));
    for (const ParamID id : {5U, 6U})
        transfer.AddChange(id, .2, 0);
    EXPECT_TRUE(transfer.TransferChangesTo(changes));

    ASSERT_EQ(changes.getParameterCount(), 3);
    EXPECT_EQ(changes.getParameterData(0)->getParameterId(), 5U);
    EXPECT_EQ(changes.getParameterData(0)->getPointCount(), 2);
    EXPECT_EQ(changes.getParameterData(1)->getParameterId(), 4U);
    EXPECT_EQ(changes.getParameterData(1)->getPointCount(), 1);
    EXPECT_EQ(changes.getParameterData(2)->getParameterId(), 6U);
}

TEST(ParameterChangeTransfer, KeepsTheNewestHundred)
{
    for (const int count : {99, 100, 101, 250, 1000})
    {
        SCOPED_TRACE(count);
        ParameterChangeTransfer transfer;
        transfer.SetParameterIDs({4, 5});
        for (int change = 0; change < count; ++change)
            transfer.AddChange(4, change, 0);
        transfer.AddChange(5, -1, 0);
        const std::vector<double> values = TakeValues(transfer, 4);
        const int kept = std::min(count, 100);
        ASSERT_EQ(values.size(), static_cast<std::size_t>(kept));
        for (int index = 0; index < kept; ++index)
            EXPECT_EQ(values[static_cast<std::size_t>(index)], count - kept + index);
        EXPECT_EQ(TakeValues(transfer, 5), std::vector<double>{-1});
    }
}

TEST(ParameterChangeTransfer, IgnoresUnknownIDs)
{
    ParameterChangeTransfer transfer;
    transfer.AddChange(4, .5, 0);
    transfer.SetParameterIDs({3, 5});
    transfer.AddChange(4, .5, 0);
    EXPECT_FALSE(transfer.HasChanges());
    ParameterChanges changes;
    EXPECT_FALSE(transfer.TransferChangesTo(changes));
    double value = .25;
    int32 offset = 9;
    for (const ParamID id : {ParamID(4), ParamID(3), std::numeric_limits<ParamID>::max()})
        EXPECT_FALSE(transfer.GetNextChange(id, value, offset));
    EXPECT_EQ(value, .25);
    EXPECT_EQ(offset, 9);
}

TEST(ParameterChangeTransfer, DeliversByAscendingIDAndOldestFirst)
{
    // IDs as plug-ins have them: hashes, steps, the largest; enough of them for every level of the set of written
    // ones.
    std::vector<ParamID> ids = {0xffffffff, 0, 0x80000000};
    for (ParamID id = 1; id < 5000; ++id)
        ids.push_back(id * 65536);
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs(ids);
    const ParamID written[] = {0xffffffff, 65536 * 4999U, 65536, 65536 * 64U, 0, 0x80000000};
    for (const ParamID id : written)
    {
        transfer.AddChange(id, .1, 7);
        transfer.AddChange(id, .2, 3);
    }
    ParameterChanges changes;
    EXPECT_TRUE(transfer.TransferChangesTo(changes));
    const std::vector<ParamID> expected = {0, 65536, 65536 * 64, 65536 * 4999, 0x80000000, 0xffffffff};
    ASSERT_EQ(changes.getParameterCount(), static_cast<int32>(expected.size()));
    for (std::size_t index = 0; index < expected.size(); ++index)
    {
        auto* queue = changes.getParameterData(static_cast<int32>(index));
        EXPECT_EQ(queue->getParameterId(), expected[index]);
        EXPECT_EQ(queue->getPointCount(), 2);
    }
    EXPECT_FALSE(transfer.HasChanges());
}

TEST(ParameterChangeTransfer, CarriesValuesAndOffsetsBitForBit)
{
    const double values[] = {-0., 1e-310, std::numeric_limits<double>::infinity(), 1. / 3., -1e300};
    const int32 offsets[] = {0, -1, std::numeric_limits<int32>::min(), std::numeric_limits<int32>::max(), 1023};
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({1});
    for (std::size_t index = 0; index < std::size(values); ++index)
        transfer.AddChange(1, values[index], offsets[index]);
    for (std::size_t index = 0; index < std::size(values); ++index)
    {
        double value = 0;
        int32 offset = 0;
        ASSERT_TRUE(transfer.GetNextChange(1, value, offset));
        EXPECT_EQ(std::signbit(value), std::signbit(values[index]));
        EXPECT_EQ(value, values[index]);
        EXPECT_EQ(offset, offsets[index]);
    }
}

TEST(ParameterChangeTransfer, NewIDsDropWhatIsPending)
{
    for (const std::vector<ParamID>& ids : {std::vector<ParamID>{1, 2}, {2, 1, 1}, {1, 2, 3}, {1}})
    {
        ParameterChangeTransfer transfer;
        transfer.SetParameterIDs({1, 2});
        transfer.AddChange(1, .5, 0);
        transfer.SetParameterIDs(ids);
        ParameterChanges changes;
        EXPECT_FALSE(transfer.TransferChangesTo(changes));
        transfer.AddChange(1, .25, 0);
        EXPECT_EQ(TakeValues(transfer, 1), std::vector<double>{.25});
    }
}

TEST(ParameterChangeTransfer, TransferChangesFromReadsEveryPoint)
{
    ParameterChanges changes;
    AddPoint(changes, 1, 5, .1);
    AddPoint(changes, 1, 9, .2);
    AddPoint(changes, 8, 0, .3);
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({1});
    EXPECT_TRUE(transfer.TransferChangesFrom(changes));
    EXPECT_EQ(TakeValues(transfer, 1), (std::vector<double>{.1, .2}));

    ParameterChanges unknownOnly;
    AddPoint(unknownOnly, 8, 0, .3);
    EXPECT_TRUE(transfer.TransferChangesFrom(unknownOnly)) << "a point was read, although nothing is kept of it";
    EXPECT_FALSE(transfer.HasChanges());

    ParameterChanges empty;
    int32 index = 0;
    empty.addParameterData(1, index);
    EXPECT_FALSE(transfer.TransferChangesFrom(empty)) << "a queue without points";
}

TEST(ParameterChangeTransfer, CopyToCarriesWhatIsPending)
{
    ParameterChangeTransfer source;
    source.SetParameterIDs({1, 2, 3});
    source.AddChange(3, .3, 0);
    for (int change = 0; change < 105; ++change)
        source.AddChange(1, change, change);
    source.CopyTo(source);
    ParameterChangeTransfer copy;
    copy.SetParameterIDs({9});
    copy.AddChange(9, 1, 0);
    source.CopyTo(copy);
    EXPECT_EQ(TakeValues(copy, 9), std::vector<double>()) << "the copy has the source's IDs";
    for (ParameterChangeTransfer* transfer : {&source, &copy})
    {
        EXPECT_TRUE(transfer->HasChanges());
        const std::vector<double> values = TakeValues(*transfer, 1);
        ASSERT_EQ(values.size(), 100U);
        EXPECT_EQ(values.front(), 5);
        EXPECT_EQ(values.back(), 104);
        EXPECT_EQ(TakeValues(*transfer, 3), std::vector<double>{.3});
        EXPECT_EQ(TakeValues(*transfer, 2), std::vector<double>());
        EXPECT_FALSE(transfer->HasChanges());
    }
}

TEST(ParameterChangeTransfer, HasChangesFollowsBothWaysOfReading)
{
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({1, 2, 5000});
    EXPECT_FALSE(transfer.HasChanges());
    transfer.AddChange(1, .5, 0);
    transfer.AddChange(5000, .5, 0);
    EXPECT_EQ(TakeValues(transfer, 1).size(), 1U);
    EXPECT_TRUE(transfer.HasChanges());
    EXPECT_EQ(TakeValues(transfer, 5000).size(), 1U);
    EXPECT_FALSE(transfer.HasChanges());
    transfer.AddChange(2, .5, 0);
    ParameterChanges changes;
    EXPECT_TRUE(transfer.TransferChangesTo(changes));
    EXPECT_FALSE(transfer.HasChanges());
}

} // namespace

} // namespace zebaudiofilterhost::vst3
