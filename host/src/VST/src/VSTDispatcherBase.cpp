#include "host/src/VST/src/VSTDispatcherBase.h"

namespace zebaudiofilterhost::vst
{

VSTDispatcherBase::VSTDispatcherBase(AEffect* effect) : mEffect(effect)
{
}
VSTDispatcherBase::~VSTDispatcherBase() = default;

long long VSTDispatcherBase::Dispatcher(int opcode, int index, long long value, void* ptr, float opt) const
{
    if (!mEffect || !mEffect->dispatcher)
        return 0;
    try
    {
        return mEffect->dispatcher(mEffect, opcode, index, value, ptr, opt);
    }
    catch (...)
    {
        // The host goes on without the answer of a plug-in that throws.
        return 0;
    }
}

} // namespace zebaudiofilterhost::vst
