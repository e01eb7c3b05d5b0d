// Parameter changes that wait for the processor go along into a clone.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/hosted/HostedPlugin.h"

#include <gtest/gtest.h>

namespace
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::PresetData;
using zebaudiofilterhost::PropList;
using zebaudiofilterhost::vst3::VST3AudioFilter;
using zebtest::FilterPtr;

constexpr Steinberg::Vst::ParamID kGain = 0;
constexpr double kQuarter = 0.6245708351400078; // normalised, of -72 dB to 24 dB: a gain of 0.25
constexpr float kInput = 0.5F;                  // what RunBlocks sends

class CloneOfGain : public testing::Test
{
protected:
    static void SetUpTestSuite() { zebaudiofilterhost::Initialize(); }
    static void TearDownTestSuite() { zebaudiofilterhost::Terminate(); }

    // As the plug-in's editor does it.
    static void Edit(AudioFilter& filter, double value)
    {
        auto& plugin = dynamic_cast<VST3AudioFilter&>(filter);
        EXPECT_EQ(plugin.performEdit(kGain, value), Steinberg::kResultOk);
    }

    // The plug-in's own bytes.
    static std::vector<unsigned char> State(const AudioFilter& filter)
    {
        PropList list;
        PresetData preset(list);
        filter.SaveSettings(preset);
        std::vector<unsigned char> chunk;
        EXPECT_TRUE(preset.GetChunkData(chunk));
        return chunk;
    }

    static float Gain(AudioFilter& filter) { return zebtest::RunBlocks(filter, 2, 64)[0][63] / kInput; }

    const FilterPtr mFilter = zebtest::MakeFilter(zebtest::EffectBundle("ZebGain"));
    const FilterPtr mChanged = zebtest::MakeFilter(zebtest::EffectBundle("ZebGain"));
};

TEST_F(CloneOfGain, GetsTheChangesThatWait)
{
    ASSERT_TRUE(mFilter && mChanged);
    Edit(*mChanged, kQuarter);
    mChanged->FlushMessageQueue();
    ASSERT_NE(State(*mChanged), State(*mFilter));

    Edit(*mFilter, kQuarter);
    const AudioFilter& source = *mFilter;
    const FilterPtr clone = source.Clone();
    const FilterPtr second = source.Clone();
    ASSERT_TRUE(clone && second);
    EXPECT_NE(State(*clone), State(*mChanged)) << "the change waits in the clone, too";
    clone->FlushMessageQueue();
    EXPECT_EQ(State(*clone), State(*mChanged));
    EXPECT_NEAR(Gain(*clone), 0.25F, 1e-4F);
    EXPECT_NEAR(Gain(*second), 0.25F, 1e-4F) << "the first block delivers it as well";
    EXPECT_NEAR(Gain(*mFilter), 0.25F, 1e-4F) << "the source keeps its own";
}

TEST_F(CloneOfGain, GoesItsOwnWayAfterwards)
{
    ASSERT_TRUE(mFilter);
    Edit(*mFilter, kQuarter);
    const AudioFilter& source = *mFilter;
    const FilterPtr clone = source.Clone();
    ASSERT_TRUE(clone);
    Edit(*clone, 0.75);
    EXPECT_NEAR(Gain(*clone), 1.0F, 1e-4F);
    EXPECT_NEAR(Gain(*mFilter), 0.25F, 1e-4F);
}

} // namespace
