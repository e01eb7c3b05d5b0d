#pragma once

#include "host/src/VST/interface/VST2Interface.h"

namespace zebaudiofilterhost::vst
{

/// The guarded way into a plug-in's dispatcher, for every class that calls one.
class VSTDispatcherBase
{
public:
    /// `effect` is borrowed, may be null, and outlives this object or is never called again.
    explicit VSTDispatcherBase(AEffect* effect);
    virtual ~VSTDispatcherBase();

    /// What the plug-in answers; 0 without a plug-in, and when it throws. [the opcode's thread]
    long long Dispatcher(int opcode, int index, long long value, void* ptr, float opt) const;

protected:
    AEffect* GetEffect() const { return mEffect; }

private:
    AEffect* mEffect;
};

} // namespace zebaudiofilterhost::vst
