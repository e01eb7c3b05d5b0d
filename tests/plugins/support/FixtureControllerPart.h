#pragma once

#include "examples/effects/support/ControllerPart.h"
#include "tests/plugins/support/Bytes.h"
#include "tests/plugins/support/FixtureObject.h"
#include "tests/plugins/support/FixtureView.h"
#include "tests/plugins/support/HostAccess.h"

namespace fixture
{

// A controller that records what is called and behaves as the knobs say.
template <class Base>
class FixtureControllerPart : public ControllerPart<Base>
{
    using Part = ControllerPart<Base>;

public:
    FixtureControllerPart() : Part(ParameterSet(TheBehaviour().parameters)) { Record("controller.created"); }

    ~FixtureControllerPart() override { Record("controller.destroyed"); }

    int32 PLUGIN_API getParameterCount() override { return GetInt(Knob::kParameterCount, Part::getParameterCount()); }

    tresult PLUGIN_API getParameterInfo(int32 index, ParameterInfo& info) override
    {
        if (IsOn(Knob::kParameterInfoResult))
            return GetInt(Knob::kParameterInfoResult);
        const tresult result = Part::getParameterInfo(index, info);
        if (result == kResultOk && info.id == kProgram)
            info.stepCount = GetInt(Knob::kParameterStepCount, info.stepCount);
        return result;
    }

    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override
    {
        Record("controller.setParamNormalized", id, value);
        return Part::setParamNormalized(id, value);
    }

    tresult PLUGIN_API setComponentState(IBStream* state) override
    {
        Record("controller.setComponentState", Summary(ReadAll(state)));
        return GetInt(Knob::kSetComponentStateResult);
    }

    tresult PLUGIN_API setComponentHandler(IComponentHandler* handler) override
    {
        Record("controller.setComponentHandler", handler != nullptr ? 1 : 0);
        SetHandler(handler);
        return Part::setComponentHandler(handler);
    }

    IPlugView* PLUGIN_API createView(FIDString name) override
    {
        Record("controller.createView", std::string_view(name));
        return TheBehaviour().hasView ? new FixtureView : nullptr;
    }
};

// The program lists and units of a fixture, for a controller or a single component.
template <class Base>
class FixtureUnits : public Base
{
public:
    int32 PLUGIN_API getUnitCount() override
    {
        return GetInt(Knob::kUnitCount, static_cast<int>(TheBehaviour().units.size()));
    }

    tresult PLUGIN_API getUnitInfo(int32 index, UnitInfo& info) override
    {
        const UnitShape* unit = At(TheBehaviour().units, index);
        if (unit == nullptr)
            return kInvalidArgument;
        info = {unit->id, unit->id == kRootUnitId ? kNoParentUnitId : kRootUnitId, {}, unit->programList};
        CopyText(u"Unit", info.name);
        return kResultOk;
    }

    int32 PLUGIN_API getProgramListCount() override
    {
        return GetInt(Knob::kProgramListCount, static_cast<int>(TheBehaviour().programLists.size()));
    }

    tresult PLUGIN_API getProgramListInfo(int32 index, ProgramListInfo& info) override
    {
        const ProgramListShape* list = At(TheBehaviour().programLists, index);
        if (list == nullptr)
            return kInvalidArgument;
        info = {list->id, {}, GetInt(Knob::kProgramCount, list->count)};
        CopyText(u"Programs", info.name);
        return kResultOk;
    }

    tresult PLUGIN_API getProgramName(ProgramListID id, int32 index, String128 name) override
    {
        for (const ProgramListShape& list : TheBehaviour().programLists)
        {
            if (list.id != id || index < 0 || index >= list.count)
                continue;
            CopyText(list.prefix + NumberText(index + 1, 0), name);
            return kResultOk;
        }
        return kInvalidArgument;
    }

    tresult PLUGIN_API getProgramInfo(ProgramListID, int32, FIDString, String128) override { return kNotImplemented; }
    tresult PLUGIN_API hasProgramPitchNames(ProgramListID, int32) override { return kResultFalse; }
    tresult PLUGIN_API getProgramPitchName(ProgramListID, int32, int16, String128) override
    {
        return kNotImplemented;
    }
    UnitID PLUGIN_API getSelectedUnit() override { return kRootUnitId; }
    tresult PLUGIN_API selectUnit(UnitID) override { return kResultOk; }
    tresult PLUGIN_API getUnitByBus(MediaType, BusDirection, int32, int32, UnitID&) override { return kResultFalse; }
    tresult PLUGIN_API setUnitProgramData(int32, int32, IBStream*) override { return kNotImplemented; }

private:
    template <class Shape>
    static const Shape* At(const std::vector<Shape>& shapes, int32 index)
    {
        return index >= 0 && index < static_cast<int32>(shapes.size()) ? &shapes[static_cast<std::size_t>(index)]
                                                                       : nullptr;
    }
};

} // namespace fixture
