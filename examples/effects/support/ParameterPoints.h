#pragma once

#include "examples/effects/support/Vst3.h"

#include <algorithm>
#include <limits>

namespace effects
{

// Calls `visit(ParamID, int32 offset, ParamValue)` for every change that came with the block.
template <class Visit>
void VisitPoints(const ProcessData& data, Visit visit)
{
    if (data.inputParameterChanges == nullptr)
        return;
    for (int32 i = 0; i < data.inputParameterChanges->getParameterCount(); ++i)
    {
        IParamValueQueue* queue = data.inputParameterChanges->getParameterData(i);
        for (int32 j = 0; queue != nullptr && j < queue->getPointCount(); ++j)
        {
            int32 offset = 0;
            ParamValue value = 0.0;
            if (queue->getPoint(j, offset, value) == kResultOk)
                visit(queue->getParameterId(), offset, value);
        }
    }
}

// Cuts a block at its parameter changes: `apply(ParamID, ParamValue)` for the changes that fall due, then
// `render(int32 first, int32 count)` up to the next one. A block without samples, which only carries changes, applies
// them all.
template <class Apply, class Render>
void ProcessInStretches(const ProcessData& data, Apply apply, Render render)
{
    constexpr int32 kNever = std::numeric_limits<int32>::max();
    int32 applied = -1; // changes up to here are in force
    int32 position = 0;
    do
    {
        int32 next = kNever;
        const int32 due = data.numSamples == 0 ? kNever : position;
        VisitPoints(data,
                    [&](ParamID id, int32 offset, ParamValue value)
                    {
                        offset = std::max<int32>(offset, 0);
                        if (offset > due)
                            next = std::min(next, offset);
                        else if (offset > applied)
                            apply(id, value);
                    });
        applied = due;
        const int32 end = std::min(next, data.numSamples);
        if (end > position)
            render(position, end - position);
        position = end;
    } while (position < data.numSamples);
}

} // namespace effects
