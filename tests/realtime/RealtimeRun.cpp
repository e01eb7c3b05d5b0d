#include "tests/realtime/RealtimeRun.h"

#include "audiofilter/src/ChannelMapEditing.h"
#include "foundation/zebcore/MainThreadLoop.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <ostream>
#include <thread>

namespace realtimeproof
{

namespace
{

using Bus = AudioFilterBusDescription;

ChannelLayout LayoutOf(int channels)
{
    if (channels == 6)
        return Bus::CreateSurround51(u"", Bus::kBusType_Main).GetLayout();
    return channels == 2 ? zebmediatypes::CreateStereoChannelLayout()
                         : ChannelLayout(static_cast<std::size_t>(channels));
}

} // namespace

std::ostream& operator<<(std::ostream& out, const Traffic& traffic)
{
    return out << traffic.blocks << " blocks of " << traffic.smallest << " to " << traffic.largest << " frames, "
               << traffic.messages << " messages, " << traffic.mapEdits << " map edits, " << traffic.presets
               << " presets, " << traffic.ticks << " ticks, " << traffic.elsewhere
               << " rounds of a third thread, heard of " << traffic.heard << " changes";
}

bool AnsweringHost::GetTimeInfo(utility::TimecodeFormat& /*format*/, int& /*first*/, int& /*second*/) const
{
    return false;
}

bool AnsweringHost::GetTempo(utility::Tempo& tempo) const
{
    tempo.mTempo = 120.0;
    tempo.mNumerator = 4;
    tempo.mDenominator = 4;
    return true;
}

bool AnsweringHost::GetTransportState(bool& playing, bool& /*recording*/, bool& /*looping*/) const
{
    playing = true;
    return true;
}

RealtimeRun::RealtimeRun(Subject& subject, long blocks)
    : mSubject(subject), mFilter(subject.Filter()), mBlocksOfStretch(std::max(blocks / kStretches, 1L))
{
    InitializeMainThreadID();
    mFilter.SetAudioFilterHost(&mHost);
    mFilter.SetSampleRate(48000.0F);
    mConnection = mFilter.ConnectAutomatedParameterChange([this](int, float) { ++mTraffic.heard; });
    for (auto& channel : mInput)
        channel.fill(0.5F);
    for (std::size_t channel = 0; channel < kChannels; ++channel)
        mOut[channel] = mOutput[channel].data();
}

RealtimeRun::~RealtimeRun()
{
    mFilter.SetAudioFilterHost(nullptr);
}

void RealtimeRun::Go()
{
    KeepPresets();
    realtimeguard::PrepareProcess();
    const unsigned int before = mFilter.GetParameterDirtyCount();
    std::thread elsewhere([this] { WorkElsewhere(); });
    for (int stretch = 0; stretch < kStretches; ++stretch)
    {
        SetUp(stretch);
        mFilter.Resume();
        RunStretch(stretch == 0);
        mFilter.Suspend();
    }
    mAllIsOver = true;
    elsewhere.join();
    // Messages that nobody has taken keep their filter, and a flush takes no more than the ring holds.
    for (int flush = 0; flush < 256; ++flush)
        mFilter.FlushMessageQueue();
    mTraffic.messagesRun = static_cast<long>(mFilter.GetParameterDirtyCount() - before);
    mTraffic.blocks = mBlocks;
    mTraffic.elsewhere = mOtherRounds;
    zebcore::threads::RunMainThreadUntil([this] { return mTraffic.heard > 0; }, 5000);
}

void RealtimeRun::KeepPresets()
{
    for (std::size_t index = 0; index < mPresets.size(); ++index)
    {
        mFilter.SetParameter(0, 0.25F + 0.5F * static_cast<float>(index));
        mFilter.OnUITimerTick();
        PresetData preset(mPresets[index]);
        mFilter.SaveSettings(preset);
    }
}

void RealtimeRun::SetUp(int stretch)
{
    constexpr std::array<int, 4> kBlockSizes = {kMaxFrames, 64, 1500, 512};
    const auto place = static_cast<std::size_t>(stretch);
    const ChannelLayout layout = LayoutOf(mSubject.Channels()[place % mSubject.Channels().size()]);
    mFilter.RequestIOConfiguration({layout}, {layout});
    mBlockSize = kBlockSizes[place % kBlockSizes.size()];
    mFilter.SetBlockSize(mBlockSize);
    mFilter.SetMainTargetBus(stretch % 3 == 1 ? Bus::CreateStereo(u"Main", Bus::kBusType_Main)
                                              : Bus::CreateSurround51(u"Main", Bus::kBusType_Main));
    mFilter.SetSideChainTargetBus(stretch % 2 == 0 ? Bus::CreateStereo(u"Side", Bus::kBusType_SideChain) : Bus());
    mFilter.SetUseChannelMap(stretch % 4 != 3);
    mFilter.SetDefaultChannelMap(AudioFilter::kDirection_Input);
    mFilter.SetDefaultChannelMap(AudioFilter::kDirection_Output);
}

void RealtimeRun::RunStretch(bool first)
{
    mStretchIsOver = false;
    std::thread process([this, first] { Process(first); });
    EachBlock(mStretchIsOver, mMainRounds, [this](int round) { WorkOnMain(round); });
    process.join();
}

// Works no oftener than blocks come, so that nothing piles up while the process thread does not get a processor.
template <class Work>
void RealtimeRun::EachBlock(const std::atomic<bool>& end, std::atomic<int>& rounds, const Work& work) const
{
    for (long seen = -1; !end;)
    {
        if (const long blocks = mBlocks.load(std::memory_order_relaxed); blocks != seen)
        {
            seen = blocks;
            work(rounds.load());
            ++rounds;
        }
        else
            std::this_thread::yield();
    }
}

void RealtimeRun::WorkOnMain(int round)
{
    mFilter.PostSetParameter(0, static_cast<float>(1 + round % 100) / 100.0F);
    ++mTraffic.messages;
    EditMaps(round);
    if (round % 16 == 0)
        ChangePreset(round / 16);
    mSubject.WorkOnMain(round);
    mFilter.OnUITimerTick();
    zebcore::threads::PumpMainThread();
    ++mTraffic.ticks;
}

void RealtimeRun::EditMaps(int round)
{
    const auto direction = round % 2 == 0 ? AudioFilter::kDirection_Input : AudioFilter::kDirection_Output;
    const int plugChannel = round % 3;
    ChannelMap map;
    switch (round % 5)
    {
    case 0:
        mFilter.RemoveChannelMapping(direction, plugChannel);
        break;
    case 1:
        channelmaps::CreateEmptyChannelMap(kChannels, false, map);
        for (const int channel : {0, 1})
            channelmaps::SetMapping(map, channel, AnyChannel());
        mFilter.SetChannelMap(map, direction);
        break;
    case 2:
        mFilter.AutoConnectSideChainChannels(round % 3 == 0);
        break;
    default:
        mFilter.AssignChannelMapping(direction, plugChannel, AnyChannel());
    }
    ++mTraffic.mapEdits;
}

void RealtimeRun::ChangePreset(int round)
{
    const int factoryPresets = mFilter.GetNumFactoryPresets();
    if (factoryPresets > 0 && round % 3 == 0)
        mFilter.SetFactoryPreset(round % factoryPresets);
    else if (!mFilter.LoadSettings(PresetData(mPresets[static_cast<std::size_t>(round) % mPresets.size()])))
        return;
    ++mTraffic.presets;
}

void RealtimeRun::WorkElsewhere()
{
    EachBlock(mAllIsOver, mOtherRounds, [this](int round) { mSubject.WorkElsewhere(round); });
}

void RealtimeRun::Process(bool first)
{
    realtimeguard::PrepareThread();
    for (int block = 0; first && block < kWarmUp; ++block)
        ProcessBlock();
    for (long block = 0; block < mBlocksOfStretch; block += kTurn)
    {
        const int mainRounds = mMainRounds;
        const int otherRounds = mOtherRounds;
        ProcessTurn(std::min<long>(kTurn, mBlocksOfStretch - block));
        while (mMainRounds == mainRounds || mOtherRounds == otherRounds)
            std::this_thread::yield();
    }
    mStretchIsOver = true;
}

void RealtimeRun::ProcessTurn(long blocks)
{
    const realtimeguard::UsageSection usage;
    for (long block = 0; block < blocks; ++block)
    {
        const realtimeguard::Section section;
        ProcessBlock();
        mBlocks.fetch_add(1, std::memory_order_relaxed);
    }
}

// As many short ones as long ones, by powers of two.
int RealtimeRun::NextFrames()
{
    const unsigned int octaves = static_cast<unsigned int>(std::bit_width(static_cast<unsigned int>(mBlockSize))) + 1;
    const unsigned int span = 1U << mProcessRandom() % octaves;
    return std::min(1 + static_cast<int>(mProcessRandom() % span), mBlockSize);
}

void RealtimeRun::ProcessBlock()
{
    const int frames = NextFrames();
    mTraffic.smallest = mTraffic.smallest == 0 ? frames : std::min(mTraffic.smallest, frames);
    mTraffic.largest = std::max(mTraffic.largest, frames);
    // Silence comes and goes with the channels' buffers; a plug-in that adds to its outputs finds them empty.
    ChannelFlags silent;
    const auto silentBits = mProcessRandom() % 4 == 0 ? mProcessRandom() : 0;
    for (std::size_t channel = 0; channel < kChannels; ++channel)
    {
        const bool isSilent = (silentBits >> channel & 1U) != 0;
        if (isSilent)
            silent.Set(ChannelBit(static_cast<unsigned int>(channel)));
        mIn[channel] = isSilent ? mZeros.data() : mInput[channel].data();
        std::memset(mOut[channel], 0, static_cast<std::size_t>(frames) * sizeof(float));
    }
    ChannelFlags outSilent;
    mFilter.SetCurrentOffset(mPosition);
    mFilter.ProcessWithMapping(mIn.data(), mOut.data(), frames, silent, outSilent);
    mPosition += frames;
    // Without maps nothing passes by the plug-in, so this is its own.
    if (!mFilter.GetUseChannelMap() && mOut[0][frames - 1] != 0.0F)
        mTraffic.hasSounded = true;
}

} // namespace realtimeproof
