#include "utility/DelayLine.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <array>
#include <vector>

namespace zebaudiofilterhost
{
namespace
{

// Two channels of never repeating samples; the second is the negative of the first.
class Source
{
public:
    float** Next(unsigned int frames)
    {
        for (auto& channel : mChannels)
            channel.resize(frames);
        for (unsigned int i = 0; i < frames; ++i)
        {
            const auto sample = static_cast<float>(++mCount);
            mChannels[0][i] = sample;
            mChannels[1][i] = -sample;
        }
        mPointers = {mChannels[0].data(), mChannels[1].data()};
        return mPointers.data();
    }

private:
    int mCount = 0;
    std::array<std::vector<float>, 2> mChannels;
    std::array<float*, 2> mPointers{};
};

struct Case
{
    unsigned int bufferSize;
    unsigned int delay;
    std::vector<unsigned int> blocks; // Sizes, over and over
};

class DelayLineRun : public ::testing::TestWithParam<Case>
{
};

TEST_P(DelayLineRun, GivesBackWhatWasWrittenDelayFramesAgo)
{
    const Case& run = GetParam();
    boost::intrusive_ptr<DelayLine> line(new DelayLine(run.bufferSize, run.delay, 2));
    Source source;
    int position = -static_cast<int>(run.delay);
    for (int round = 0; round < 200; ++round)
    {
        const unsigned int frames = run.blocks[static_cast<std::size_t>(round) % run.blocks.size()];
        line->WriteData(source.Next(frames), frames);
        // First, since the other fills the room past the ring's end
        std::vector<float> copied(frames + 1, 0.5F);
        ASSERT_TRUE(line->CopyDelayedOutput(1, frames, copied.data()));
        ASSERT_EQ(copied[frames], 0.5F);
        float** const out = line->GetDelayedOutput(frames);
        ASSERT_NE(out, nullptr);
        for (unsigned int i = 0; i < frames; ++i)
        {
            ++position;
            const float expected = position > 0 ? static_cast<float>(position) : 0.0F;
            ASSERT_EQ(out[0][i], expected) << "block " << round << ", frame " << i;
            ASSERT_EQ(out[1][i], -expected);
            ASSERT_EQ(copied[i], -expected);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Shapes, DelayLineRun,
                         ::testing::Values(Case{8, 0, {8}}, Case{8, 0, {3, 5, 8}}, Case{3, 5, {3}},
                                           Case{4, 5, {3, 4, 1}}, Case{64, 1000, {64}}, Case{64, 1, {64, 63}},
                                           Case{16, 16, {16}}, Case{16, 7, {1}}, Case{5, 2, {5, 0, 2}}));

boost::intrusive_ptr<DelayLine> LineWithSamples(unsigned int delay)
{
    boost::intrusive_ptr<DelayLine> line(new DelayLine(4, delay, 2));
    Source source;
    line->WriteData(source.Next(4), 4);
    return line;
}

TEST(DelayLine, BlockAboveTheBufferSizeChangesNothing)
{
    const auto line = LineWithSamples(0);
    Source source;
    line->WriteData(source.Next(5), 5);
    EXPECT_EQ(line->GetDelayedOutput(4)[0][3], 4.0F);
}

TEST(DelayLine, ABlockAboveTheBufferSizeIsReadForAsFarAsTheLineReaches)
{
    const auto line = LineWithSamples(10);
    Source source;
    for (const unsigned int frames : {4U, 4U, 2U})
        line->WriteData(source.Next(frames), frames);
    // At the ring's end: 14 frames, of which 10 wait.
    std::array<float, 15> copied{};
    for (unsigned int frames = 5; frames <= 14; ++frames)
    {
        float** const out = line->GetDelayedOutput(frames);
        ASSERT_NE(out, nullptr) << frames;
        ASSERT_TRUE(line->CopyDelayedOutput(1, frames, copied.data())) << frames;
        EXPECT_EQ(out[0][frames - 1], 4.0F) << frames;
        for (unsigned int i = 0; i < frames; ++i)
            EXPECT_EQ(copied[i], out[1][i]) << frames;
    }
    for (const unsigned int frames : {19U, 0x7fffffffU, 0xffffffffU})
    {
        EXPECT_EQ(line->GetDelayedOutput(frames), nullptr) << frames;
        EXPECT_FALSE(line->CopyDelayedOutput(1, frames, copied.data())) << frames;
    }
}

TEST(DelayLine, SameBufferSizeKeepsTheContentAndAnyDelayEmptiesIt)
{
    const auto line = LineWithSamples(0);
    EXPECT_TRUE(line->SetBufferSize(4));
    EXPECT_EQ(line->GetDelayedOutput(4)[0][3], 4.0F);
    EXPECT_TRUE(line->SetDelay(0));
    Source source;
    line->WriteData(source.Next(2), 2);
    EXPECT_EQ(line->GetDelayedOutput(4)[0][0], 0.0F); // Beyond what was written since
    EXPECT_TRUE(line->SetBufferSize(5));
    line->WriteData(source.Next(5), 5);
    EXPECT_EQ(line->GetDelayedOutput(5)[0][4], 7.0F);
}

TEST(DelayLine, OldSamplesReappearUnlessResetClearsThem)
{
    for (const bool clear : {false, true})
    {
        boost::intrusive_ptr<DelayLine> line(new DelayLine(4, 4, 2));
        Source source;
        line->WriteData(source.Next(4), 4);
        line->WriteData(source.Next(4), 4);
        line->Reset(clear);
        line->WriteData(source.Next(2), 2);
        EXPECT_EQ(line->GetDelayedOutput(2)[0][0], clear ? 0.0F : 5.0F); // Four frames before the start
    }
}

TEST(DelayLine, InvalidLineIsHarmless)
{
    DelayLine empty;
    Source source;
    empty.WriteData(source.Next(1), 1);
    EXPECT_EQ(empty.GetDelayedOutput(1), nullptr);
    EXPECT_FALSE(empty.CopyDelayedOutput(0, 1, nullptr));

    DelayLine tooLarge(1U << 31, 1U << 31, 64); // More than the counts can say
    tooLarge.WriteData(source.Next(1), 1);
    EXPECT_EQ(tooLarge.GetDelayedOutput(1), nullptr);
    EXPECT_FALSE(tooLarge.SetDelay(1U << 31));
    EXPECT_FALSE(tooLarge.SetBufferSize(1U << 31));

    const auto deleted = LineWithSamples(0);
    EXPECT_FALSE(deleted->CopyDelayedOutput(2, 4, nullptr)); // No such channel
    deleted->DeleteAudioBuffer();
    EXPECT_EQ(deleted->GetDelayedOutput(1), nullptr);
    EXPECT_FALSE(deleted->CopyDelayedOutput(0, 1, nullptr));
    EXPECT_TRUE(deleted->SetBufferSize(4)); // The same size, but there is no storage to keep
    EXPECT_NE(deleted->GetDelayedOutput(4), nullptr);
}

} // namespace
} // namespace zebaudiofilterhost
