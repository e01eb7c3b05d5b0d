#pragma once

#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"

#include <vector>

namespace zebaudiofilterhost::xau
{

// A unit whose parameters a test describes one by one.
class DescribedUnit : public FakeUnit
{
public:
    void Describe(AudioUnitParameterID id, AudioUnitParameterUnit unit, UInt32 flags)
    {
        const FakeUnit::Key key(kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, id);
        auto info = Read<AudioUnitParameterInfo>(key);
        info.unit = unit;
        info.flags = flags;
        Answer(key, info);
    }

    // Steps 0 to `last` of parameter 1, with names if there are any.
    void DescribeSteps(Float32 last, const std::vector<const char*>& names)
    {
        const FakeUnit::Key key(kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, 1);
        auto info = Read<AudioUnitParameterInfo>(key);
        info.maxValue = last;
        Answer(key, info);
        const FakeUnit::Key strings(kAudioUnitProperty_ParameterValueStrings, kAudioUnitScope_Global, 1);
        Forget(strings);
        if (names.empty())
            return;
        CFMutableArrayRef array = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
        for (const char* name : names)
        {
            const CFOwner text(MakeString(name));
            CFArrayAppendValue(array, text.get());
        }
        Answer<CFArrayRef>(strings, array); // the reference is that of the one row that reads it
    }
};

} // namespace zebaudiofilterhost::xau
