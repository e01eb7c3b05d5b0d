#include "benchmarks/process/Block.h"
#include "benchmarks/process/Bypass.h"
#include "benchmarks/process/OurWay.h"
#include "benchmarks/process/Work.h"

#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

// The effect behind a map, or without one.
class MapWork final : public Work
{
public:
    MapWork(int frames, OurWay::Map map)
        : mWay(kBenchEffect4, frames, map), mMap(map), mIn(2, frames), mOut(2, frames)
    {
        mIn.Fill(0);
    }

    void Run() override { mWay.Process(mIn.GetChannels(), mOut.GetChannels(), mIn.GetFrames()); }

    void Verify() override
    {
        mOut.Clear();
        Run();
        for (int channel = 0; channel < 2; ++channel)
            for (int frame = 0; frame < mIn.GetFrames(); ++frame)
            {
                const int source = mMap == OurWay::Map::kSwappedOutputs ? 1 - channel : channel;
                if (mOut.GetChannels()[channel][frame] != -Block::GetSample(source, frame))
                    throw std::runtime_error("the map leads elsewhere");
            }
    }

private:
    OurWay mWay;
    OurWay::Map mMap;
    Block mIn;
    Block mOut;
};

void AddMapRow(std::vector<Case>& cases, const std::string& name, int frames, OurWay::Map map)
{
    const std::string row = "P9/" + name + "/frames:" + std::to_string(frames);
    cases.push_back({row, "ours",
                     [=]
                     {
                         return std::make_unique<MapWork>(frames, map);
                     }});
    cases.push_back({row, "again", nullptr});
    cases.push_back({row, "nomap",
                     [=]
                     {
                         return std::make_unique<MapWork>(frames, OurWay::Map::kNone);
                     }});
}

void AddBypassRow(std::vector<Case>& cases, int channels, int latency)
{
    const std::string row = "P9/bypass/channels:" + std::to_string(channels) + "/latency:" + std::to_string(latency);
    cases.push_back({row, "ours",
                     [=]
                     {
                         return std::make_unique<FilterBypassWork>(channels, latency);
                     }});
    cases.push_back({row, "again", nullptr});
    cases.push_back({row, "copy",
                     [=]
                     {
                         return std::make_unique<CopyBypassWork>(channels, latency);
                     }});
}

} // namespace

void AddMapCases(std::vector<Case>& cases)
{
    for (const int frames : {64, 512})
    {
        AddMapRow(cases, "identity", frames, OurWay::Map::kIdentity);
        AddMapRow(cases, "swap", frames, OurWay::Map::kSwappedOutputs);
    }
    for (const int latency : {0, 1000, 48000})
    {
        AddBypassRow(cases, kTargetChannels - 2, latency); // one pair of 8
        AddBypassRow(cases, kTargetChannels, latency);
    }
}

} // namespace zebaudiofilterhost::benchmarks
