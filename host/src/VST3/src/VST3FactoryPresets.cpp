#include "host/src/VST3/src/IndexWalk.h"
#include "host/src/VST3/src/PluginText.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::kResultOk;
using Steinberg::Vst::IUnitInfo;
using Steinberg::Vst::kNoProgramListId;
using Steinberg::Vst::ProgramListID;

namespace
{

// kNoProgramListId if there is no root unit.
ProgramListID FindRootProgramList(IUnitInfo& units)
{
    ProgramListID list = kNoProgramListId;
    WalkList([&] { return units.getUnitCount(); },
             [&](int index)
             {
                 Steinberg::Vst::UnitInfo info = {};
                 if (units.getUnitInfo(index, info) != kResultOk)
                     return IndexWalk::kMissing;
                 if (info.id != Steinberg::Vst::kRootUnitId)
                     return IndexWalk::kFound;
                 list = info.programListId;
                 return IndexWalk::kStop;
             });
    return list;
}

int CountPrograms(IUnitInfo& units, ProgramListID list)
{
    int32 count = 0;
    WalkList([&] { return units.getProgramListCount(); },
             [&](int index)
             {
                 Steinberg::Vst::ProgramListInfo info = {};
                 if (units.getProgramListInfo(index, info) != kResultOk)
                     return IndexWalk::kMissing;
                 if (info.id != list)
                     return IndexWalk::kFound;
                 count = info.programCount;
                 return IndexWalk::kStop;
             });
    return std::clamp(count, 0, kMaxListLength);
}

} // namespace

void VST3AudioFilter::FindFactoryPresets()
{
    if (!mUnitInfo || mUnitInfo->getProgramListCount() < 1)
        return;
    const ProgramListID list = FindRootProgramList(*mUnitInfo);
    if (list != kNoProgramListId)
        mNumPrograms = CountPrograms(*mUnitInfo, list);
}

int VST3AudioFilter::GetNumFactoryPresets() const
{
    return mNumPrograms;
}

// Names come from the first list, which need not be the root unit's that was counted: it may have more of them.
UTF16String VST3AudioFilter::GetFactoryPresetName(int index) const
{
    if (!mUnitInfo || index < 0)
        return {};
    Steinberg::Vst::ProgramListInfo info = {};
    if (mUnitInfo->getProgramListInfo(0, info) != kResultOk)
        return {};
    Steinberg::Vst::String128 name = {};
    if (mUnitInfo->getProgramName(info.id, index, name) != kResultOk)
        return {};
    return UTF16String(BoundedText(name));
}

void VST3AudioFilter::SetFactoryPreset(int index)
{
    const std::uint32_t id = mProgramChangeID.load(std::memory_order_acquire);
    if (!mController || id == kNoParameterID)
        return;
    Steinberg::Vst::ParameterInfo info = {};
    if (mController->getParameterInfo(mProgramChangeIndex, info) != kResultOk)
        return;
    if (info.stepCount < 1 || index < 0 || index > info.stepCount)
        return;
    const double value = static_cast<double>(index) / static_cast<double>(info.stepCount);
    mController->setParamNormalized(id, value);
    mInputTransfer.AddChange(id, value, 0);
}

} // namespace zebaudiofilterhost::vst3
