#pragma once

#include "audiofilter/AudioFilter.h"
#include "benchmarks/process/Way.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <string>

namespace zebaudiofilterhost::benchmarks
{

/// The library, initialised, with the effects of the bundle in its catalogue. Outlives every OurWay.
class OurLibrary
{
public:
    OurLibrary();
    ~OurLibrary();
    OurLibrary(const OurLibrary&) = delete;
    OurLibrary& operator=(const OurLibrary&) = delete;
};

/// The effect as an AudioFilter, through public headers alone.
class OurWay final : public Way
{
public:
    enum class Map
    {
        kNone,
        kIdentity,
        kSwappedOutputs
    };

    /// Throws std::runtime_error when the effect does not come up.
    OurWay(const std::string& effect, int frames, Map map = Map::kIdentity);
    ~OurWay() override;

    void Process(float** channels, int frames) override { Process(channels, channels, frames); }
    void Process(float** in, float** out, int frames);
    void PostChanges(int count, float value) override;
    void Tick() override;
    BenchSide& GetSide() override { return *mSide; }

private:
    boost::intrusive_ptr<AudioFilter> mFilter;
    BenchSide* mSide;
};

} // namespace zebaudiofilterhost::benchmarks
