#include "Specimen.h"

#include <algorithm>
#include <bit>
#include <random>

namespace soak
{

using namespace zebaudiofilterhost;

namespace
{

/// Tells 120 in 4/4, playing.
class SteadyHost final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat&, int&, int&) const override { return false; }

    bool GetTempo(utility::Tempo& tempo) const override
    {
        tempo.mTempo = 120.0;
        tempo.mNumerator = 4;
        tempo.mDenominator = 4;
        return true;
    }

    bool GetTransportState(bool& playing, bool& recording, bool& looping) const override
    {
        playing = true;
        recording = looping = false;
        return true;
    }
};

SteadyHost sHost; // outlives every filter

/// Buffers for one channel after the other, and pointers to them as a filter takes them.
class Channels
{
public:
    Channels(int count, int frames)
        : mSamples(static_cast<std::size_t>(count) * static_cast<std::size_t>(frames)), mFrames(frames)
    {
        for (int channel = 0; channel < count; ++channel)
        {
            mPointers.push_back(mSamples.data() + static_cast<std::ptrdiff_t>(channel) * frames);
        }
    }

    float** Pointers() { return mPointers.data(); }

    void FillWithNoise(std::minstd_rand& random, int frames)
    {
        std::uniform_real_distribution<float> noise(-0.25F, 0.25F);
        for (float* channel : mPointers)
        {
            std::generate_n(channel, std::min(frames, mFrames), [&] { return noise(random); });
        }
    }

    void AddToHash(std::uint64_t& hash, int frames) const
    {
        constexpr std::uint64_t kPrime = 0x100000001B3;
        for (const float* channel : mPointers)
        {
            std::for_each_n(channel, frames,
                            [&hash](float sample) { hash = (hash ^ std::bit_cast<std::uint32_t>(sample)) * kPrime; });
        }
    }

private:
    std::vector<float> mSamples;
    std::vector<float*> mPointers;
    int mFrames;
};

int WidestSide(const AudioFilter& filter, const Setup& setup)
{
    return std::max(
        {setup.bus.GetChannelCount(), filter.GetNumberOfInputChannels(), filter.GetNumberOfOutputChannels(), 1});
}

// The latency may be another one once the filter runs: what passes by it is then aligned by starting again.
void Start(AudioFilter& filter)
{
    const int before = filter.GetInitialDelay();
    filter.Resume();
    if (filter.GetInitialDelay() != before)
    {
        filter.Suspend();
        filter.Resume();
    }
}

} // namespace

Specimen::Specimen(const Subject& subject, const FilterPointer& filter) : mSubject(subject), mFilter(filter)
{
    mFilter->SetAudioFilterHost(&sHost);
}

Specimen::~Specimen()
{
    try
    {
        Close();
    }
    catch (...)
    {
    }
}

void Specimen::Close()
{
    CloseEditor();
    Suspend();
}

void Specimen::Suspend()
{
    if (mIsRunning)
    {
        mFilter->Suspend();
        mIsRunning = false;
    }
}

void Specimen::Configure(const Setup& setup)
{
    Suspend();
    mSetup = setup;
    mFilter->RequestIOConfiguration({setup.bus.GetLayout()}, {setup.bus.GetLayout()});
    mFilter->SetMainTargetBus(setup.bus);
    mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
    mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Output);
    mFilter->SetUseChannelMap(setup.mapped);
    mFilter->SetSampleRate(setup.sampleRate);
    mFilter->SetBlockSize(setup.blockSize);
    Start(*mFilter);
    mIsRunning = true;
}

std::uint64_t Specimen::Process(const std::vector<int>& sizes, std::uint32_t noiseStart, ProcessThread& thread)
{
    std::uint64_t hash = 0xCBF29CE484222325;
    const int count = WidestSide(*mFilter, mSetup);
    Channels in(count, mSetup.blockSize);
    Channels out(count, mSetup.blockSize);
    thread.Run(
        [&]
        {
            std::minstd_rand random(noiseStart);
            long long position = 0;
            for (const int frames : sizes)
            {
                in.FillWithNoise(random, frames);
                ChannelFlags silent;
                mFilter->SetCurrentOffset(position);
                mFilter->ProcessWithMapping(in.Pointers(), out.Pointers(), frames, ChannelFlags(), silent);
                out.AddToHash(hash, frames);
                position += frames;
            }
        });
    return hash;
}

void Specimen::OpenEditor()
{
    if (mEditor || !mFilter->HasCustomEditor())
    {
        return;
    }
    const boost::intrusive_ptr<AudioFilterEditor> editor = mFilter->CreateCustomEditor();
    if (editor != nullptr && editor->CanEmbedView())
    {
        mEditor.emplace(editor);
    }
}

void Specimen::CloseEditor()
{
    if (mEditor)
    {
        mEditor->Close();
    }
    mEditor.reset();
}

} // namespace soak
