#include "audiofilter/AudioFilterProxy.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterFactory.h"
#include "tests/audiofilter/RecordingFilter.h"
#include "utility/EffectUtils.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost
{
namespace
{

using testing::MakeFilter;
using testing::MakeMap;
using testing::RecordingFilter;

// A catalogue that can make recording filters with two parameters.
class AudioFilterCloneTest : public ::testing::Test
{
protected:
    static void SetUpTestSuite()
    {
        InitializeMainThreadID();
        const Guid guid = Guid::CreateUnique();
        AudioFilterFactory::GetInstance().RegisterFactoryFunction(guid,
                                                                  [](const UTF16String&)
                                                                  {
                                                                      auto filter = MakeFilter({1}, {1});
                                                                      filter->mParameters.resize(2);
                                                                      return boost::intrusive_ptr<AudioFilter>(
                                                                          filter);
                                                                  });
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(
            boost::intrusive_ptr<AudioFilterDescriptor>(
                new AudioFilterDescriptor(u"Recording", 1, AudioFilterCategory(), u"1:recording", guid, false)));
    }

    static boost::intrusive_ptr<RecordingFilter> AsRecording(const boost::intrusive_ptr<AudioFilter>& filter)
    {
        return dynamic_cast<RecordingFilter*>(filter.get());
    }
};

TEST_F(AudioFilterCloneTest, CarriesBusesRateSettingsMapsAndPresetName)
{
    const auto filter = MakeFilter({2, 1}, {2});
    filter->mParameters = {0.25F, 0.5F};
    filter->SetSampleRate(48000.0F);
    filter->SetMainTargetBus(testing::MakeBus(6));
    filter->SetSideChainTargetBus(testing::MakeBus(1));
    filter->SetUseChannelMap(true);
    filter->SetChannelMap(MakeMap(3, {{2, 0}}), AudioFilter::kDirection_Input);
    filter->SetChannelMap(MakeMap(2, {{1, 1}}), AudioFilter::kDirection_Output);
    filter->SetPresetNameAndDirtyState({u"Warm", true});

    const auto clone = AsRecording(filter->Clone());
    ASSERT_TRUE(clone);
    EXPECT_EQ(clone->GetInputBuses().size(), 2U);
    EXPECT_EQ(clone->GetNumberOfInputChannels(), 3);
    EXPECT_EQ(clone->mParameters, filter->mParameters);
    struct Probe : public RecordingFilter
    {
        using RecordingFilter::mSampleRate;
    };
    EXPECT_EQ((*clone).*(&Probe::mSampleRate), 48000.0F);
    EXPECT_TRUE(clone->GetUseChannelMap());
    EXPECT_TRUE(clone->GetChannelMap(AudioFilter::kDirection_Input) ==
                filter->GetChannelMap(AudioFilter::kDirection_Input));
    EXPECT_TRUE(clone->GetChannelMap(AudioFilter::kDirection_Output) ==
                filter->GetChannelMap(AudioFilter::kDirection_Output));
    EXPECT_TRUE(clone->GetMainTargetBus() == filter->GetMainTargetBus());
    EXPECT_TRUE(clone->GetSideChainTargetBus() == filter->GetSideChainTargetBus());
    EXPECT_TRUE(clone->GetPresetNameAndDirtyState() == filter->GetPresetNameAndDirtyState());
}

// Has no bus ahead of its first request, of one layout for each side; then a fixed number of such buses.
class LateFilter : public AudioFilter
{
public:
    explicit LateFilter(int inputs)
        : AudioFilter(inputs == 0 ? u"1:late generator" : u"1:late mixer", u""), mInputs(inputs)
    {
    }
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override
    {
        if (inputs.size() != 1 || outputs.size() != 1)
            return;
        ClearBusConfiguration();
        for (int bus = 0; bus < mInputs; ++bus)
            AddInputBus(AudioFilterBusDescription(u"", inputs[0], AudioFilterBusDescription::kBusType_Main));
        AddOutputBus(AudioFilterBusDescription(u"", outputs[0], AudioFilterBusDescription::kBusType_Main));
    }

private:
    int mInputs;
};

TEST_F(AudioFilterCloneTest, GetsBusesOfAPluginThatTakesOneLayoutForEachSide)
{
    for (const int inputs : {0, 2})
    {
        const Guid guid = Guid::CreateUnique();
        AudioFilterFactory::GetInstance().RegisterFactoryFunction(
            guid, [inputs](const UTF16String&) { return boost::intrusive_ptr<AudioFilter>(new LateFilter(inputs)); });
        const boost::intrusive_ptr<AudioFilter> filter(new LateFilter(inputs));
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(
            new AudioFilterDescriptor(u"Late", 1, AudioFilterCategory(), filter->GetID(), guid, false));
        EXPECT_TRUE(filter->Clone()->GetOutputBuses().empty()) << "it had none";
        filter->RequestIOConfiguration({ChannelLayout(2)}, {ChannelLayout(2)});
        const boost::intrusive_ptr<AudioFilterProxy> proxy(new AudioFilterProxy(filter));
        for (const auto& copy : {filter->Clone(), proxy->CreateAudioFilterFromZombieState()})
        {
            EXPECT_EQ(copy->GetInputBuses().size(), static_cast<std::size_t>(inputs));
            EXPECT_EQ(copy->GetNumberOfOutputChannels(), 2);
        }
    }
}

TEST_F(AudioFilterCloneTest, LeavesBlockSizeNameAndFlagsBehind)
{
    const auto filter = MakeFilter({1}, {1});
    filter->mParameters.resize(2);
    filter->SetBlockSize(512);
    filter->SetDisplayName(u"Mine");
    filter->SetHasHighCPU(true);
    filter->SetUseChannelMap(true);
    filter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
    const auto clone = AsRecording(filter->Clone());
    ASSERT_TRUE(clone);
    EXPECT_TRUE(clone->GetDisplayName() == u"Recording");
    EXPECT_FALSE(clone->GetHasHighCPU());
    struct Probe : public RecordingFilter
    {
        using RecordingFilter::mBlockSize;
    };
    EXPECT_EQ((*clone).*(&Probe::mBlockSize), 0);
}

TEST_F(AudioFilterCloneTest, StaticCloneTakesQueuedParametersAlong)
{
    const auto filter = MakeFilter({1}, {1});
    filter->mParameters.resize(2);
    filter->PostSetParameter(1, 0.875F);
    const auto clone = AsRecording(AudioFilter::Clone(filter));
    ASSERT_TRUE(clone);
    EXPECT_EQ(clone->mParameters[1], 0.875F);
}

TEST_F(AudioFilterCloneTest, IsNullWhenTheFactoryDoesNotKnowTheFilter)
{
    boost::intrusive_ptr<AudioFilter> filter(new AudioFilter(u"1:gone", u"Gone"));
    EXPECT_FALSE(filter->Clone());
    EXPECT_FALSE(AudioFilter::Clone(filter));
}

} // namespace
} // namespace zebaudiofilterhost
