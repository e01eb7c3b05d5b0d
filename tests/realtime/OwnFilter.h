#pragma once

#include "tests/realtime/Subject.h"

#include <array>
#include <atomic>
#include <functional>

namespace realtimeproof
{

// A filter of the application's own: a gain with latency, a side chain that opens it, and parameters that any thread
// may set. It can do one thing that it must not.
class OwnFilter final : public AudioFilter
{
public:
    OwnFilter();

    int GetInitialDelay() const override { return 37; }
    int GetParameterCount() const override { return static_cast<int>(mValues.size()); }
    void SetParameter(int index, float value) override;
    float GetParameter(int index) const override;
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override;
    void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags) override;

    // In that block, from 0.
    void Plant(long block, std::function<void()> act);

private:
    std::array<std::atomic<float>, 2> mValues{}; // gain, share of the side chain
    long mBlock = 0;
    long mPlantedIn = -1;
    std::function<void()> mPlanted;
};

class OwnSubject final : public Subject
{
public:
    OwnSubject() : Subject(new OwnFilter, {2, 1, 6}) {}

    void WorkOnMain(int round) override { Filter().SetHasHighCPU(round % 2 == 0); }
    void WorkElsewhere(int round) override;

    void Plant(long block, std::function<void()> act)
    {
        static_cast<OwnFilter&>(Filter()).Plant(block, std::move(act));
    }
};

} // namespace realtimeproof
