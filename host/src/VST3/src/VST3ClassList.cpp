#include "host/src/VST3/src/VST3ClassList.h"

#include "foundation/zebcore/Trace.h"
#include "host/src/VST3/src/IndexWalk.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <pluginterfaces/vst/ivstaudioprocessor.h>

#include <cstring>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::PClassInfo;

namespace
{

// Calls `visit` with each class that the factory can describe, until it returns true; returns whether it did.
template <class Visit>
bool VisitClasses(Steinberg::IPluginFactory& factory, int32 count, const Visit& visit)
{
    bool wanted = false;
    WalkList([count] { return count; },
             [&](int index)
             {
                 PClassInfo info = {};
                 if (factory.getClassInfo(index, &info) != Steinberg::kResultOk)
                     return IndexWalk::kMissing;
                 wanted = visit(info);
                 return wanted ? IndexWalk::kStop : IndexWalk::kFound;
             });
    return wanted;
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
