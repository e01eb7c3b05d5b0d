// A gain behind a fixed look-ahead, with an editor: latency to see at the right sample, a parameter to save and
// restore, and a window to open.

#include <juce_audio_utils/juce_audio_utils.h>

namespace
{

constexpr int kLatency = 64;

class StrangerEffect final : public juce::AudioProcessor
{
public:
    StrangerEffect()
        : AudioProcessor(BusesProperties()
                             .withInput("Input", juce::AudioChannelSet::stereo())
                             .withOutput("Output", juce::AudioChannelSet::stereo()))
    {
        addParameter(mGain = new juce::AudioParameterFloat({"gain", 1}, "Gain", 0.0F, 2.0F, 0.5F));
        addParameter(mInvert = new juce::AudioParameterBool({"invert", 1}, "Invert", false));
        setLatencySamples(kLatency);
    }

    const juce::String getName() const override { return "Stranger"; }
    bool acceptsMidi() const override { return false; }
    bool producesMidi() const override { return false; }
    double getTailLengthSeconds() const override { return 0.0; }
    int getNumPrograms() override { return 1; }
    int getCurrentProgram() override { return 0; }
    void setCurrentProgram(int /*index*/) override {}
    const juce::String getProgramName(int /*index*/) override { return {}; }
    void changeProgramName(int /*index*/, const juce::String& /*name*/) override {}
    bool hasEditor() const override { return true; }
    juce::AudioProcessorEditor* createEditor() override { return new juce::GenericAudioProcessorEditor(*this); }

    bool isBusesLayoutSupported(const BusesLayout& layouts) const override
    {
        const auto& set = layouts.getMainOutputChannelSet();
        return set == layouts.getMainInputChannelSet() &&
               (set == juce::AudioChannelSet::mono() || set == juce::AudioChannelSet::stereo());
    }

    void prepareToPlay(double /*sampleRate*/, int /*blockSize*/) override
    {
        mDelayed.setSize(2, kLatency);
        mDelayed.clear();
        mPosition = 0;
    }

    void releaseResources() override {}

    void processBlock(juce::AudioBuffer<float>& buffer, juce::MidiBuffer& /*midi*/) override
    {
        const float gain = mInvert->get() ? -mGain->get() : mGain->get();
        for (int frame = 0; frame < buffer.getNumSamples(); ++frame)
        {
            for (int channel = 0; channel < std::min(buffer.getNumChannels(), 2); ++channel)
            {
                float& held = mDelayed.getWritePointer(channel)[mPosition];
                float& sample = buffer.getWritePointer(channel)[frame];
                std::swap(held, sample);
                sample *= gain;
            }
            mPosition = (mPosition + 1) % kLatency;
        }
    }

    void getStateInformation(juce::MemoryBlock& state) override
    {
        juce::MemoryOutputStream stream(state, false);
        stream.writeFloat(mGain->get());
        stream.writeBool(mInvert->get());
    }

    void setStateInformation(const void* data, int size) override
    {
        juce::MemoryInputStream stream(data, static_cast<size_t>(size), false);
        mGain->setValueNotifyingHost(mGain->convertTo0to1(stream.readFloat()));
        mInvert->setValueNotifyingHost(stream.readBool() ? 1.0F : 0.0F);
    }

private:
    juce::AudioParameterFloat* mGain = nullptr;
    juce::AudioParameterBool* mInvert = nullptr;
    juce::AudioBuffer<float> mDelayed;
    int mPosition = 0;
};

} // namespace

juce::AudioProcessor* JUCE_CALLTYPE createPluginFilter()
{
    return new StrangerEffect();
}
