// What the process thread runs, and nothing else: no lock, allocation, free or system call of ours.

#include "foundation/zebcore/HighPrecisionTime.h"
#include "foundation/zebcore/Trace.h"
#include "host/src/VST3/src/ScopeExit.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::vst3
{

using Steinberg::Vst::AudioBusBuffers;
using Steinberg::Vst::ProcessContext;

void VST3AudioFilter::SetCurrentOffset(long long offset)
{
    mProcessContext.projectTimeSamples = offset;
}

void VST3AudioFilter::SetParameter(int index, float value)
{
    AudioFilter::SetParameter(index, value);
    std::uint32_t id = 0;
    if (!FindParameterID(index, id))
        return;
    if (mController)
        mController->setParamNormalized(id, static_cast<double>(value));
    mInputTransfer.AddChange(id, static_cast<double>(value), 0);
}

// False for an index out of range.
bool VST3AudioFilter::FindParameterID(int index, std::uint32_t& id) const
{
    const Published<ParameterTable>::Reader parameters(mParameters);
    const auto& infos = parameters->mParameterInfos;
    if (index < 0 || static_cast<std::size_t>(index) >= infos.size())
        return false;
    id = infos[static_cast<std::size_t>(index)]->GetParameterID();
    return true;
}

void VST3AudioFilter::Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags)
{
    if (!mInitialized)
    {
        AudioFilter::Process(in, out, frames, inFlags, outFlags);
        return;
    }
    try
    {
        UpdateProcessContext();
        outFlags = ChannelFlags();
        TakeOfferedQueues();
        PassInputSilence(inFlags);
        for (int offset = 0; offset < frames;)
        {
            const int slice = std::min(mMaxBlockSize, frames - offset);
            ProcessSlice(in, out, offset, slice);
            offset += slice;
        }
        outFlags |= CollectOutputSilence();
    }
    catch (...) // what a plug-in throws ends the block, and goes no further
    {
    }
}

// Swaps in the queues that a rebuild of the parameter list has made; those replaced go to the main thread to be
// freed.
void VST3AudioFilter::TakeOfferedQueues()
{
    if (mOfferedQueues.load(std::memory_order_relaxed) == nullptr)
        return;
    QueueSet* const taken = mOfferedQueues.exchange(nullptr, std::memory_order_acquire); // sees the queues made
    if (taken == nullptr)
        return;
    mInputChanges.Swap(taken->mInput);
    mOutputChanges.Swap(taken->mOutput);
    taken->mNext = mSpentQueues.load(std::memory_order_relaxed);
    while (!mSpentQueues.compare_exchange_weak(taken->mNext, taken, std::memory_order_release)) // gives them away
    {
    }
}

void VST3AudioFilter::UpdateProcessContext()
{
    const IAudioFilterHost* host = GetAudioFilterHost();
    if (!host)
    {
        if (mSuspended)
            mProcessContext.state &= ~static_cast<Steinberg::uint32>(ProcessContext::kPlaying);
        else
            mProcessContext.state |= ProcessContext::kPlaying;
        return;
    }
    using zebcore::utility::HighPrecisionTime;
    const auto now = HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime());
    mProcessContext.systemTime = static_cast<Steinberg::int64>(now);
    mProcessContext.state = ProcessContext::kSystemTimeValid;
    utility::Tempo tempo = {};
    if (host->GetTempo(tempo))
        UpdateMusicalTime(tempo);
    bool playing = false;
    bool recording = false;
    bool looping = false;
    if (!host->GetTransportState(playing, recording, looping))
        return;
    const auto set = [this](bool on, Steinberg::uint32 flag)
    {
        mProcessContext.state |= on ? flag : 0U;
    };
    set(playing, ProcessContext::kPlaying);
    set(recording, ProcessContext::kRecording);
    set(looping, ProcessContext::kCycleActive);
}

// The first beat is 1, and the position of the bar is a count of beats; both on purpose.
void VST3AudioFilter::UpdateMusicalTime(const utility::Tempo& tempo)
{
    const Steinberg::Vst::TSamples position = mProcessContext.projectTimeSamples;
    const float seconds = static_cast<float>(position) / mSampleRate;
    const double framesPerBeat = static_cast<double>(60.0F * mSampleRate) / tempo.mTempo;
    mProcessContext.tempo = tempo.mTempo;
    mProcessContext.timeSigNumerator = tempo.mNumerator;
    mProcessContext.timeSigDenominator = tempo.mDenominator;
    mProcessContext.projectTimeMusic = static_cast<double>(seconds) * tempo.mTempo / 60.0 + 1.0;
    mProcessContext.barPositionMusic = static_cast<double>(position) / framesPerBeat + 1.0;
    mProcessContext.state |= ProcessContext::kProjectTimeMusicValid | ProcessContext::kTempoValid |
                             ProcessContext::kBarPositionValid | ProcessContext::kTimeSigValid;
}

// The bits of a bus stand at the channels' places among all channels of the filter, unlike those that the plug-in
// gives back for its outputs, which count from 0 in each bus.
void VST3AudioFilter::PassInputSilence(ChannelFlags inFlags)
{
    for (std::size_t bus = 0; bus < mInputBuffers.size(); ++bus)
        mInputBuffers[bus].silenceFlags = inFlags.Value() & mInputBits[bus];
    for (AudioBusBuffers& bus : mOutputBuffers)
        bus.silenceFlags = 0;
}

ChannelFlags VST3AudioFilter::CollectOutputSilence() const
{
    ChannelFlags silent;
    unsigned int channel = 0;
    for (const AudioBusBuffers& bus : mOutputBuffers)
    {
        silent.Set(bus.silenceFlags << (channel % 64U));
        channel += static_cast<unsigned int>(bus.numChannels);
    }
    return silent;
}

void VST3AudioFilter::ProcessSlice(float** in, float** out, int offset, int frames)
{
    mProcessData.numSamples = frames;
    // Those behind the filter's channels stay as they are. A suspended filter has none at all, not even these.
    for (std::size_t channel = 0; channel + kSpareChannels < mInputChannels.size(); ++channel)
        mInputChannels[channel] = in[channel] + offset;
    for (std::size_t channel = 0; channel + kSpareChannels < mOutputChannels.size(); ++channel)
        mOutputChannels[channel] = out[channel] + offset;

    // Also when the plug-in throws: it must not get the same changes twice.
    const ScopeExit cleared([this] { ClearProcessedInput(); });
    mInputTransfer.TransferChangesTo(mInputChanges);
    mOutputChanges.ClearQueue();
    if (!mProcessing)
    {
        mProcessor->setProcessing(1);
        mProcessing = true;
    }
    CallProcess();
    mOutputTransfer.TransferChangesFrom(mOutputChanges);
    mProcessContext.projectTimeSamples += frames;
}

void VST3AudioFilter::CallProcess()
{
    const Steinberg::tresult result = mProcessor->process(mProcessData);
    if (result == Steinberg::kResultOk || mProcessErrorReported)
        return;
    ZEB_TRACE_REALTIME("VST3AudioFilter::Process", "failed with result: " << result);
    mProcessErrorReported = true;
}

void VST3AudioFilter::ClearProcessedInput()
{
    mInputChanges.ClearQueue();
    if (mInputEvents)
        mInputEvents->Clear();
    if (mOutputEvents)
        mOutputEvents->Clear();
}

} // namespace zebaudiofilterhost::vst3
