// A plug-in whose list of parameters grows while audio runs: the process thread goes on without an allocation, and
// changes of the new parameters reach it.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3PluginModule.h"

#include "foundation/zebcore/NativePath.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <chrono>
#include <thread>

namespace zebaudiofilterhost::vst3
{
namespace
{

constexpr int kFrames = 16;
constexpr int kFirstCount = 10;
constexpr int kLastCount = 300;
constexpr int kStep = 10;
constexpr unsigned int kFirstID = 100000; // of the fixture's first parameter; each later one has an ID one smaller

class GrowingParameters : public ::testing::Test
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        mRecorder.Set("parameterCount", kFirstCount);
        mRecorder.SetRecording(false);
        const auto path = zebcore::filesupport::FromNativePath(zebtest::FixtureBundle("ManyParameters").string());
        const auto module = GetVST3Plugin(path);
        std::vector<UTF16String> ids;
        ASSERT_TRUE(module && module->GetPluginInfo(ids) && !ids.empty());
        mFilter = module->CreateVST3AudioFilter(ids.front());
        ASSERT_TRUE(mFilter);
        mFilter->SetSampleRate(48000.0F);
        mFilter->SetBlockSize(kFrames);
    }

    ~GrowingParameters() override
    {
        mFilter.reset();
        mRecorder.SetRecording(true);
        mRecorder.Reset();
    }

    // The process thread.
    void ProcessBlocks()
    {
        std::array<std::array<float, kFrames>, 4> buffers{};
        std::array<float*, 2> in = {buffers[0].data(), buffers[1].data()};
        std::array<float*, 2> out = {buffers[2].data(), buffers[3].data()};
        while (!mDone)
        {
            {
                ChannelFlags silent;
                const realtimeguard::Section section;
                mFilter->ProcessWithMapping(in.data(), out.data(), kFrames, ChannelFlags(), silent);
            }
            ++mBlocks;
            while (mHold && !mDone)
            {
                mIsHeld = true;
                std::this_thread::yield();
            }
            mIsHeld = false;
        }
    }

    template <class Condition>
    static bool WaitFor(const Condition& condition)
    {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
        while (!condition())
        {
            if (std::chrono::steady_clock::now() > deadline)
                return false;
            std::this_thread::yield();
        }
        return true;
    }

    // A thread of the plug-in's own. Each time, one block gets a change of every parameter that there is.
    void Grow()
    {
        int edits = 0;
        for (int count = kFirstCount; count <= kLastCount && mArrive; count += kStep)
        {
            mRecorder.Set("parameterCount", count);
            mFilter->restartComponent(Steinberg::Vst::kParamTitlesChanged);
            mHold = true;
            mArrive = WaitFor([this] { return mIsHeld.load(); });
            for (int index = 0; index < count; ++index)
                mFilter->performEdit(kFirstID - static_cast<unsigned int>(index), count / 1000.0);
            edits += count;
            mHold = false;
            mArrive = mArrive && WaitFor([&] { return mRecorder.Get("pointsSeen") >= edits; });
            mArrive = mArrive && WaitFor([this] { return !mIsHeld; });
        }
        mEdits = edits;
        mDone = true;
    }

    const zebtest::FixtureRecorder mRecorder = zebtest::RecorderOf(zebtest::FixtureBundle("ManyParameters"));
    boost::intrusive_ptr<VST3AudioFilter> mFilter;
    std::atomic<bool> mDone{false};
    std::atomic<bool> mHold{false};
    std::atomic<bool> mIsHeld{false};
    std::atomic<bool> mArrive{true};
    std::atomic<int> mBlocks{0};
    std::atomic<int> mEdits{0};
};

TEST_F(GrowingParameters, NeedNoMemoryOnTheProcessThreadAndArrive)
{
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    mFilter->Resume();
    std::thread process([this] { ProcessBlocks(); });
    std::thread plugin([this] { Grow(); });
    while (!mDone)
        mFilter->OnUITimerTick();
    plugin.join();
    process.join();
    mFilter->Suspend();
    EXPECT_TRUE(mArrive) << "after " << mRecorder.Get("pointsSeen") << " changes";
    EXPECT_EQ(mRecorder.Get("pointsSeen"), mEdits);
    EXPECT_EQ(mRecorder.Get("pointSeenLast"), kFirstID) << "they come by ID, the smallest first";
    EXPECT_EQ(mFilter->GetParameterCount(), kLastCount);
    EXPECT_GE(mBlocks, (kLastCount - kFirstCount) / kStep);
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
}

} // namespace
} // namespace zebaudiofilterhost::vst3
