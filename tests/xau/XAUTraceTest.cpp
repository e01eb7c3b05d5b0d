#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"
#include "tests/xau/support/TraceText.h"

#include <gmock/gmock.h>

#include <array>
#include <cstdlib>

namespace zebaudiofilterhost::xau
{
namespace
{

using testing::HasSubstr;

TEST(XAUTrace, NamesTheCallsThatFail)
{
    const TestClock clock;
    FakeUnit unit(kAudioUnitType_Effect, "Maker: Traced");
    unit.mRefused = {FormatOf(kAudioUnitScope_Input), Global(kAudioUnitProperty_HostCallbacks),
                     Global(kAudioUnitProperty_MaximumFramesPerSlice)};
    const TraceText trace("XAUAudioFilter");
    const auto filter = unit.MakeFilter();
    filter->GetInitialDelay();
    filter->RequestIOConfiguration({ChannelLayout(3)}, {ChannelLayout(2)});
    unit.mRefused = {FormatOf(kAudioUnitScope_Output)};
    filter->RequestIOConfiguration({ChannelLayout(3)}, {ChannelLayout(7)});
    unit.AnswerList({kAudioUnitProperty_AudioChannelLayout, kAudioUnitScope_Output, 0},
                    std::vector<UInt32>{0x840004, 0, 0});
    filter->BuildIOConfiguration();
    for (const char* line :
         {"Create(4:", "XAUAudioFilter(), vendor: Maker, effect: Traced",
          "XAUAudioFilter::BuildParameterInfos(), AudioUnitGetProperty() 1 failed with code -10879",
          "kAudioUnitProperty_HostCallbacks failed with code -10868",
          "AudioUnitSetProperty(kAudioUnitProperty_MaximumFramesPerSlice) failed with code -10868",
          "XAUAudioFilter::SetStreamFormat(),  AudioUnitSetProperty() / kAudioUnitProperty_StreamFormat failed with "
          "code -10868",
          "kAudioUnitProperty_Latency failed with code -10879",
          "XAUAudioFilter::RequestIOConfiguration(),  AudioUnitSetProperty() / kAudioUnitProperty_StreamFormat / "
          "kAudioUnitScope_Input, channels: 3 failed with code -10868",
          "kAudioUnitScope_Output, channels: 7 failed with code -10868",
          "kAudioUnitProperty_AudioChannelLayout unsupported", "Unknown channel layout tag: 8650756"})
        EXPECT_THAT(trace.mLines, testing::Contains(HasSubstr(line)));
}

// In a process of its own: others have failed in this one.
TEST(XAUTraceDeathTest, OnlyTheFirstFailedRenderOfAProcessIsTold)
{
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    const auto failTwice = []
    {
        const TestClock clock;
        FakeUnit unit;
        unit.mRender = [](UInt32, AudioBufferList&)
        {
            return kAudioUnitErr_NoConnection;
        };
        const TraceText trace("XAUAudioFilter::Process");
        for (int round = 0; round < 2; ++round)
        {
            const auto filter = unit.MakeFilter();
            filter->Resume();
            ChannelFlags silent;
            filter->Process(nullptr, nullptr, 2000, ChannelFlags(), silent);
        }
        const bool isRight = trace.mLines.size() == 1 && unit.CountCalls("render 976") == 2 &&
                             trace.mLines.front().find("AudioUnitRender: -10876") != std::string::npos;
        std::_Exit(isRight ? 0 : 1);
    };
    EXPECT_EXIT(failTwice(), testing::ExitedWithCode(0), "");
}

} // namespace
} // namespace zebaudiofilterhost::xau
