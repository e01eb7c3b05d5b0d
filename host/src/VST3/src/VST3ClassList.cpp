#include "host/src/VST3/src/VST3ClassList.h"

#include "foundation/zebcore/Trace.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <algorithm>
#include <pluginterfaces/vst/ivstaudioprocessor.h>

#include <cstring>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::PClassInfo;

namespace
{

// Counts of plug-ins lie. A shell of thousands of classes is real; this many, or such a row of classes that the
// factory cannot describe, is not.
constexpr int32 kMaxClasses = 16384;
constexpr int32 kMaxFailuresInARow = 1024;

// Calls `visit` with each class that the factory can describe, until it returns true; returns whether it did.
template <class Visit>
bool VisitClasses(Steinberg::IPluginFactory& factory, int32 count, const Visit& visit)
{
    int32 failures = 0;
    for (int32 index = 0; index < std::min(count, kMaxClasses) && failures < kMaxFailuresInARow; ++index)
    {
        PClassInfo info = {};
        if (factory.getClassInfo(index, &info) != Steinberg::kResultOk)
        {
            ++failures;
            continue;
        }
        failures = 0;
        if (visit(info))
            return true;
    }
    return false;
}

bool IsAudioClass(const PClassInfo& info)
{
    return std::strncmp(info.category, kVstAudioEffectClass, sizeof(info.category)) == 0;
}

} // namespace

bool FindClass(Steinberg::IPluginFactory& factory, const Steinberg::TUID classID, PClassInfo& info)
{
    const int32 count = factory.countClasses();
    ZEB_TRACE("VST3PluginModule::CreateAudioFilter", "mFactory->countClasses(): " << count);
    return VisitClasses(factory, count,
                        [&](const PClassInfo& candidate)
                        {
                            if (!Steinberg::FUnknownPrivate::iidEqual(candidate.cid, classID))
                                return false;
                            info = candidate;
                            return true;
                        });
}

std::vector<UTF16String> ListAudioClasses(Steinberg::IPluginFactory& factory)
{
    std::vector<UTF16String> filterIDs;
    VisitClasses(factory, factory.countClasses(),
                 [&](const PClassInfo& info)
                 {
                     if (IsAudioClass(info))
                         filterIDs.push_back(EncodeFilterID(info.cid));
                     return false;
                 });
    return filterIDs;
}

} // namespace zebaudiofilterhost::vst3
