#include "tests/audiofilter/RecordingFilter.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost
{
namespace
{

using testing::MakeBus;
using testing::MakeFilter;
using Bus = AudioFilterBusDescription;

const Bus kStereo = Bus::CreateStereo(u"A", Bus::kBusType_Main);
const Bus kOtherName = Bus::CreateStereo(u"B", Bus::kBusType_SideChain);
const Bus kOtherLabels(u"A", zebmediatypes::CreateMatrixStereoChannelLayout(), Bus::kBusType_Main);
const Bus kMono = Bus::CreateMono(u"A", Bus::kBusType_Main);

TEST(BusDescription, EqualityAndEquivalenceLookAtDifferentThings)
{
    struct Case
    {
        const Bus& other;
        bool equal;
        bool sameLayout;
        bool sameCount;
    };
    for (const Case& c : {Case{kStereo, true, true, true}, Case{kOtherName, false, true, true},
                          Case{kOtherLabels, false, false, true}, Case{kMono, false, false, false}})
    {
        EXPECT_EQ(kStereo == c.other, c.equal);
        EXPECT_EQ(kStereo != c.other, !c.equal);
        EXPECT_EQ(kStereo.IsEquivalent(c.other, true), c.sameLayout);
        EXPECT_EQ(kStereo.IsEquivalent(c.other, false), c.sameCount);
        EXPECT_EQ(AreAudioFilterBusDescriptionsEquivalent({kStereo}, {c.other}, false), c.sameLayout);
    }
}

TEST(BusDescription, ListsAreEquivalentBusByBus)
{
    EXPECT_TRUE(AreAudioFilterBusDescriptionsEquivalent({}, {}, true));
    EXPECT_FALSE(AreAudioFilterBusDescriptionsEquivalent({kStereo}, {kStereo, kMono}, true));
    EXPECT_FALSE(AreAudioFilterBusDescriptionsEquivalent({kMono, kStereo}, {kStereo, kMono}, true));
}

TEST(BusDescription, MadeLayoutsHaveTheirChannels)
{
    EXPECT_EQ(Bus().GetChannelCount(), 0);
    EXPECT_EQ(Bus::CreateSurround51(u"", Bus::kBusType_Main).GetChannelCount(), 6);
    EXPECT_EQ(Bus::CreateSurround71(u"", Bus::kBusType_SideChain).GetChannelCount(), 8);
    EXPECT_EQ(Bus::CreateSurround71(u"", Bus::kBusType_SideChain).GetType(), Bus::kBusType_SideChain);
}

TEST(BusDescription, AssignmentAndSwapMoveEverything)
{
    Bus a = kOtherName;
    Bus b;
    a.swap(b);
    EXPECT_TRUE(a == Bus());
    EXPECT_TRUE(b == kOtherName);
    a = *&b;
    EXPECT_TRUE(a == kOtherName);
}

TEST(FilterBuses, CountsRunThroughAllBuses)
{
    const auto filter = MakeFilter({1, 1}, {8});
    EXPECT_EQ(filter->GetNumberOfInputChannels(), 2);
    EXPECT_TRUE(filter->CanUseSideChaining());
    filter->ClearInputBusConfiguration();
    EXPECT_EQ(filter->GetNumberOfInputChannels(), 0);
    filter->AddInputBuses({MakeBus(8)});
    EXPECT_FALSE(filter->CanUseSideChaining());

    std::vector<Bus> inputs(5);
    std::vector<Bus> outputs(5);
    filter->GetBusConfiguration(inputs, outputs);
    EXPECT_EQ(inputs.size(), 1U);
    EXPECT_EQ(outputs.size(), 1U);
    filter->ClearBusConfiguration();
    EXPECT_EQ(filter->GetNumberOfOutputChannels(), 0);
}

TEST(FilterBuses, TargetBusesSignalAndTakeTheTypeTheyAreGiven)
{
    const auto filter = MakeFilter({}, {});
    int fired = 0;
    filter->ConnectTargetFormatChanged([&fired] { ++fired; });
    filter->SetMainTargetBus(kOtherName);
    filter->SetSideChainTargetBus(kMono);
    filter->SetChannelMapTargetChannelLayout(kStereo.GetLayout());
    EXPECT_EQ(fired, 3);
    EXPECT_EQ(filter->GetMainTargetBus().GetType(), Bus::kBusType_SideChain);
    EXPECT_TRUE(filter->GetChannelMapTargetChannelLayout() == kStereo.GetLayout());
    EXPECT_EQ(filter->GetSideChainTargetBusChannelCount(), 1);
}

// Grants what it likes, whatever it is asked for.
class StubbornFilter : public testing::RecordingFilter
{
public:
    StubbornFilter(std::vector<int> inputs, std::vector<int> outputs)
        : RecordingFilter({}, {}), mInputs(std::move(inputs)), mOutputs(std::move(outputs))
    {
    }

    void RequestIOConfiguration(const std::vector<ChannelLayout>&, const std::vector<ChannelLayout>&) override
    {
        ClearBusConfiguration();
        for (const int channels : mInputs)
            AddInputBus(MakeBus(channels));
        for (const int channels : mOutputs)
            AddOutputBus(MakeBus(channels));
    }

private:
    std::vector<int> mInputs;
    std::vector<int> mOutputs;
};

TEST(FilterBuses, AFormatIsSupportedWhenTheOneOutputBusGetsItsChannels)
{
    struct Case
    {
        std::vector<int> inputs;
        std::vector<int> outputs;
        bool supported;
    };
    const std::vector<Case> cases{{{2}, {2}, true},     {{1}, {2}, true},     {{2}, {1}, false}, {{}, {2}, false},
                                  {{2}, {2, 2}, false}, {{0, 2}, {2}, false}, {{2}, {}, false}};
    for (const Case& c : cases)
    {
        boost::intrusive_ptr<AudioFilter> filter(new StubbornFilter(c.inputs, c.outputs));
        EXPECT_EQ(filter->IsChannelFormatSupported(kStereo.GetLayout()), c.supported);
        EXPECT_EQ(filter->GetInputBuses().size(), c.inputs.size()); // Left as it was probed
    }
}

} // namespace
} // namespace zebaudiofilterhost
