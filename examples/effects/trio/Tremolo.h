#pragma once

#include "examples/effects/support/Bases.h"
#include "examples/effects/trio/ProgramList.h"

namespace effects::trio
{

// Swells and fades. Component and controller are one object, which also has the program list.
class Tremolo : public ProgramList<SingleComponentWith<IUnitInfo>>
{
public:
    Tremolo();

    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override;
    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;

private:
    void Apply(ParamID id, ParamValue value);
    void Render(ProcessData& data, int32 first, int32 count);

    double mPhase = 0.0; // of the swell, 0 to 1
};

} // namespace effects::trio
