#include "audiofilter/AudioFilterProxy.h"

#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterFactory.h"
#include "tests/audiofilter/RecordingFilter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <utility>
#include <vector>

namespace zebaudiofilterhost
{
namespace
{

using testing::Buffers;
using ::testing::ElementsAre;
using testing::MakeBus;
using testing::MakeMap;
using testing::RecordingFilter;

using ProxyPtr = boost::intrusive_ptr<AudioFilterProxy>;

const UTF16String kID = u"3:sleeper";
constexpr auto kUnit = AudioFilterParameterInfoUnit(4);

std::vector<std::string> sLog; // What was asked of live filters, in order

// A filter that tells what is asked of it, and whose second parameter has no description.
class LiveFilter : public RecordingFilter
{
public:
    LiveFilter() : RecordingFilter({2, 1}, {2})
    {
        mFilterID = kID;
        mDisplayName = u"Sleeper";
        mParameters = {0.25F, 0.5F, 0.75F};
    }

    void SetSampleRate(float sampleRate) override
    {
        sLog.push_back("rate " + std::to_string(static_cast<int>(sampleRate)));
        AudioFilter::SetSampleRate(sampleRate);
    }
    void Resume() override
    {
        sLog.emplace_back("resume");
        AudioFilter::Resume();
    }
    void SetBlockSize(int frames) override
    {
        sLog.push_back("block " + std::to_string(frames));
        AudioFilter::SetBlockSize(frames);
    }
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override
    {
        sLog.push_back("buses " + std::to_string(inputs.size()) + " " + std::to_string(outputs.size()));
        RecordingFilter::RequestIOConfiguration(inputs, outputs);
    }
    bool LoadSettings(const PresetData& preset) override
    {
        sLog.emplace_back("settings");
        return AudioFilter::LoadSettings(preset);
    }
    float GetParameter(int index) const override
    {
        sLog.push_back("value " + std::to_string(index));
        return RecordingFilter::GetParameter(index);
    }
    boost::intrusive_ptr<AudioFilterParameterInfo> GetParameterInfo(int index) const override
    {
        sLog.push_back("info " + std::to_string(index));
        if (index == 1)
            return nullptr;
        return new GenericParameterInfo(u"Name", u"dB", kUnit, index, -60.0F, 6.0F, index == 0, true, 2, 3);
    }
};

// A catalogue that can make live filters, as long as their plug-in is there.
class AudioFilterProxyTest : public ::testing::Test
{
protected:
    AudioFilterProxyTest()
    {
        mFactory.RegisterFactoryFunction(mGuid, [](const UTF16String&)
                                         { return boost::intrusive_ptr<AudioFilter>(new LiveFilter); });
        sLog.clear();
    }

    ~AudioFilterProxyTest() override { AudioFilterDescriptorManager::GetInstance().ClearInfosForLocator(mLocator); }

    void InstallPlugin()
    {
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(
            new AudioFilterDescriptor(mLocator, u"Sleeper", u"V", 1, AudioFilterCategory(), kID, mGuid, false));
    }

    static boost::intrusive_ptr<LiveFilter> MakeConfigured()
    {
        boost::intrusive_ptr<LiveFilter> filter(new LiveFilter);
        filter->SetSampleRate(96000.0F);
        filter->SetBlockSize(256);
        filter->SetMainTargetBus(MakeBus(4));
        filter->SetUseChannelMap(true);
        filter->SetChannelMap(MakeMap(4, {{3, 0}, {2, 1}}), AudioFilter::kDirection_Input);
        filter->SetChannelMap(MakeMap(4, {{1, 0}}), AudioFilter::kDirection_Output);
        filter->SetPresetNameAndDirtyState({u"Warm", true});
        sLog.clear();
        return filter;
    }

