#include "host/src/VST/src/VSTDispatcherBase.h"

#include "tests/vst/support/FakeEffect.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::FakeEffect;

TEST(VSTDispatcherBase, PassesAllArgumentsAndTheAnswer)
{
    FakeEffect fake;
    int target = 0;
    const auto address = reinterpret_cast<long long>(&target); // more than 32 bits
    fake.Return(effSetChunk, address);
    const VSTDispatcherBase dispatcher(fake.Get());
    EXPECT_EQ(dispatcher.Dispatcher(effSetChunk, -7, address, &target, 0.25F), address);
    ASSERT_EQ(fake.Calls().size(), 1U);
    const fakeeffect::Call call = fake.Calls().front();
    EXPECT_EQ(call.opcode, effSetChunk);
    EXPECT_EQ(call.index, -7);
    EXPECT_EQ(call.value, address);
    EXPECT_EQ(call.ptr, &target);
    EXPECT_EQ(call.opt, 0.25F);
}

TEST(VSTDispatcherBase, NothingThereAndNothingThrownReachesTheCaller)
{
    FakeEffect fake;
    fake.Throw(effOpen);
    fake.On(effIdle, [](int, long long, void*, float) -> long long { throw 5; });
    const VSTDispatcherBase dispatcher(fake.Get());
    EXPECT_EQ(dispatcher.Dispatcher(effOpen, 0, 0, nullptr, 0), 0);
    EXPECT_EQ(dispatcher.Dispatcher(effIdle, 0, 0, nullptr, 0), 0);
    EXPECT_EQ(fake.Count("effOpen"), 1U);
    EXPECT_EQ(VSTDispatcherBase(nullptr).Dispatcher(effOpen, 0, 0, nullptr, 0), 0);
    fake.effect.dispatcher = nullptr;
    EXPECT_EQ(dispatcher.Dispatcher(effOpen, 0, 0, nullptr, 0), 0);
}

} // namespace

} // namespace zebaudiofilterhost::vst
