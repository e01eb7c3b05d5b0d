#pragma once

namespace fixture
{

// How the unit asks for its input.
enum class InputMemory
{
    Own,
    Null,
    Interleaved // own, in one buffer for all channels
};

// What a test sets (ZebFixtureSet).
struct RecorderKnobs
{
    double inputMemory = 0;    // an InputMemory
    double renderResult = 0;   // an OSStatus
    double refusesFormats = 0; // and has an interleaved one
};

RecorderKnobs& Knobs();

} // namespace fixture
