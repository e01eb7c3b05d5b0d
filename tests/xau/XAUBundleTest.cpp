// Real bundles through the filter: the order of the calls, the objects handed out, the ways to ask for input.

#include "audiofilter/PresetData.h"
#include "host/src/XAU/linux/view/ParameterRow.h"
#include "host/src/XAU/src/XAUAudioFilter.h"
#include "host/src/XAU/src/XAUComponentID.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/support/VariableGuard.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>

#include <dlfcn.h>
#include <map>
#include <set>
#include <sstream>

namespace zebaudiofilterhost::xau
{
namespace
{

using testing::ElementsAre;
using testing::Pair;
using testing::UnorderedElementsAre;
using Row = std::vector<float>;

constexpr OSType kZeb = 0x7A656278;
constexpr OSType kRecorder = 0x7265636F;
constexpr OSType kMixer = 0x7A6D6978;

boost::intrusive_ptr<XAUAudioFilter> MakeFilter(OSType type, OSType subType)
{
    return XAUAudioFilter::Create(u"4:" + EncodeComponentID({type, subType, kZeb, 0, 0}));
}

const ChannelLayout kStereo = zebmediatypes::CreateStereoChannelLayout();

class XAUBundleTest : public testing::Test
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        mRecorder.Clear();
        mRecorder.Reset();
    }
    void TearDown() override { mRecorder.Reset(); }

    void MakeRecorder()
    {
        mFilter = MakeFilter(kAudioUnitType_Effect, kRecorder);
        ASSERT_TRUE(mFilter);
    }

    std::vector<std::string> TakeCalls()
    {
        std::vector<std::string> calls = mRecorder.Calls();
        mRecorder.Clear();
        return calls;
    }

    // Releases of all objects that were handed out so far, by kind.
    static std::multimap<std::string, int> AllReleases()
    {
        using Function = const char*();
        void* const binary = dlopen(zebtest::BinaryOf(Bundle()).c_str(), RTLD_LAZY | RTLD_NOLOAD);
        auto* const releases = reinterpret_cast<Function*>(dlsym(binary, "ZebUnitReleases"));
        std::istringstream lines(releases());
        std::multimap<std::string, int> counts;
        for (std::string line; std::getline(lines, line);)
        {
            const std::size_t blank = line.rfind(' ');
            counts.emplace(line.substr(0, blank), std::stoi(line.substr(blank + 1)));
        }
        return counts;
    }

    // The same, each kind once.
    static std::map<std::string, std::set<int>> Releases()
    {
        std::map<std::string, std::set<int>> counts;
        for (const auto& [kind, count] : AllReleases())
            counts[kind].insert(count);
        return counts;
    }

    static std::filesystem::path Bundle() { return std::filesystem::path(ZEB_UNIT_FIXTURES) / "Recorder.component"; }

    // What comes out for inputs that count from 0 and from 1000.
    std::vector<Row> Process(std::size_t frames)
    {
        std::vector<Row> in(static_cast<std::size_t>(mFilter->GetNumberOfInputChannels()), Row(frames));
        std::vector<Row> out(static_cast<std::size_t>(mFilter->GetNumberOfOutputChannels()), Row(frames, -1.0F));
        std::vector<float*> inputs;
        std::vector<float*> outputs;
        for (std::size_t channel = 0; channel < in.size(); ++channel)
        {
            for (std::size_t frame = 0; frame < frames; ++frame)
                in[channel][frame] = static_cast<float>(channel * 1000 + frame);
            inputs.push_back(in[channel].data());
        }
        for (Row& row : out)
            outputs.push_back(row.data());
        ChannelFlags silent;
        mFilter->Process(inputs.data(), outputs.data(), static_cast<int>(frames), ChannelFlags(), silent);
        return out;
    }

    zebtest::VariableGuard mPath{"AUDIO_COMPONENT_PATH", std::string(ZEB_UNIT_FIXTURES) + ":" + ZEB_UNITS};
    zebtest::FixtureRecorder mRecorder{Bundle()};
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
};

// From the factory to the end.
TEST_F(XAUBundleTest, AUnitIsCalledInOrder)
{
    MakeRecorder();
    EXPECT_THAT(TakeCalls(),
                ElementsAre("Create", "Set 27 0 0", "Set 8 1 0", "Set 8 2 0", "Set 14 0 0", "Initialize"));
    mFilter->RequestIOConfiguration({kStereo}, {kStereo});
    EXPECT_THAT(TakeCalls(), ElementsAre("Uninitialize", "Set 8 1 0", "Set 8 2 0", "Initialize"));
    mFilter->SetBlockSize(2048);
    EXPECT_THAT(TakeCalls(), ElementsAre("Uninitialize", "Set 14 0 0", "Initialize"));
    mFilter->Resume();
    EXPECT_THAT(TakeCalls(), ElementsAre("Set 23 1 0", "Reset"));
    Process(1030);
    EXPECT_THAT(mRecorder.CallsTo("Render"), ElementsAre("Render 1024", "Render 6"));
    TakeCalls();
    zebcore::proplist::PropList list;
    PresetData preset(list);
    ASSERT_TRUE(mFilter->SaveChunkData(preset));
    ASSERT_TRUE(mFilter->LoadChunkData(preset));
    mFilter->SetFactoryPreset(0);
    EXPECT_THAT(TakeCalls(), ElementsAre("Set 0 0 0", "Set 36 0 0"));
    mFilter->Suspend();
    mFilter->SetSampleRate(96000.0F);
    EXPECT_THAT(TakeCalls(), ElementsAre("Uninitialize", "Set 8 1 0", "Set 8 2 0", "Initialize"));
    mFilter.reset();
    EXPECT_THAT(TakeCalls(), ElementsAre("Uninitialize", "Close"));
}

