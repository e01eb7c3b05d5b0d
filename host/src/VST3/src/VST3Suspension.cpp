// The filter's way from suspended to running and back, and what it does for the plug-in while no audio runs.

#include "audiofilter/src/FloatingPointMode.h"
#include "host/src/VST3/src/ScopeExit.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::Vst::AudioBusBuffers;

namespace
{

// One element a bus; the buses share `channels`, which has a pointer for each channel of the filter.
void AllocateBuses(const std::vector<AudioFilterBusDescription>& descriptions, float** channels,
                   std::vector<AudioBusBuffers>& buses)
{
    buses.assign(descriptions.size(), AudioBusBuffers());
    float** next = channels;
    for (std::size_t index = 0; index < descriptions.size(); ++index)
    {
        buses[index].numChannels = descriptions[index].GetChannelCount();
        buses[index].channelBuffers32 = next;
        next += buses[index].numChannels;
    }
}

// The bits of each bus's channels among all channels of the filter.
std::vector<unsigned long long> BitsOfBuses(const std::vector<AudioFilterBusDescription>& descriptions)
{
    std::vector<unsigned long long> bits;
    unsigned int channel = 0;
    for (const AudioFilterBusDescription& description : descriptions)
    {
        bits.push_back(0);
        for (int index = 0; index < description.GetChannelCount(); ++index)
            bits.back() |= ChannelBit(channel++);
    }
    return bits;
}

// Takes the buses out of `data`, and puts them back in the end.
class WithoutBuses
{
public:
    explicit WithoutBuses(Steinberg::Vst::ProcessData& data) : mData(data), mSaved(data)
    {
        mData.numSamples = 0;
        mData.numInputs = 0;
        mData.numOutputs = 0;
        mData.inputs = nullptr;
        mData.outputs = nullptr;
    }
    ~WithoutBuses()
    {
        mData.numSamples = mSaved.numSamples;
        mData.numInputs = mSaved.numInputs;
        mData.numOutputs = mSaved.numOutputs;
        mData.inputs = mSaved.inputs;
        mData.outputs = mSaved.outputs;
    }
    WithoutBuses(const WithoutBuses&) = delete;
    WithoutBuses& operator=(const WithoutBuses&) = delete;

private:
    Steinberg::Vst::ProcessData& mData;
    const Steinberg::Vst::ProcessData mSaved;
};

} // namespace

void VST3AudioFilter::SetSampleRate(float sampleRate)
{
    AudioFilter::SetSampleRate(sampleRate);
    mProcessContext.sampleRate = static_cast<double>(sampleRate);
}

void VST3AudioFilter::SetBlockSize(int blockSize)
{
    AudioFilter::SetBlockSize(blockSize);
}

int VST3AudioFilter::GetMaxProcessingBlockSize() const
{
    return mMaxBlockSize;
}

unsigned int VST3AudioFilter::GetTail() const
{
    return mInitialized ? mProcessor->getTailSamples() : 0;
}

// While audio runs the plug-in is not asked.
int VST3AudioFilter::GetInitialDelay() const
{
    if (mSuspended && mInitialized)
        return static_cast<int>(mProcessor->getLatencySamples());
    return mLatency;
}

void VST3AudioFilter::Resume()
{
    if (!mInitialized)
    {
        AudioFilter::Resume();
        return;
    }
    TakeOfferedQueues();
    SetupProcessing();
    AllocateBusBuffers();
    FillProcessData();
    mComponent->setActive(1);
    // Behind setActive, and never switched off again.
    if (GetSideChainTargetBusChannelCount() != 0)
        ActivateBuses(Steinberg::Vst::kInput, Steinberg::Vst::kAux);
    mProcessErrorReported = false;
    // The delay line is sized in here, by the latency known so far: one that the plug-in finds only now takes effect
    // with the next Resume.
    AudioFilter::Resume();
    mLatency = static_cast<int>(mProcessor->getLatencySamples());
}

void VST3AudioFilter::Suspend()
{
    AudioFilter::Suspend();
    if (!mInitialized)
        return;
    if (mProcessing)
    {
        mProcessor->setProcessing(0);
        mProcessing = false;
    }
    mComponent->setActive(0);
    FreeBusBuffers();
}

