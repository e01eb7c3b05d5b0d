// What audioMasterGetTime answers.

#include "foundation/zebcore/HighPrecisionTime.h"
#include "tests/vst/support/FakeFilter.h"

#include <bit>

using namespace fakeeffect;

namespace
{

constexpr int kUsual = 0x2f00;

class Host final : public zebaudiofilterhost::IAudioFilterHost
{
public:
    bool GetTimeInfo(zebaudiofilterhost::utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTempo(zebaudiofilterhost::utility::Tempo& tempo) const override
    {
        const bool wasZero = tempo.mTempo == 0.0 && tempo.mNumerator == 0 && tempo.mDenominator == 0;
        EXPECT_TRUE(wasZero) << "what the host leaves out is not 0";
        if (knows)
            tempo = answer;
        return result;
    }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }

    zebaudiofilterhost::utility::Tempo answer;
    bool knows = true;
    bool result = true;
};

class TimeInfo : public FilterTest
{
protected:
    ~TimeInfo() override { filter.reset(); }

    const VstTimeInfo* Ask(long long wanted = 0)
    {
        return std::bit_cast<const VstTimeInfo*>(fake.CallHost(audioMasterGetTime, 0, wanted));
    }

    Host host; // outlives the filter
};

} // namespace

TEST_F(TimeInfo, IsThereOnlyWhileRunning)
{
    Make();
    EXPECT_EQ(Ask(), nullptr);
    filter->Resume();
    const VstTimeInfo* const info = Ask();
    ASSERT_NE(info, nullptr);
    EXPECT_EQ(Ask(), info) << "plug-ins may keep the address";
    filter->Suspend();
    EXPECT_EQ(Ask(), nullptr);
}

TEST_F(TimeInfo, WithoutAHostHoldsTheUsualValues)
{
    Make();
    filter->Resume();
    const VstTimeInfo info = *Ask();
    EXPECT_EQ(info.sampleRate, 0.0);
    EXPECT_EQ(info.tempo, 120.0);
    EXPECT_EQ(info.timeSigNumerator, 4);
    EXPECT_EQ(info.timeSigDenominator, 4);
    EXPECT_EQ(info.smpteFrameRate, kVstSmpte25fps);
    EXPECT_EQ(info.flags, kUsual | kVstTransportPlaying | kVstTransportChanged);
    for (const double member : {info.samplePos, info.ppqPos, info.barStartPos, info.cycleStartPos, info.cycleEndPos})
        EXPECT_EQ(member, 0.0);
    EXPECT_EQ(info.smpteOffset, 0);
    EXPECT_EQ(info.samplesToNextClock, 0);
}

TEST_F(TimeInfo, EachChangeOfTheTransportIsToldOnce)
{
    Make();
    for (int round = 0; round < 2; ++round)
    {
        filter->Resume();
        const VstTimeInfo* const info = Ask();
        EXPECT_EQ(info->flags, kUsual | kVstTransportPlaying | kVstTransportChanged);
        EXPECT_EQ(Ask()->flags, kUsual | kVstTransportPlaying);
        filter->Suspend();
        EXPECT_EQ(info->flags, kUsual);
    }
}

TEST_F(TimeInfo, TellsTheClock)
{
    using zebcore::utility::HighPrecisionTime;
    const auto now = []
    {
        return static_cast<double>(HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime()));
    };
    MakeRunning();
    const double before = now();
    const double told = Ask()->nanoSeconds;
    EXPECT_GE(told, before);
    EXPECT_LE(told, now());
}

// Whatever the plug-in wants of the record.
TEST_F(TimeInfo, FollowsTheHost)
{
    struct
    {
        float sampleRate;
        double tempo;
        long long offset;
        double beat;
    } const rows[] = {
        {48000.0F, 120.0, 0, 1.0},
        {48000.0F, 120.0, 48000, 3.0},
        {44100.0F, 60.0, 22050, 1.5},
        {48000.0F, 120.0, -24000, 0.0},
        {48000.0F, 0.0, 48000, 1.0},
        // The product of rate and minute is taken in single precision: 1006632896 and not 1006632900.
        {16777215.0F, 1.0, 1006632896, 2.0},
    };
    MakeRunning();
    filter->SetAudioFilterHost(&host);
    for (const auto& row : rows)
    {
        host.answer.mTempo = row.tempo;
        host.answer.mNumerator = 7;
        host.answer.mDenominator = 8;
        filter->SetSampleRate(row.sampleRate);
        filter->SetCurrentOffset(row.offset);
        const VstTimeInfo* const info = Ask();
        EXPECT_EQ(info->sampleRate, static_cast<double>(row.sampleRate));
        EXPECT_EQ(info->samplePos, static_cast<double>(row.offset));
        EXPECT_EQ(info->tempo, row.tempo);
        EXPECT_EQ(info->timeSigNumerator, 7);
        EXPECT_EQ(info->timeSigDenominator, 8);
        EXPECT_EQ(info->ppqPos, row.beat) << row.offset;
        EXPECT_EQ(info->barStartPos, row.beat);
    }
    filter->SetAudioFilterHost(nullptr);
}

TEST_F(TimeInfo, TakesARecordThatTheHostRefuses)
{
    MakeRunning();
    filter->SetAudioFilterHost(&host);
    host.result = false;
    host.answer.mTempo = 90.0;
    host.answer.mNumerator = 3;
    EXPECT_EQ(Ask()->tempo, 90.0);
    host.knows = false;
    const VstTimeInfo* const info = Ask();
    EXPECT_EQ(info->tempo, 0.0);
    EXPECT_EQ(info->timeSigNumerator, 0);
    EXPECT_EQ(info->ppqPos, 1.0);
    filter->SetAudioFilterHost(nullptr);
}

TEST_F(TimeInfo, PositionStandsWithoutAHostAndRewindsAtResume)
{
    MakeRunning();
    filter->SetAudioFilterHost(&host);
    host.answer.mTempo = 120.0;
    filter->SetCurrentOffset(24000);
    Ask();
    filter->SetAudioFilterHost(nullptr);
    filter->SetCurrentOffset(48000);
    const VstTimeInfo* const info = Ask();
    EXPECT_EQ(info->samplePos, 24000.0);
    EXPECT_EQ(info->ppqPos, 2.0);
    filter->Suspend();
    // A plug-in that asks while it is switched on sees where the transport stood.
    double atStart = -1.0;
    fake.On(effStartProcess,
            [&](int, long long, void*, float)
            {
                atStart = Ask()->samplePos;
                return 0LL;
            });
    filter->Resume();
    EXPECT_EQ(atStart, 24000.0);
    EXPECT_EQ(info->samplePos, 0.0);
    EXPECT_EQ(info->ppqPos, 2.0);
}
