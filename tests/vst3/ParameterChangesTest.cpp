#include "host/src/VST3/src/ParameterChanges.h"

#include <gtest/gtest.h>

#include <limits>
#include <utility>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Points = std::vector<std::pair<Steinberg::int32, double>>;

Points PointsOf(Steinberg::Vst::IParamValueQueue& queue)
{
    Points points;
    for (Steinberg::int32 index = 0; index < queue.getPointCount(); ++index)
    {
        std::pair<Steinberg::int32, double> point;
        EXPECT_EQ(queue.getPoint(index, point.first, point.second), Steinberg::kResultOk);
        points.push_back(point);
    }
    return points;
}

PluginPtr<ParameterValueQueue> MakeQueue(Steinberg::Vst::ParamID id)
{
    return PluginPtr<ParameterValueQueue>::Adopt(new ParameterValueQueue(id));
}

TEST(ParameterValueQueue, KeepsPointsInOrderOfOffset)
{
    struct Case
    {
        const char* mName;
        Points mAdded;
        std::vector<Steinberg::int32> mIndices;
        Points mKept;
    };
    const Case cases[] = {
        {"later value of one offset wins", {{10, .1}, {5, .2}, {10, .3}}, {0, 0, 1}, {{5, .2}, {10, .3}}},
        {"appended", {{1, .1}, {2, .2}, {3, .3}}, {0, 1, 2}, {{1, .1}, {2, .2}, {3, .3}}},
        {"inserted", {{1, .1}, {9, .2}, {4, .3}}, {0, 1, 1}, {{1, .1}, {4, .3}, {9, .2}}},
        {"before the block", {{0, .1}, {-3, .2}}, {0, 0}, {{-3, .2}, {0, .1}}},
        {"first replaced", {{0, .1}, {2, .2}, {0, .3}}, {0, 1, 0}, {{0, .3}, {2, .2}}},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto queue = MakeQueue(7);
        std::vector<Steinberg::int32> indices;
        for (const auto& [offset, value] : test.mAdded)
        {
            Steinberg::int32 index = -1;
            EXPECT_EQ(queue->addPoint(offset, value, index), Steinberg::kResultOk);
            indices.push_back(index);
        }
        EXPECT_EQ(indices, test.mIndices);
        EXPECT_EQ(PointsOf(*queue), test.mKept);
    }
}

TEST(ParameterValueQueue, GrowsBeyondItsReserve)
{
    const auto queue = MakeQueue(7);
    Steinberg::int32 index = 0;
    for (Steinberg::int32 offset = 0; offset < 3 * kMaxPointsPerParameter; ++offset)
        queue->addPoint(offset, .5, index);
    EXPECT_EQ(queue->getPointCount(), 3 * kMaxPointsPerParameter);
    EXPECT_EQ(index, 3 * kMaxPointsPerParameter - 1);
}

TEST(ParameterValueQueue, RefusesIndicesOutOfRange)
{
    const auto queue = MakeQueue(7);
    Steinberg::int32 offset = 3;
    double value = .25;
    queue->addPoint(0, 1., offset);
    offset = 3;
    for (const Steinberg::int32 index : {-1, 1, std::numeric_limits<Steinberg::int32>::min()})
        EXPECT_EQ(queue->getPoint(index, offset, value), Steinberg::kResultFalse) << index;
    EXPECT_EQ(offset, 3);
    EXPECT_EQ(value, .25);
}

TEST(ParameterChanges, GivesOneQueueForEachID)
{
    ParameterChanges changes;
    Steinberg::int32 index = -1;
    auto* first = changes.addParameterData(30, index);
    EXPECT_EQ(index, 0);
    auto* second = changes.addParameterData(20, index);
    EXPECT_EQ(index, 1);
    first->addPoint(0, .5, index);
    EXPECT_EQ(changes.addParameterData(30, index), first);
    EXPECT_EQ(index, 0);
    EXPECT_EQ(first->getPointCount(), 1) << "a queue in use keeps its points";
    EXPECT_NE(first, second);
    EXPECT_EQ(changes.getParameterCount(), 2);
    EXPECT_EQ(changes.getParameterData(1), second);
}

TEST(ParameterChanges, ReusesQueuesAfterClear)
{
    ParameterChanges changes;
    Steinberg::int32 index = 0;
    auto* queue = changes.addParameterData(30, index);
    queue->addPoint(0, .5, index);
    changes.ClearQueue();
    EXPECT_EQ(changes.getParameterCount(), 0);
    EXPECT_EQ(changes.getParameterData(0), nullptr);
    EXPECT_EQ(changes.addParameterData(40, index), queue);
    EXPECT_EQ(queue->getParameterId(), 40U);
    EXPECT_EQ(queue->getPointCount(), 0);
}

TEST(ParameterChanges, SetMaxParametersMakesAndDropsQueues)
{
    ParameterChanges changes;
    changes.SetMaxParameters(3);
    EXPECT_EQ(changes.getParameterCount(), 0);
    Steinberg::int32 index = 0;
    auto* first = changes.addParameterData(1, index);
    changes.addParameterData(2, index);
    changes.SetMaxParameters(-1);
    EXPECT_EQ(changes.getParameterCount(), 2);
    changes.SetMaxParameters(1);
    EXPECT_EQ(changes.getParameterCount(), 1);
    EXPECT_EQ(changes.getParameterData(0), first);
    EXPECT_EQ(changes.getParameterData(1), nullptr);
    changes.SetMaxParameters(0);
    EXPECT_EQ(changes.getParameterCount(), 0);
}

TEST(ParameterChanges, AnswersForItsInterfaceOnly)
{
    ParameterChanges changes;
    void* object = nullptr;
    EXPECT_EQ(changes.queryInterface(Steinberg::Vst::IParameterChanges::iid, &object), Steinberg::kResultOk);
    EXPECT_EQ(object, &changes);
    EXPECT_EQ(changes.release(), 1U) << "the query added a reference";
    EXPECT_EQ(changes.queryInterface(Steinberg::Vst::IParamValueQueue::iid, &object), Steinberg::kNoInterface);
    EXPECT_EQ(object, nullptr);
}

TEST(ParameterChanges, AQueueOutlivesItsOwnerWhileAPluginHoldsIt)
{
    PluginPtr<Steinberg::Vst::IParamValueQueue> held;
    {
        ParameterChanges changes;
        Steinberg::int32 index = 0;
        held = PluginPtr<Steinberg::Vst::IParamValueQueue>::Retain(changes.addParameterData(5, index));
    }
    EXPECT_EQ(held->getParameterId(), 5U);
}

} // namespace

} // namespace zebaudiofilterhost::vst3
