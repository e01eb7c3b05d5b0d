// Real binaries that misbehave, each as a filter: what its calls to the host get, and what its process function gets.

#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTPluginModule.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>

namespace zebaudiofilterhost::vst
{
namespace
{

using testing::AnyOf;
using testing::Contains;
using testing::Each;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;
using zebtest::FixtureRecorder;

constexpr int kFrames = 64;

// Of a plain file or bundle; of a shell the shell itself. Without a scan's look at it, which some do not survive.
boost::intrusive_ptr<VSTAudioFilter> MakeFilterOf(const std::filesystem::path& path)
{
    const auto module = GetVSTPlugin(zebcore::utility::UTF16FromNarrow(path.string()));
    return module ? boost::dynamic_pointer_cast<VSTAudioFilter>(module->CreateAudioFilter(u"2:0 any")) : nullptr;
}

class FilterFixtures : public testing::Test
{
protected:
    void SetUp() override { InitializeMainThreadID(); }

    // A block of ones through the filter, for as many channels as it has.
    static std::vector<std::vector<float>> Process(VSTAudioFilter& filter)
    {
        const auto make = [](int channels)
        {
            return std::vector<std::vector<float>>(static_cast<std::size_t>(channels),
                                                   std::vector<float>(kFrames, 1.0F));
        };
        std::vector<std::vector<float>> in = make(filter.GetNumberOfInputChannels());
        std::vector<std::vector<float>> out = make(filter.GetNumberOfOutputChannels());
        std::vector<float*> inPointers;
        std::vector<float*> outPointers;
        for (auto& channel : in)
            inPointers.push_back(channel.data());
        for (auto& channel : out)
            outPointers.push_back(channel.data());
        ChannelFlags flags;
        filter.ProcessWithMapping(inPointers.data(), outPointers.data(), kFrames, ChannelFlags(), flags);
        return out;
    }

    static void Resume(VSTAudioFilter& filter)
    {
        filter.SetSampleRate(48000.0F);
        filter.SetBlockSize(kFrames);
        filter.Resume();
    }
};

bool IsFinite(const std::vector<float>& channel)
{
    return std::all_of(channel.begin(), channel.end(), [](float frame) { return std::isfinite(frame); });
}

} // namespace

// The static layer says that each pin is connected, since it knows none; the instance, that none is, as long as there
// are no buses.
TEST_F(FilterFixtures, EachMomentOfLifeHasItsAnswers)
{
    struct
    {
        const char* fixture;
        const char* when;
        int pin;
    } const rows[] = {{"CallsInEntry", "entry", 0},      {"CallsInEntry", "made", 0},
                      {"CallsInOpen", "open", 1},        {"CallsInClose", "close", 0},
                      {"CallsWithoutEffect", "open", 0}, {"CallsWithoutEffect", "close", 0}};
    for (const auto& row : rows)
    {
        const std::filesystem::path path = zebtest::VST2Fixture(row.fixture);
        const FixtureRecorder recorder(path);
        recorder.Clear();
        auto filter = MakeFilterOf(path);
        ASSERT_TRUE(filter);
        Resume(*filter);
        filter.reset();
        const std::string when = row.when;
        const std::vector<std::string> calls = recorder.CallsTo(when + ".");
        for (const std::string& answer :
             {std::string("audioMasterVersion -> 2400"), std::string("audioMasterGetTime -> 0"),
              "audioMasterPinConnected 0 0 -> " + std::to_string(row.pin),
              std::string("audioMasterGetVendorString -> 1 Corvane Systems"),
              std::string("audioMasterGetProductString -> 1 Opal"),
              std::string("audioMasterCanDo shellCategory -> 1"), std::string("audioMasterCanDo sizeWindow -> 0"),
              std::string("audioMasterCanDo -> 0"), std::string("audioMasterVendorSpecific 0x70400000 -> 0x0"),
              std::string("audioMasterVendorSpecific 0x70400000 1 -> 0x11005678 0"),
              std::string("audioMasterBeginEdit 0 -> 0"), std::string("audioMasterGetLanguage -> 1")})
            EXPECT_THAT(calls, Contains(when + "." + answer)) << row.fixture;
        EXPECT_EQ(recorder.LiveObjects(), 0) << row.fixture;
    }
}

// Whatever a plug-in says of its pins, each has a buffer, and whatever it throws, the samples stay finite.
TEST_F(FilterFixtures, EachOneProcesses)
{
    int made = 0;
    std::vector<std::string> notMade;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(zebtest::VST2FixtureFolder()))
    {
        if (entry.path().extension() != ".so" || entry.path().filename() == "Helper.so")
            continue;
        const auto filter = MakeFilterOf(entry.path());
        if (!filter)
        {
            notMade.push_back(entry.path().stem());
            continue;
        }
        SCOPED_TRACE(entry.path().filename());
        const FixtureRecorder recorder(entry.path());
        for (const std::size_t channels : {1U, 2U, 6U})
        {
            filter->RequestIOConfiguration({ChannelLayout(channels)}, {ChannelLayout(channels)});
            Resume(*filter);
            recorder.Clear();
            for (const std::vector<float>& channel : Process(*filter))
                EXPECT_TRUE(IsFinite(channel));
            const std::vector<std::string> calls = recorder.CallsTo("process");
            EXPECT_THAT(calls, Contains(HasSubstr(" null= ")));
            EXPECT_THAT(calls, Each(AnyOf(EndsWith(" null= 0"), StartsWith("process.")))); // or a call to the host
            filter->Suspend();
        }
        ++made;
    }
    EXPECT_GT(made, 50);
    EXPECT_THAT(notMade, ElementsAre("NullEntry"));
}

} // namespace zebaudiofilterhost::vst
