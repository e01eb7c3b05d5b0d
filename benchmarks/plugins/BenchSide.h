#pragma once

namespace zebaudiofilterhost::benchmarks
{

/// What a benchmark asks of its effect behind the host's back, so that every host has the same work to do and each
/// can be asked whether it did it.
class BenchSide
{
public:
    /// Calls performEdit with this value, as an editor does, for the IDs from `first` to `first + count - 1`.
    virtual void PerformEdits(int first, int count, double value) = 0;

    /// Parameter points that reached `process` so far.
    virtual long long GetPointsReceived() const = 0;

    /// What `process` got last for this ID, normalised.
    virtual double GetProcessedValue(int id) const = 0;

protected:
    ~BenchSide() = default;
};

/// The binary exports a function of this name and type: the side door of the effect that was made last.
inline constexpr const char* kLatestBenchSide = "ZebBenchLatest";
using LatestBenchSide = BenchSide* (*)();

/// The effects of the bundle, by their number of parameters.
inline constexpr const char* kBenchEffect4 = "Bench 4";
inline constexpr const char* kBenchEffect512 = "Bench 512";
inline constexpr const char* kBenchEffect4096 = "Bench 4096";

} // namespace zebaudiofilterhost::benchmarks
