#pragma once

#include "examples/effects/support/Bases.h"

#include <array>

namespace effects::trio
{

// Lowers what is low and raises what is high, or the other way round. One object, without programs.
class Tilt : public SingleComponent
{
public:
    Tilt();

    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;

private:
    void Render(ProcessData& data, int32 first, int32 count);

    std::array<float, 2> mLow{}; // per channel, what lies below the middle frequency
};

} // namespace effects::trio
