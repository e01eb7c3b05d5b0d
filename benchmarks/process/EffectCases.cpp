#include "benchmarks/process/Block.h"
#include "benchmarks/process/DirectWay.h"
#include "benchmarks/process/OurWay.h"
#include "benchmarks/process/Work.h"

#ifdef ZEB_HAS_PEER
#include "benchmarks/process/PeerWay.h"
#endif

#include <stdexcept>
#include <utility>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

using MakeWay = std::function<std::unique_ptr<Way>(const std::string& effect, int frames)>;

enum class Changes
{
    kNone,
    kPosted, // by the application
    kEdited  // by the plug-in's editor
};

constexpr int kChangesOfBlock = 16;
constexpr int kFramesOfChanges = 512;
constexpr int kBlocksOfTick = 2; // of that size, as near as they come to the library's 20 ms

// One effect that goes on processing one block.
class EffectWork final : public Work
{
public:
    EffectWork(std::unique_ptr<Way> way, int frames, Changes changes)
        : mWay(std::move(way)), mBlock(2, frames), mChanges(changes)
    {
        mBlock.Fill(0);
    }

    void Run() override
    {
        if (mChanges != Changes::kNone)
            Change();
        mWay->Process(mBlock.GetChannels(), mBlock.GetFrames());
    }

    void Verify() override
    {
        BenchSide& side = mWay->GetSide();
        for (int block = 0; block < 4; ++block)
        {
            mBlock.Fill(block);
            const long long before = side.GetPointsReceived();
            Run();
            CheckSignal(block);
            const int expected = mChanges == Changes::kNone ? 0 : kChangesOfBlock;
            if (side.GetPointsReceived() - before != expected)
                throw std::runtime_error("the plug-in got other than " + std::to_string(expected) + " changes");
            if (expected != 0 && side.GetProcessedValue(kChangesOfBlock - 1) != static_cast<double>(mValue))
                throw std::runtime_error("the plug-in got another value");
        }
    }

private:
    void Change()
    {
        constexpr float kOne = 0.25F;
        constexpr float kOther = 0.75F;
        mValue = mValue == kOne ? kOther : kOne;
        if (mChanges == Changes::kPosted)
            mWay->PostChanges(kChangesOfBlock, mValue);
        else
            mWay->GetSide().PerformEdits(0, kChangesOfBlock, static_cast<double>(mValue));
        if (++mBlocks % kBlocksOfTick == 0)
            mWay->Tick();
    }

    void CheckSignal(int firstFrame)
    {
        for (int channel = 0; channel < mBlock.GetChannelCount(); ++channel)
            for (int frame = 0; frame < mBlock.GetFrames(); ++frame)
                if (mBlock.GetChannels()[channel][frame] != -Block::GetSample(channel, firstFrame + frame))
                    throw std::runtime_error("the plug-in did not process the signal");
    }

    std::unique_ptr<Way> mWay;
    Block mBlock;
    Changes mChanges;
    float mValue = 0.0F;
    int mBlocks = 0;
};

template <class Kind>
std::unique_ptr<Way> Make(const std::string& effect, int frames)
{
    return std::make_unique<Kind>(effect, frames);
}

// Direct first: it is what the control repeats.
const std::pair<const char*, MakeWay> kWays[] = {
    {"direct", Make<DirectWay>},
    {"again", nullptr},
    {"ours",
     [](const std::string& effect, int frames)
     {
         return std::make_unique<OurWay>(effect, frames);
     }},
#ifdef ZEB_HAS_PEER
    {"peer", Make<PeerWay>},
#endif
};

void AddRow(std::vector<Case>& cases, const std::string& row, const char* effect, int frames, Changes changes)
{
    for (const auto& [way, make] : kWays)
    {
        Case added{row, way, nullptr};
        if (make)
            added.make = [=, makeWay = make]
            {
                return std::make_unique<EffectWork>(makeWay(effect, frames), frames, changes);
            };
        cases.push_back(std::move(added));
    }
}

} // namespace

void AddEffectCases(std::vector<Case>& cases)
{
    for (int frames = 16; frames <= 1024; frames *= 2)
        AddRow(cases, "P1/frames:" + std::to_string(frames), kBenchEffect4, frames, Changes::kNone);
    for (const auto& [count, effect] :
         {std::pair(4, kBenchEffect4), std::pair(512, kBenchEffect512), std::pair(4096, kBenchEffect4096)})
        AddRow(cases, "P2/parameters:" + std::to_string(count), effect, 64, Changes::kNone);
    AddRow(cases, "P3/posted", kBenchEffect512, kFramesOfChanges, Changes::kPosted);
    AddRow(cases, "P3/edited", kBenchEffect512, kFramesOfChanges, Changes::kEdited);
}

} // namespace zebaudiofilterhost::benchmarks