// Once where the host has to, and not at all where the unit keeps it, or may.
TEST_F(XAUBundleTest, EveryObjectIsReleasedAsOftenAsItHasToBe)
{
    MakeRecorder();
    mFilter->RequestIOConfiguration({kStereo}, {kStereo});
    EXPECT_EQ(mFilter->GetParameterInfo(0)->GetName(), u"Released");
    EXPECT_EQ(mFilter->GetParameterInfo(1)->GetLabel(), u"gadgets");
    EXPECT_EQ(mFilter->GetParameterInfo(2)->GetName(), u"Plain");
    EXPECT_EQ(mFilter->GetFactoryPresetName(0), u"First");
    EXPECT_EQ(mFilter->GetParameterString(2), u"some");
    EXPECT_THAT(Releases().at("presets"), testing::Contains(0)) << "the filter has them as long as it lives";
    zebcore::proplist::PropList list;
    PresetData preset(list);
    ASSERT_TRUE(mFilter->SaveChunkData(preset));
    ASSERT_TRUE(mFilter->LoadChunkData(preset));
    for (AudioUnitParameterID id = 0; id < 4; ++id)
        ParameterRow(mFilter->GetComponentInstance(), kAudioUnitScope_Global, id);
    mFilter.reset();
    // The unit releases what it keeps once, when it is closed.
    EXPECT_THAT(Releases(),
                UnorderedElementsAre(Pair("name", ElementsAre(1)), Pair("unit name", ElementsAre(1)),
                                     Pair("kept name", ElementsAre(1)), Pair("kept unit name", ElementsAre(1)),
                                     Pair("presets", ElementsAre(1)), Pair("element name", ElementsAre(1)),
                                     Pair("step names", ElementsAre(1)), Pair("value text", ElementsAre(0)),
                                     Pair("class info", ElementsAre(0)), Pair("given class info", ElementsAre(1))));
}

TEST_F(XAUBundleTest, InputComesIntoMemoryOfEitherSide)
{
    MakeRecorder();
    mFilter->RequestIOConfiguration({kStereo}, {kStereo});
    mFilter->Resume();
    for (const double memory : {0.0, 1.0})
    {
        mRecorder.Set("inputMemory", memory);
        TakeCalls();
        EXPECT_THAT(Process(4), ElementsAre(Row({0, 1, 2, 3}), Row({1000, 1001, 1002, 1003}))) << memory;
        EXPECT_THAT(TakeCalls(), ElementsAre("Render 4", "Pulled 1 16"));
    }
}

// It is not asked for, and a unit that will have nothing else gets one channel in what it wants to be two.
TEST_F(XAUBundleTest, AnInterleavedUnitKeepsItsFormatAndHarmsNothing)
{
    mRecorder.Set("refusesFormats", 1);
    mRecorder.Set("inputMemory", 2);
    MakeRecorder();
    mFilter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    ASSERT_EQ(mFilter->GetNumberOfInputChannels(), 2) << "the buses tell what the unit has";
    ASSERT_EQ(mFilter->GetNumberOfOutputChannels(), 2);
    mFilter->Resume();
    TakeCalls();
    EXPECT_THAT(Process(4), ElementsAre(Row({0, 1, 2, 3}), Row(4, -1.0F)));
    EXPECT_THAT(TakeCalls(), ElementsAre("Render 4", "Pulled 1 16"));
}

TEST_F(XAUBundleTest, AFailingRenderIsOverAndTheNextIsTried)
{
    MakeRecorder();
    mFilter->RequestIOConfiguration({kStereo}, {kStereo});
    mFilter->Resume();
    mRecorder.Set("renderResult", kAudioUnitErr_NoConnection);
    EXPECT_THAT(Process(2), ElementsAre(Row(2, -1.0F), Row(2, -1.0F)));
    mRecorder.Set("renderResult", 0);
    EXPECT_THAT(Process(2), ElementsAre(Row({0, 1}), Row({1000, 1001})));
}

// Any number on each side.
TEST_F(XAUBundleTest, TheMixerTakesCountsThatDiffer)
{
    mFilter = MakeFilter(kAudioUnitType_Mixer, kMixer);
    ASSERT_TRUE(mFilter);
    for (const auto& [inputs, outputs] : {std::pair(1, 2), {2, 1}, {2, 5}, {6, 2}, {2, 2}})
    {
        mFilter->RequestIOConfiguration({ChannelLayout(static_cast<std::size_t>(inputs))},
                                        {ChannelLayout(static_cast<std::size_t>(outputs))});
        EXPECT_EQ(mFilter->GetInputBuses().front().GetLayout().size(), static_cast<std::size_t>(inputs));
        EXPECT_EQ(mFilter->GetNumberOfOutputChannels(), outputs);
        mFilter->Resume();
        EXPECT_TRUE(mFilter->IsAUInitialized()) << inputs << " to " << outputs;
        const Row last = Process(3).back();
        const float first = inputs == 1 ? 0.0F : 1000.0F * static_cast<float>(outputs - 1);
        EXPECT_EQ(last, inputs == 1 || outputs <= inputs ? Row({first, first + 1, first + 2}) : Row(3, 0.0F))
            << inputs << " to " << outputs;
    }
}

} // namespace
} // namespace zebaudiofilterhost::xau
