#include "benchmarks/peer/PeerFilter.h"

#include <juce_audio_processors/juce_audio_processors.h>

namespace zebaudiofilterhost::benchmarks
{

struct PeerFilter::Impl
{
    juce::ScopedJuceInitialiser_GUI initialiser; // counted: the peer's main thread is that of the first
    juce::VST3PluginFormat format;
    juce::MidiBuffer notes;
    std::unique_ptr<juce::AudioPluginInstance> instance; // goes before what it was made with
    std::string error;
};

PeerFilter::PeerFilter() : mImpl(std::make_unique<Impl>())
{
}

PeerFilter::~PeerFilter() = default;

bool PeerFilter::Load(const std::string& bundle, const std::string& name)
{
    juce::OwnedArray<juce::PluginDescription> found;
    mImpl->format.findAllTypesForFile(found, bundle);
    for (const juce::PluginDescription* description : found)
    {
        if (!name.empty() && description->name != juce::String(name))
            continue;
        constexpr double kAnyRate = 48000.0; // Prepare sets both
        constexpr int kAnyBlock = 512;
        juce::String error;
        mImpl->instance = mImpl->format.createInstanceFromDescription(*description, kAnyRate, kAnyBlock, error);
        mImpl->error = error.toStdString();
        return mImpl->instance != nullptr;
    }
    mImpl->error = "no such effect in " + bundle;
    return false;
}

const std::string& PeerFilter::GetError() const
{
    return mImpl->error;
}

void PeerFilter::Prepare(double sampleRate, int frames)
{
    mImpl->instance->enableAllBuses();
    mImpl->instance->setRateAndBufferSizeDetails(sampleRate, frames);
    mImpl->instance->prepareToPlay(sampleRate, frames);
}

void PeerFilter::Process(float** channels, int channelCount, int frames)
{
    juce::AudioBuffer<float> buffer(channels, channelCount, frames);
    mImpl->instance->processBlock(buffer, mImpl->notes);
}

void PeerFilter::SetParameter(int index, float value)
{
    mImpl->instance->getParameters().getUnchecked(index)->setValue(value);
}

int PeerFilter::GetParameterCount() const
{
    return mImpl->instance->getParameters().size();
}

float PeerFilter::GetParameter(int index) const
{
    return mImpl->instance->getParameters()[index]->getValue();
}

std::vector<char> PeerFilter::GetState() const
{
    juce::MemoryBlock state;
    mImpl->instance->getStateInformation(state);
    return {state.begin(), state.end()};
}

void PeerFilter::SetState(const std::vector<char>& state)
{
    mImpl->instance->setStateInformation(state.data(), static_cast<int>(state.size()));
}

} // namespace zebaudiofilterhost::benchmarks
