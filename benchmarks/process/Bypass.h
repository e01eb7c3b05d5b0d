#pragma once

#include "audiofilter/AudioFilter.h"
#include "benchmarks/process/Block.h"
#include "benchmarks/process/Work.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <memory>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

inline constexpr int kBypassFrames = 512;
inline constexpr int kTargetChannels = 8;

/// What the two ways of a bypass row share: a block goes in, and its last `channels` channels come out again, late by
/// the latency.
class BypassWork : public Work
{
public:
    void Verify() override;

protected:
    BypassWork(int channels, int latency);

    int mChannels;
    int mLatency;
    Block mIn{kTargetChannels, kBypassFrames};
    Block mOut{kTargetChannels, kBypassFrames};

private:
    void CheckBlock(long long firstFrame);
};

/// Channels that pass by a filter that has no plug-in and does nothing: what is left is the cost of passing by.
class FilterBypassWork final : public BypassWork
{
public:
    /// The first channels, as far as they don't pass by, belong to the filter.
    FilterBypassWork(int channels, int latency);
    ~FilterBypassWork() override;

    void Run() override;

private:
    boost::intrusive_ptr<AudioFilter> mFilter;
};

/// The same by plain copies and nothing else: without latency each sample is copied once, to where it goes; with
/// latency twice, into a store and out of it, and the store is as long as the latency needs.
class CopyBypassWork final : public BypassWork
{
public:
    CopyBypassWork(int channels, int latency);

    void Run() override;

private:
    std::vector<std::vector<float>> mStores;
    std::size_t mWrite = 0;
    std::size_t mRead = 0;
};

} // namespace zebaudiofilterhost::benchmarks
