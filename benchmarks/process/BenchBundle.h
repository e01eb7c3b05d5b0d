#pragma once

#include "benchmarks/plugins/BenchSide.h"

#include <string>

namespace zebaudiofilterhost::benchmarks
{

inline constexpr double kSampleRate = 48000.0;

/// The binary of the effects to measure, loaded once more for the benchmark itself: all hosts of the process share
/// its code. Failures are exceptions.
class BenchBundle
{
public:
    static BenchBundle& GetInstance();

    /// The bundle, and the folder that it is in.
    static std::string GetPath();
    static std::string GetFolder();

    /// An exported function of the binary.
    template <class Function>
    Function Find(const char* name) const
    {
        return reinterpret_cast<Function>(FindSymbol(name)); // NOLINT: that is how functions are found in a binary
    }

    /// For the ModuleEntry of the binary.
    void* GetHandle() const { return mHandle; }

    /// The side door of the effect that was made last.
    BenchSide& GetLatestSide() const;

private:
    BenchBundle();

    void* FindSymbol(const char* name) const;

    void* mHandle; // stays open until the process ends
};

} // namespace zebaudiofilterhost::benchmarks
