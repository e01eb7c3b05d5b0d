// Which buses a request ends in, with plug-ins that agree, refuse and lie.
#include "foundation/zebcore/StringConversion.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

#include <numeric>
#include <ostream>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

struct Request
{
    const char* fixture;
    std::size_t channels;
    const char* inputs; // "name:channels"
    const char* outputs;
};

std::ostream& operator<<(std::ostream& stream, const Request& request)
{
    return stream << request.fixture << ' ' << request.channels;
}

constexpr Request kRequests[] = {
    {"Normal", 1, "Mono In:1", "Mono Out:1"},
    {"Normal", 2, "Stereo In:2", "Stereo Out:2"},
    {"Normal", 6, "Surround 5.1 In:6", "Surround 5.1 Out:6"},
    {"Normal", 8, "Multi-Mono In:8", "Multi-Mono Out:8"},
    {"Normal", 12, "Multi-Mono In:12", "Multi-Mono Out:12"},
    {"Normal", 64, "Multi-Mono In:64", "Multi-Mono Out:64"},
    {"StubbornPins", 6, "Surround 5.1 In:6", "Surround 5.1 Out:6"},
    {"Version2300", 1, "Mono In:1", "Mono Out:1"},
    {"Mono", 1, "Mono In:1", "Mono Out:1"},
    {"Mono", 2, "Mono In:1", "Mono Out:1"},
    {"CanMono", 1, "Mono In:1", "Mono Out:1"},
    {"CanMono", 2, "Stereo In:2", "Stereo Out:2"},
    {"RefusesArrangements", 1, "Stereo In:2", "Stereo Out:2"},
    {"RefusesArrangements", 6, "Stereo In:2", "Stereo Out:2"},
    {"ThrowsInDispatcher", 1, "Stereo In:2", "Stereo Out:2"},
    {"Surround", 6, "Surround 5.1 In:6", "Surround 5.1 Out:6"},
    {"FourOutputs", 2, "Stereo In:2", "Multi-Mono In:4"},
    {"SideChain", 2, "Multi-Mono In:4", "Stereo Out:2"},
    {"NoInputs", 2, "Multi-Mono In:0", "Stereo Out:2"},
    {"NoPins", 2, "Multi-Mono In:0", "Multi-Mono In:0"},
    {"NegativeCounts", 2, "Multi-Mono In:0", "Multi-Mono In:0"},
    // The plug-in has taken what was asked for, so that its pins are these, but says no arrangement that could be
    // used.
    {"NoArrangement", 1, "Mono In:1", "Mono Out:1"},
    {"NullArrangements", 6, "Surround 5.1 In:6", "Surround 5.1 Out:6"},
    {"HalfArrangement", 6, "Surround 5.1 In:6", "Surround 5.1 Out:6"},
    {"HugeArrangement", 2, "Stereo In:2", "Stereo Out:2"},
    {"NegativeArrangement", 2, "Stereo In:2", "Stereo Out:2"},
    {"EmptyArrangement", 2, "Stereo In:2", "Stereo Out:2"},
    // The plug-in agreed to something else.
    {"OtherArrangement", 2, "Multi-Mono In:5", "Multi-Mono Out:5"},
};

std::string Describe(const std::vector<AudioFilterBusDescription>& buses)
{
    return std::accumulate(buses.begin(), buses.end(), std::string(),
                           [](const std::string& text, const AudioFilterBusDescription& bus) {
                               return text + zebcore::utility::NarrowFromUTF16(bus.GetName()) + ':' +
                                      std::to_string(bus.GetChannelCount());
                           });
}

class HostedVST2Request : public HostedVST2, public testing::WithParamInterface<Request>
{
};

TEST_P(HostedVST2Request, EndsInTheseBusesAndSoundGoesThrough)
{
    const Request& request = GetParam();
    const FilterPtr filter = Make(request.fixture);
    ASSERT_NE(filter, nullptr);
    const ChannelLayout layout(request.channels);
    filter->RequestIOConfiguration({layout}, {layout});
    EXPECT_EQ(Describe(filter->GetInputBuses()), request.inputs);
    EXPECT_EQ(Describe(filter->GetOutputBuses()), request.outputs);

    // No pin is a null pointer, whatever buses and pins have come to.
    const bool hears = filter->GetNumberOfInputChannels() > 0;
    for (const auto& channel : RunBlocks(*filter, 2, 100))
        if (std::string_view(request.fixture) != "OtherArrangement" &&
            std::string_view(request.fixture) != "StubbornPins")
        {
            EXPECT_EQ(channel.back(), hears ? 0.5F : 0.0F);
        }
    for (const std::string& line : Recorder().CallsTo("processReplacing"))
        EXPECT_TRUE(line.ends_with("null= 0")) << line;
}

INSTANTIATE_TEST_SUITE_P(All, HostedVST2Request, testing::ValuesIn(kRequests));

TEST_F(HostedVST2, ThePluginIsToldTypeCountAndNames)
{
    const FilterPtr filter = Make("Normal");
    const std::pair<std::size_t, std::string> rows[] = {
        {1, "0:1:M"}, {2, "1:2:L"}, {3, "-2:3:3"}, {6, "15:6:L"}, {8, "23:8:L"}, {12, "-2:12:12"}, {64, "-2:64:64"}};
    for (const auto& [channels, text] : rows)
    {
        Recorder().Clear();
        filter->RequestIOConfiguration({ChannelLayout(channels)}, {ChannelLayout(channels)});
        EXPECT_EQ(Recorder().CallsTo("effSetSpeakerArrangement"),
                  std::vector<std::string>{"effSetSpeakerArrangement " + text + ' ' + text});
    }
    Recorder().Clear();
    filter->RequestIOConfiguration({ChannelLayout(2), ChannelLayout(2)}, {ChannelLayout(2)});
    EXPECT_EQ(filter->GetNumberOfInputChannels(), 64);
    EXPECT_TRUE(Recorder().Calls().empty());
}

// Both pins read the one channel, and what comes out of the second is dropped.
TEST_F(HostedVST2, MonoGoesThroughStereoPins)
{
    const FilterPtr filter = Make("CanMono");
    filter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    Recorder().Set("gain", 0.5);
    const auto out = RunBlocks(*filter, 2, 100);
    ASSERT_EQ(out.size(), 1U);
    EXPECT_EQ(out[0], std::vector<float>(100, 0.25F));
    EXPECT_EQ(Recorder().CallsTo("processReplacing"),
              std::vector<std::string>(2, "processReplacing 100 2 2 null= 0"));
    EXPECT_EQ(Recorder().Do("audioMasterPinConnected 0 1"), "0");
    EXPECT_EQ(Recorder().Do("audioMasterPinConnected 1 1"), "1");
}

// A plug-in that only adds finds its outputs cleared for as many frames as there are channels.
TEST_F(HostedVST2, AnAddingPluginFindsWhatTheCallerLeft)
{
    const FilterPtr filter = Make("Accumulates");
    const auto out = RunBlocks(*filter, 1, 4);
    EXPECT_EQ(out[0], (std::vector<float>{0.5F, 0.5F, 9.5F, 9.5F}));
    EXPECT_EQ(out[1], out[0]);
    EXPECT_EQ(RunBlocks(*filter, 1, 1)[0], std::vector<float>{0.5F});
    EXPECT_EQ(Recorder().Count("process 4 2 2 null= 0"), 1U);
}

} // namespace