    AudioFilterFactory& mFactory = AudioFilterFactory::GetInstance();
    const Guid mGuid = Guid::CreateUnique(); // Registrations last to the end of the process
    const PluginLocator mLocator{kTechnologyVST3, u"/sleeper.vst3"};
};

TEST_F(AudioFilterProxyTest, OfNothingButANameHasHiddenParameters)
{
    const ProxyPtr proxy(new AudioFilterProxy(kID, u"Gone", 2, true));
    EXPECT_TRUE(proxy->IsProxy());
    EXPECT_TRUE(proxy->GetID() == kID);
    EXPECT_TRUE(proxy->GetDisplayName() == u"Gone");
    EXPECT_TRUE(proxy->DoPresetsUseChunkData());
    EXPECT_EQ(proxy->GetParameterCount(), 2);
    for (int index = 0; index < 2; ++index)
    {
        EXPECT_EQ(proxy->GetParameter(index), 0.0F);
        const auto info = proxy->GetParameterInfo(index);
        ASSERT_TRUE(info);
        EXPECT_TRUE(info->GetName().empty() && info->GetLabel().empty());
        EXPECT_EQ(info->GetUnit(), AudioFilterParameterInfoUnit(0));
        EXPECT_FALSE(info->CanBeAutomated());
        EXPECT_FALSE(info->IsExposed());
        EXPECT_EQ(info->FromNormalized(0.0F), 0.0F);
        EXPECT_EQ(info->FromNormalized(0.5F), 0.5F);
        EXPECT_EQ(info->FromNormalized(1.0F), 1.0F);
    }
    EXPECT_EQ(ProxyPtr(new AudioFilterProxy(kID, u"", 0, false))->GetParameterCount(), 0);
}

TEST_F(AudioFilterProxyTest, IndicesOutOfRangeChangeNothingButTheDirtyCount)
{
    const ProxyPtr proxy(new AudioFilterProxy(kID, u"Gone", 2, false));
    proxy->SetParameter(1, 0.5F);
    proxy->SetParameterDisplayName(1, u"Depth");
    for (const int index : {2, -1, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()})
    {
        SCOPED_TRACE(index);
        const unsigned int dirty = proxy->GetParameterDirtyCount();
        proxy->SetParameter(index, 1.0F);
        EXPECT_EQ(proxy->GetParameterDirtyCount(), dirty + 1);
        EXPECT_EQ(proxy->GetParameter(index), 0.0F);
        EXPECT_FALSE(proxy->GetParameterInfo(index));
        proxy->SetParameterDisplayName(index, u"Nobody");
    }
    EXPECT_EQ(proxy->GetParameterCount(), 2);
    EXPECT_EQ(proxy->GetParameter(0), 0.0F);
    EXPECT_EQ(proxy->GetParameter(1), 0.5F);
    EXPECT_TRUE(proxy->GetParameterInfo(0)->GetName().empty());
    EXPECT_TRUE(proxy->GetParameterInfo(1)->GetName() == u"Depth");
}

TEST_F(AudioFilterProxyTest, KeepsAnyPresetUninterpreted)
{
    const ProxyPtr proxy(new AudioFilterProxy(kID, u"Gone", 1, false));
    PropList first;
    first.SetValue(u8"Stale", 1);
    EXPECT_TRUE(proxy->LoadSettings(PresetData(first)));

    PropList list;
    PresetData preset(list);
    preset.SetVersion(99.0F);
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    preset.SetParamList({0.5F, 0.25F});
    preset.SetChunkData(std::vector<unsigned char>{1, 0, 255}.data(), 3);
    EXPECT_TRUE(proxy->LoadSettings(preset));
    EXPECT_EQ(proxy->GetParameter(0), 0.0F);

    PropList savedList;
    savedList.SetValue(u8"Stale", 2);
    PresetData saved(savedList);
    proxy->SaveSettings(saved);
    EXPECT_TRUE(saved == preset);
    std::list<float> params;
    saved.GetParamList(params);
    EXPECT_THAT(params, ElementsAre(0.5F, 0.25F));
    int stale = 0;
    EXPECT_FALSE(savedList.GetValue(u8"Stale", stale));

    // A copy: what becomes of the argument later is nothing to the proxy.
    preset.SetVersion(1.0F);
    proxy->SaveSettings(saved);
    EXPECT_EQ(saved.GetVersion(), 99.0F);
}

TEST_F(AudioFilterProxyTest, TakesOverALiveFilter)
{
    const auto filter = MakeConfigured();
    const ProxyPtr proxy(new AudioFilterProxy(filter));
    EXPECT_THAT(std::exchange(sLog, {}), ElementsAre("value 0", "value 1", "value 2", "value 0", "info 0", "value 1",
                                                     "info 1", "value 2", "info 2"));

    EXPECT_TRUE(proxy->GetID() == kID);
    EXPECT_TRUE(proxy->GetDisplayName() == u"Sleeper");
    EXPECT_FALSE(proxy->DoPresetsUseChunkData());
    EXPECT_EQ(proxy->GetInputBuses(), filter->GetInputBuses());
    EXPECT_EQ(proxy->GetOutputBuses(), filter->GetOutputBuses());
    EXPECT_EQ(proxy->GetMainTargetBus().GetChannelCount(),
              AudioFilter(u"", u"").GetMainTargetBus().GetChannelCount());
    EXPECT_TRUE(proxy->GetUseChannelMap());
    for (const auto direction : {AudioFilter::kDirection_Input, AudioFilter::kDirection_Output})
        EXPECT_TRUE(proxy->GetChannelMap(direction) == filter->GetChannelMap(direction));
    EXPECT_TRUE(proxy->GetPresetNameAndDirtyState() == filter->GetPresetNameAndDirtyState());

    ASSERT_EQ(proxy->GetParameterCount(), 3);
    for (int index = 0; index < 3; ++index)
    {
        SCOPED_TRACE(index);
        EXPECT_EQ(proxy->GetParameter(index), filter->GetParameter(index));
        const auto info = proxy->GetParameterInfo(index);
        EXPECT_TRUE(info->GetName().empty() && info->GetLabel().empty());
        EXPECT_EQ(info->GetUnit(), index == 1 ? AudioFilterParameterInfoUnit(0) : kUnit);
        EXPECT_EQ(info->CanBeAutomated(), index == 0);
        EXPECT_EQ(info->IsExposed(), index == 0);
        EXPECT_EQ(info->FromNormalized(1.0F), 1.0F);
    }

    PropList ofFilterList;
    PropList ofProxyList;
    PresetData ofFilter(ofFilterList);
    PresetData ofProxy(ofProxyList);
    filter->SaveSettings(ofFilter);
    proxy->SaveSettings(ofProxy);
    EXPECT_TRUE(ofProxy == ofFilter);
}

TEST_F(AudioFilterProxyTest, FilterWithoutParametersAndBuses)
{
    const boost::intrusive_ptr<AudioFilter> filter(new AudioFilter(u"3:bare", u"Bare"));
    const ProxyPtr proxy(new AudioFilterProxy(filter));
    EXPECT_EQ(proxy->GetParameterCount(), 0);
    EXPECT_FALSE(proxy->GetParameterInfo(0));
    EXPECT_TRUE(proxy->GetInputBuses().empty());
    EXPECT_FALSE(proxy->GetUseChannelMap());
}

TEST_F(AudioFilterProxyTest, GivesTheFilterBackWhenItsPluginIsThere)
{
    const ProxyPtr proxy(new AudioFilterProxy(MakeConfigured()));
    proxy->SetParameter(0, 1.0F);
    proxy->SetDisplayName(u"Renamed");
    EXPECT_FALSE(proxy->CreateAudioFilterFromZombieState());
    EXPECT_FALSE(proxy->Clone());

    InstallPlugin();
    sLog.clear();
    const auto revived = proxy->CreateAudioFilterFromZombieState();
    ASSERT_TRUE(revived);
    EXPECT_THAT(sLog, ElementsAre("rate 96000", "block 256", "buses 2 1", "settings")) << "and it stays suspended";
    EXPECT_FALSE(revived->IsProxy());
    EXPECT_EQ(revived->GetNumberOfInputChannels(), 3);
    EXPECT_EQ(revived->GetParameter(0), 0.25F) << "changes of the proxy's parameters are not settings";
    EXPECT_TRUE(revived->GetUseChannelMap());
    for (const auto direction : {AudioFilter::kDirection_Input, AudioFilter::kDirection_Output})
        EXPECT_TRUE(revived->GetChannelMap(direction) == proxy->GetChannelMap(direction));
    EXPECT_TRUE(revived->GetPresetNameAndDirtyState() == std::make_pair(UTF16String(u"Warm"), true));
    EXPECT_TRUE(revived->GetDisplayName() == u"Sleeper");
    EXPECT_EQ(proxy->GetParameter(0), 1.0F) << "the proxy stays as it was";
}

TEST_F(AudioFilterProxyTest, WithoutSettingsTheFilterKeepsItsDefaults)
{
    InstallPlugin();
    const ProxyPtr proxy(new AudioFilterProxy(kID, u"Gone", 3, false));
    const auto revived = proxy->CreateAudioFilterFromZombieState();
    ASSERT_TRUE(revived);
    EXPECT_EQ(revived->GetParameter(2), 0.75F);
    EXPECT_EQ(revived->GetNumberOfInputChannels(), 0) << "the layouts are those of the proxy's buses, which are none";
}

TEST_F(AudioFilterProxyTest, PlaysSilenceAndLetsOtherChannelsPass)
{
    constexpr int kFrames = 16;
    const ProxyPtr proxy(new AudioFilterProxy(MakeConfigured()));
    proxy->SetMainTargetBus(MakeBus(4));
    proxy->SetBlockSize(kFrames);
    proxy->Resume();
    Buffers in(4, kFrames);
    Buffers out(4, kFrames);
    in.Fill(0.5F);
    out.Fill(0.25F);
    ChannelFlags flags;
    proxy->ProcessWithMapping(in.Pointers(), out.Pointers(), kFrames, ChannelFlags(), flags);
    // Application channel 0 is connected to nothing, 1 is the output, 2 and 3 only feed the plug-in.
    EXPECT_FALSE(flags.IsSet(ChannelBit(0)));
    EXPECT_EQ(out.Channel(0)[kFrames - 1], 0.5F);
    for (const unsigned int channel : {1U, 2U, 3U})
        EXPECT_TRUE(flags.IsSet(ChannelBit(channel))) << channel;
    proxy->Suspend();
}

} // namespace
} // namespace zebaudiofilterhost
