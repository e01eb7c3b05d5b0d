#pragma once

#include "examples/effects/support/Vst3.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace effects
{

// Numbers as bytes, lowest first, so that a state made on one machine loads on any other. An error sticks: write or
// read all, then ask once.
class StateWriter
{
public:
    explicit StateWriter(IBStream* stream) : mStream(stream), mFailed(stream == nullptr) {}

    void Write(uint32 value) { WriteBytes(value, 4); }
    void Write(double value);
    bool Failed() const { return mFailed; }

private:
    void WriteBytes(uint64 value, int32 size);

    IBStream* mStream;
    bool mFailed;
};

class StateReader
{
public:
    explicit StateReader(IBStream* stream) : mStream(stream), mFailed(stream == nullptr) {}

    void Read(uint32& value) { value = static_cast<uint32>(ReadBytes(4)); }
    void Read(double& value);
    bool Failed() const { return mFailed; } // also when the stream ended too early

private:
    uint64 ReadBytes(int32 size);

    IBStream* mStream;
    bool mFailed;
};

} // namespace effects
