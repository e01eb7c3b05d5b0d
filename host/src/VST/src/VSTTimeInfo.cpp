// The record of audioMasterGetTime. Plug-ins ask from any thread, also two of them at once: then both get the same
// record, and the later one's answer.

#include "audiofilter/Tempo.h"
#include "foundation/zebcore/HighPrecisionTime.h"
#include "host/src/VST/src/VSTAudioFilter.h"

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr std::int32_t kAlwaysValid =
    kVstNanosValid | kVstPpqPosValid | kVstTempoValid | kVstBarsValid | kVstTimeSigValid;

// Members stand for themselves, so that no order between them is needed.
template <typename Member, typename Value>
void Set(Member& member, Value value)
{
    std::atomic_ref<Member>(member).store(static_cast<Member>(value), std::memory_order_relaxed);
}

void SetFlag(std::int32_t& flags, std::int32_t flag, bool on)
{
    const std::atomic_ref<std::int32_t> shared(flags);
    if (on)
        shared.fetch_or(flag, std::memory_order_relaxed);
    else
        shared.fetch_and(~flag, std::memory_order_relaxed);
}

} // namespace

void VSTAudioFilter::StartTimeInfo()
{
    constexpr double kOpeningTempo = 120.0;
    mTimeSampleRate = mSampleRate;
    mTimeInfo.sampleRate = static_cast<double>(mSampleRate);
    mTimeInfo.tempo = kOpeningTempo;
    mTimeInfo.timeSigNumerator = 4;
    mTimeInfo.timeSigDenominator = 4;
    mTimeInfo.smpteFrameRate = kVstSmpte25fps;
    mTimeInfo.flags = kAlwaysValid;
}

// The plug-in hears of it at once, also while it runs.
void VSTAudioFilter::SetSampleRate(float sampleRate)
{
    AudioFilter::SetSampleRate(sampleRate);
    mTimeSampleRate.store(sampleRate, std::memory_order_relaxed); // says nothing about other data
    Set(mTimeInfo.sampleRate, sampleRate);
    Dispatcher(effSetSampleRate, 0, 0, nullptr, sampleRate);
}

void VSTAudioFilter::SetCurrentOffset(long long offset)
{
    mCurrentOffset.store(offset, std::memory_order_relaxed); // says nothing about other data
}

void VSTAudioFilter::MarkTransport(bool playing)
{
    SetFlag(mTimeInfo.flags, kVstTransportPlaying, playing);
    mTransportChanged.store(true, std::memory_order_relaxed); // says nothing about other data
}

void VSTAudioFilter::RewindTimeInfo()
{
    Set(mTimeInfo.samplePos, 0.0);
}

void VSTAudioFilter::UpdateTimeInfo(long long /*wanted*/)
{
    using zebcore::utility::HighPrecisionTime;
    const bool changed = mTransportChanged.exchange(false, std::memory_order_relaxed); // of two callers, one is told
    SetFlag(mTimeInfo.flags, kVstTransportChanged, changed);
    Set(mTimeInfo.nanoSeconds, HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime()));
    if (const IAudioFilterHost* const host = GetAudioFilterHost())
        UpdateMusicalTime(*host);
}

// Whatever the host answers, and however it leaves the record, is passed on. The first beat is 1, and the bar starts
// at each beat; both on purpose.
void VSTAudioFilter::UpdateMusicalTime(const IAudioFilterHost& host)
{
    constexpr float kSecondsPerMinute = 60.0F;
    utility::Tempo tempo = {};
    host.GetTempo(tempo);
    const auto position = static_cast<double>(mCurrentOffset.load(std::memory_order_relaxed));
    const float framesPerMinute = mTimeSampleRate.load(std::memory_order_relaxed) * kSecondsPerMinute;
    const double beat = position / (static_cast<double>(framesPerMinute) / tempo.mTempo) + 1.0;
    Set(mTimeInfo.timeSigNumerator, tempo.mNumerator);
    Set(mTimeInfo.timeSigDenominator, tempo.mDenominator);
    Set(mTimeInfo.tempo, tempo.mTempo);
    Set(mTimeInfo.samplePos, position);
    Set(mTimeInfo.ppqPos, beat);
    Set(mTimeInfo.barStartPos, beat);
}

} // namespace zebaudiofilterhost::vst
