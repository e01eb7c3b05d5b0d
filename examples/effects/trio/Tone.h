#pragma once

#include "examples/effects/support/Bases.h"

#include <array>

namespace effects::trio
{

// An instrument: up to eight sine voices, played by note events that take effect at the start of their block.
class Tone : public SingleComponent
{
public:
    Tone();

    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;

protected:
    bool Supports(SpeakerArrangement arrangement) const override { return arrangement == SpeakerArr::kStereo; }

private:
    struct Voice
    {
        int16 pitch = -1; // -1: free
        double phase = 0.0;
        float velocity = 0.0F;
    };

    void TakeEvents(IEventList* events);
    void Start(int16 pitch, float velocity);
    void Stop(int16 pitch);
    float NextSample();

    std::array<Voice, 8> mVoices;
};

} // namespace effects::trio
