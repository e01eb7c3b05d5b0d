#pragma once

#include <memory>
#include <string>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

/// One VST 3 effect in the peer host. Stereo in, stereo out. Everything but Process belongs to the thread that made
/// the first one. [main]
class PeerFilter
{
public:
    PeerFilter();
    ~PeerFilter();

    PeerFilter(const PeerFilter&) = delete;
    PeerFilter& operator=(const PeerFilter&) = delete;

    /// Makes the class of that name out of the bundle; an empty name takes the first. False, with what the peer says
    /// in GetError, if there is none.
    bool Load(const std::string& bundle, const std::string& name = {});
    const std::string& GetError() const;

    /// Sample rate in hertz, and the largest block. Call it before the first block.
    void Prepare(double sampleRate, int frames);

    /// One block, in place, as an application of the peer calls it: with the buffers wrapped, and no notes. [process]
    void Process(float** channels, int channelCount, int frames);

    /// Sets a parameter as an application of the peer does: normalised, by the peer's index.
    void SetParameter(int index, float value);
    int GetParameterCount() const;
    float GetParameter(int index) const;

    /// The bytes that an application of the peer keeps of this effect, the peer's own wrapping included.
    std::vector<char> GetState() const;
    void SetState(const std::vector<char>& state);

private:
    struct Impl;

    std::unique_ptr<Impl> mImpl;
};

} // namespace zebaudiofilterhost::benchmarks
