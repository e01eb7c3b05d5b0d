#pragma once

#include "tests/realtime/Subject.h"

#include <array>
#include <atomic>
#include <iosfwd>
#include <random>

namespace realtimeproof
{

// What happened in a run, so that a run in which nothing happened proves nothing.
struct Traffic
{
    long blocks = 0;
    int smallest = 0; // frames
    int largest = 0;
    bool hasSounded = false; // the plug-in itself
    long messages = 0;
    long messagesRun = 0; // at least
    long mapEdits = 0;
    long presets = 0;
    long ticks = 0;
    long elsewhere = 0;      // rounds of the third thread
    std::atomic<long> heard; // changed parameters that the application was told of
};

std::ostream& operator<<(std::ostream& out, const Traffic& traffic);

// Answers all that a plug-in may ask of its host.
class AnsweringHost final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat& format, int& first, int& second) const override;
    bool GetTempo(utility::Tempo& tempo) const override;
    bool GetTransportState(bool& playing, bool& recording, bool& looping) const override;
};

// Blocks of random length on a process thread under the nets of the realtime guard, while the main thread posts,
// edits maps, loads presets and ticks, and a third thread does what a plug-in's own threads do. In stretches, between
// which the filter is suspended and gets other buses, targets and block sizes; ahead of the first one a few blocks
// are not watched, and what a later one needs, Resume has to prepare.
class RealtimeRun
{
public:
    static constexpr int kWarmUp = 200; // blocks, once in a run

    RealtimeRun(Subject& subject, long blocks);
    ~RealtimeRun();
    RealtimeRun(const RealtimeRun&) = delete;
    RealtimeRun& operator=(const RealtimeRun&) = delete;

    void Go();
    const Traffic& GetTraffic() const { return mTraffic; }

private:
    static constexpr int kStretches = 8;
    static constexpr int kTurn = 32;            // blocks
    static constexpr std::size_t kChannels = 8; // of the application, its side chain included
    static constexpr std::size_t kMaxFrames = 2048;

    using Samples = std::array<std::array<float, kMaxFrames>, kChannels>;
    using Random = std::minstd_rand;

    // Main thread.
    void SetUp(int stretch);
    void KeepPresets();
    void RunStretch(bool first);
    void WorkOnMain(int round);
    void EditMaps(int round);
    void ChangePreset(int round);
    int AnyChannel() { return static_cast<int>(mMainRandom() % kChannels); }

    // The process thread.
    void Process(bool first);
    void ProcessTurn(long blocks);
    void ProcessBlock();
    int NextFrames();

    void WorkElsewhere();
    template <class Work>
    void EachBlock(const std::atomic<bool>& end, std::atomic<int>& rounds, const Work& work) const;

    Subject& mSubject;
    AudioFilter& mFilter;
    AnsweringHost mHost;
    boost::signals2::scoped_connection mConnection;
    std::array<PropList, 2> mPresets;
    Traffic mTraffic;
    Random mMainRandom{1};
    int mBlockSize = 0;

    Random mProcessRandom{2};
    long long mPosition = 0;
    long mBlocksOfStretch;
    Samples mInput{};
    Samples mOutput{};
    std::array<float, kMaxFrames> mZeros{};
    std::array<float*, kChannels> mIn{};
    std::array<float*, kChannels> mOut{};

    std::atomic<long> mBlocks{0};
    std::atomic<int> mMainRounds{0};
    std::atomic<int> mOtherRounds{0};
    std::atomic<bool> mStretchIsOver{true};
    std::atomic<bool> mAllIsOver{false};
};

} // namespace realtimeproof