void VST3AudioFilter::SetupProcessing()
{
    const bool offline = mRenderingContext == kRenderingContext_Offline;
    Steinberg::Vst::ProcessSetup setup = {};
    setup.processMode = offline ? Steinberg::Vst::kOffline : Steinberg::Vst::kRealtime;
    setup.symbolicSampleSize = Steinberg::Vst::kSample32;
    setup.maxSamplesPerBlock = mBlockSize;
    setup.sampleRate = static_cast<double>(mSampleRate);
    mProcessor->setupProcessing(setup);
}

void VST3AudioFilter::AllocateBusBuffers()
{
    FreeBusBuffers();
    const auto frames = static_cast<std::size_t>(std::max(mMaxBlockSize, mBlockSize));
    mSilence.assign(frames, 0.0F);
    mDiscard.assign(frames, 0.0F);
    mInputChannels.assign(static_cast<std::size_t>(GetNumberOfInputChannels()) + kSpareChannels, mSilence.data());
    mOutputChannels.assign(static_cast<std::size_t>(GetNumberOfOutputChannels()) + kSpareChannels, mDiscard.data());
    AllocateBuses(GetInputBuses(), mInputChannels.data(), mInputBuffers);
    mInputBits = BitsOfBuses(GetInputBuses());
    AllocateBuses(GetOutputBuses(), mOutputChannels.data(), mOutputBuffers);
}

void VST3AudioFilter::FreeBusBuffers()
{
    mInputBuffers.clear();
    mInputBits.clear();
    mOutputBuffers.clear();
    mInputChannels.clear();
    mOutputChannels.clear();
    mProcessData.numInputs = 0;
    mProcessData.numOutputs = 0;
    mProcessData.inputs = nullptr;
    mProcessData.outputs = nullptr;
}

void VST3AudioFilter::FillProcessData()
{
    // The mode stays real time in offline rendering too: plug-ins learn about that from setupProcessing alone.
    mProcessData.processMode = Steinberg::Vst::kRealtime;
    mProcessData.symbolicSampleSize = Steinberg::Vst::kSample32;
    mProcessData.numInputs = static_cast<int32>(mInputBuffers.size());
    mProcessData.numOutputs = static_cast<int32>(mOutputBuffers.size());
    mProcessData.inputs = mInputBuffers.data();
    mProcessData.outputs = mOutputBuffers.data();
    mProcessData.inputParameterChanges = &mInputChanges;
    mProcessData.outputParameterChanges = &mOutputChanges;
    mProcessData.inputEvents = mInputEvents.Get();
    mProcessData.outputEvents = mOutputEvents.Get();
    mProcessData.processContext = &mProcessContext;
}

void VST3AudioFilter::FlushMessageQueue()
{
    ProcessMessageHandler::FlushMessageQueue();
    FlushParameterChanges();
}

// A call of process without samples, by which plug-ins take parameters while no audio runs. They get it while they
// are not active, too.
void VST3AudioFilter::FlushParameterChanges()
{
    if (!mSuspended || !mInitialized || mFlushing.exchange(true))
        return;
    const ScopeExit done([this] { mFlushing = false; });
    const FloatingPointMode mode; // the main thread's
    TakeOfferedQueues();
    try
    {
        mOutputChanges.ClearQueue();
        const ScopeExit cleared([this] { ClearProcessedInput(); });
        if (!mInputTransfer.TransferChangesTo(mInputChanges))
            return;
        const WithoutBuses withoutBuses(mProcessData);
        CallProcess();
        mOutputTransfer.TransferChangesFrom(mOutputChanges);
    }
    catch (...) // what a plug-in throws goes no further
    {
    }
}

boost::intrusive_ptr<AudioFilter> VST3AudioFilter::Clone() const
{
    boost::intrusive_ptr<AudioFilter> clone = AudioFilter::Clone();
    if (auto* filter = dynamic_cast<VST3AudioFilter*>(clone.get()))
    {
        mInputTransfer.CopyTo(filter->mInputTransfer);
        mOutputTransfer.CopyTo(filter->mOutputTransfer);
    }
    return clone;
}

} // namespace zebaudiofilterhost::vst3
