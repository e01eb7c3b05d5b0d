// The example effects through the whole library give the samples that they give when they are called directly.
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "tests/plugins/vst2/direct/DirectVST2.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

constexpr int kFrames = 512;
constexpr int kBlocks = 20;

VST2Channels Noise(int block)
{
    VST2Channels noise(2, std::vector<float>(kFrames));
    auto state = static_cast<std::uint32_t>(block + 1);
    for (auto& channel : noise)
        for (float& sample : channel)
            sample =
                static_cast<float>(static_cast<std::int32_t>(state = state * 1664525U + 1013904223U)) / 2147483648.0F;
    return noise;
}

VST2Channels Through(AudioFilter& filter)
{
    filter.SetSampleRate(44100.0F);
    filter.SetBlockSize(kFrames);
    filter.Resume();
    VST2Channels all(2);
    for (int block = 0; block < kBlocks; ++block)
    {
        VST2Channels in = Noise(block);
        VST2Channels out(2, std::vector<float>(kFrames, 9.0F));
        float* inputs[] = {in[0].data(), in[1].data()};
        float* outputs[] = {out[0].data(), out[1].data()};
        ChannelFlags silent;
        filter.ProcessWithMapping(inputs, outputs, kFrames, ChannelFlags(), silent);
        for (std::size_t channel = 0; channel < 2; ++channel)
            all[channel].insert(all[channel].end(), out[channel].begin(), out[channel].end());
    }
    filter.Suspend();
    return all;
}

VST2Channels Directly(const char* effect, std::int32_t member, const std::vector<float>& parameters)
{
    DirectVST2 plugin(VST2Effect(effect), member);
    for (std::size_t i = 0; i < parameters.size(); ++i)
        plugin.effect->setParameter(plugin.effect, static_cast<std::int32_t>(i), parameters[i]);
    plugin.Resume(44100.0F, kFrames);
    VST2Channels all(2);
    for (int block = 0; block < kBlocks; ++block)
    {
        const VST2Channels out = plugin.Process(Noise(block));
        for (std::size_t channel = 0; channel < 2; ++channel)
            all[channel].insert(all[channel].end(), out[channel].begin(), out[channel].end());
    }
    return all;
}

struct Effect
{
    const char* file;
    std::vector<const char*> names;
    std::vector<float> parameters;
};

TEST_F(HostedVST2, TheExamplesGiveTheSamplesThatTheyGiveAlone)
{
    const Effect effects[] = {{"ZebGain2", {"ZebGain2"}, {0.5F}},
                              {"ZebGain2Plain", {"ZebGain2Plain"}, {0.6F}},
                              {"ZebEcho2", {"ZebEcho2"}, {0.05F, 0.5F, 0.5F}},
                              {"ZebPanel2", {"ZebPanel2"}, {0.9F}},
                              {"ZebShell2", {"Zeb Invert", "Zeb Swap", "Zeb Mono"}, {0.75F}}};
    for (const Effect& effect : effects)
    {
        const auto descriptors = Scan(VST2Effect(effect.file));
        ASSERT_EQ(descriptors.size(), effect.names.size()) << effect.file;
        for (std::size_t i = 0; i < descriptors.size(); ++i)
        {
            const UTF16String id = descriptors[i]->GetUniqueID();
            EXPECT_EQ(zebcore::utility::NarrowFromUTF16(descriptors[i]->GetName()), effect.names[i]);
            EXPECT_EQ(descriptors[i]->GetVendorString(), u"Zeb Audio");
            const FilterPtr filter = zebaudiofilterhost::utility::CreateAudioFilter(id);
            ASSERT_NE(filter, nullptr);
            for (std::size_t parameter = 0; parameter < effect.parameters.size(); ++parameter)
                filter->SetParameter(static_cast<int>(parameter), effect.parameters[parameter]);
            const auto member =
                static_cast<std::int32_t>(std::stoul(zebcore::utility::NarrowFromUTF16(id.substr(2))));
            EXPECT_TRUE(Through(*filter) == Directly(effect.file, member, effect.parameters)) << effect.names[i];
        }
    }
}

// Saved to text and read again, as an application keeps it.
TEST_F(HostedVST2, AFreshInstanceWithASavedStateGivesTheSameSamples)
{
    for (const char* name : {"ZebEcho2", "ZebGain2", "ZebPanel2"})
    {
        const FilterPtr filter = MakeFilter(VST2Effect(name));
        filter->SetFactoryPreset(1);
        filter->SetParameter(0, 0.3F);
        PropList list;
        PresetData preset(list);
        filter->SaveSettings(preset);
        zebcore::UTF8String text;
        zebcore::proplist::utils::WritePropList(text, list);
        PropList other;
        ASSERT_TRUE(zebcore::proplist::utils::ReadPropList(text, other));
        const PresetData read(other);
        const FilterPtr fresh = MakeFilter(VST2Effect(name));
        EXPECT_TRUE(fresh->LoadSettings(read));
        EXPECT_EQ(fresh->GetParameter(0), 0.3F) << name;
        EXPECT_TRUE(Through(*fresh) == Through(*filter)) << name;
    }
}

TEST_F(HostedVST2, ACloneIsTheSameMemberInTheSameState)
{
    for (const auto& [name, member] : {std::pair{"ZebShell2", 1U}, {"ZebEcho2", 0U}})
    {
        const auto descriptors = Scan(VST2Effect(name));
        ASSERT_GT(descriptors.size(), member);
        const FilterPtr filter = zebaudiofilterhost::utility::CreateAudioFilter(descriptors[member]->GetUniqueID());
        filter->SetParameter(0, 0.3F);
        const FilterPtr clone = AudioFilter::Clone(filter);
        ASSERT_NE(clone, nullptr);
        EXPECT_EQ(clone->GetID(), filter->GetID());
        EXPECT_EQ(clone->GetDisplayName(), filter->GetDisplayName());
        EXPECT_TRUE(Through(*clone) == Through(*filter)) << name;
    }
}

} // namespace
