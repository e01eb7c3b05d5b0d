#pragma once

#include "examples/effects/support/Text.h"
#include "examples/effects/support/Vst3.h"

#include <string>
#include <vector>

namespace effects::trio
{

constexpr ProgramListID kProgramListID = 1;

// The factory programs of an effect that has one unit, the root: IUnitInfo for the host's program menu. Which program
// is in force is a parameter of the effect, marked kIsProgramChange. Base is an Implements<...> with IUnitInfo, or a
// class made of one.
template <class Base>
class ProgramList : public Base
{
public:
    template <class... Arguments>
    explicit ProgramList(std::vector<std::u16string> names, Arguments&&... arguments)
        : Base(std::forward<Arguments>(arguments)...), mNames(std::move(names))
    {
    }

    int32 PLUGIN_API getUnitCount() override { return 1; }

    tresult PLUGIN_API getUnitInfo(int32 index, UnitInfo& info) override
    {
        if (index != 0)
            return kInvalidArgument;
        info = {kRootUnitId, kNoParentUnitId, {}, kProgramListID};
        CopyText(u"Root", info.name);
        return kResultOk;
    }

    int32 PLUGIN_API getProgramListCount() override { return 1; }

    tresult PLUGIN_API getProgramListInfo(int32 index, ProgramListInfo& info) override
    {
        if (index != 0)
            return kInvalidArgument;
        info = {kProgramListID, {}, static_cast<int32>(mNames.size())};
        CopyText(u"Programs", info.name);
        return kResultOk;
    }

    tresult PLUGIN_API getProgramName(ProgramListID list, int32 index, String128 name) override
    {
        if (list != kProgramListID || index < 0 || index >= static_cast<int32>(mNames.size()))
            return kInvalidArgument;
        CopyText(mNames[static_cast<std::size_t>(index)], name);
        return kResultOk;
    }

    tresult PLUGIN_API getProgramInfo(ProgramListID, int32, FIDString, String128) override { return kNotImplemented; }
    tresult PLUGIN_API hasProgramPitchNames(ProgramListID, int32) override { return kResultFalse; }
    tresult PLUGIN_API getProgramPitchName(ProgramListID, int32, int16, String128) override
    {
        return kNotImplemented;
    }
    UnitID PLUGIN_API getSelectedUnit() override { return kRootUnitId; }
    tresult PLUGIN_API selectUnit(UnitID unit) override { return unit == kRootUnitId ? kResultOk : kResultFalse; }

    tresult PLUGIN_API getUnitByBus(MediaType, BusDirection, int32, int32, UnitID& unit) override
    {
        unit = kRootUnitId;
        return kResultOk;
    }

    tresult PLUGIN_API setUnitProgramData(int32, int32, IBStream*) override { return kNotImplemented; }

private:
    std::vector<std::u16string> mNames;
};

} // namespace effects::trio
