#include "tests/vst3/FakeObject.h"

#include "host/src/VST3/src/VST3VendorInterfaces.h"

#include <pluginterfaces/vst/ivstmessage.h>

#include <cstdio>

namespace fakeplugin
{

using zebaudiofilterhost::vst3::IVST3CorvaneVendorSpecificEffect;

namespace
{

std::string Number(double value)
{
    char text[32];
    std::snprintf(text, sizeof(text), " %g", value);
    return text;
}

class FakeController final : public IEditController,
                             public IUnitInfo,
                             public IConnectionPoint,
                             public IVST3CorvaneVendorSpecificEffect
{
public:
    explicit FakeController(FakePlugin& plugin) : mPlugin(plugin), mCount(plugin, "controller") {}

    tresult PLUGIN_API queryInterface(const TUID asked, void** obj) override
    {
        *obj = nullptr;
        const bool answered = Answer<IEditController>(asked, this, obj) ||
                              (mPlugin.hasUnits && Answer<IUnitInfo>(asked, this, obj)) ||
                              (mPlugin.hasConnections && Answer<IConnectionPoint>(asked, this, obj)) ||
                              (mPlugin.hasVendorEffect && Answer<IVST3CorvaneVendorSpecificEffect>(asked, this, obj));
        return answered ? kResultOk : kNoInterface;
    }
    uint32 PLUGIN_API addRef() override { return mCount.Add(); }
    uint32 PLUGIN_API release() override { return mCount.Release(this); }

    tresult PLUGIN_API initialize(FUnknown* /*context*/) override
    {
        mPlugin.Call("controller.initialize");
        return mPlugin.controllerInitializeResult;
    }
    tresult PLUGIN_API terminate() override
    {
        mPlugin.Call("controller.terminate");
        return kResultOk;
    }
    tresult PLUGIN_API setComponentState(IBStream* stream) override
    {
        mPlugin.Call("controller.setComponentState " + ReadState(stream));
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API setState(IBStream* stream) override
    {
        mPlugin.controllerState = ReadState(stream);
        mPlugin.Call("controller.setState " + mPlugin.controllerState);
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API getState(IBStream* stream) override
    {
        mPlugin.Call("controller.getState");
        return WriteState(stream, mPlugin.controllerState, mPlugin.getControllerStateResult);
    }
    int32 PLUGIN_API getParameterCount() override
    {
        if (mPlugin.countingParameters)
            mPlugin.countingParameters();
        return mPlugin.parameterCount == -1 ? static_cast<int32>(mPlugin.parameters.size()) : mPlugin.parameterCount;
    }
    tresult PLUGIN_API getParameterInfo(int32 index, ParameterInfo& info) override
    {
        if (index < 0 || index >= static_cast<int32>(mPlugin.parameters.size()))
            return kInvalidArgument;
        const FakeParameter& parameter = mPlugin.parameters[static_cast<std::size_t>(index)];
        info.id = parameter.id;
        info.flags = parameter.flags;
        info.stepCount = parameter.stepCount;
        info.unitId = parameter.unit;
        CopyText(info.title, parameter.title);
        CopyText(info.units, parameter.units);
        return kResultOk;
    }
    tresult PLUGIN_API getParamStringByValue(ParamID id, ParamValue value, String128 text) override
    {
        const std::string narrow = std::to_string(id) + ":" + Number(value);
        std::copy(narrow.begin(), narrow.end(), text);
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API getParamValueByString(ParamID /*id*/, TChar* /*text*/, ParamValue& /*value*/) override
    {
        return kNotImplemented;
    }
    ParamValue PLUGIN_API normalizedParamToPlain(ParamID /*id*/, ParamValue value) override { return value * 10.0; }
    ParamValue PLUGIN_API plainParamToNormalized(ParamID /*id*/, ParamValue value) override { return value / 10.0; }
    ParamValue PLUGIN_API getParamNormalized(ParamID id) override { return mPlugin.values[id]; }
    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override
    {
        if (mPlugin.recording)
        {
            mPlugin.Call("controller.setParamNormalized " + std::to_string(id) + Number(value));
            mPlugin.values[id] = value;
        }
        return kResultOk;
    }
    tresult PLUGIN_API setComponentHandler(IComponentHandler* handler) override
    {
        mPlugin.Call(handler ? "controller.setComponentHandler" : "controller.setComponentHandler null");
        mPlugin.handler = handler;
        return kResultOk;
    }
    IPlugView* PLUGIN_API createView(FIDString name) override
    {
        mPlugin.Call(std::string("controller.createView ") + name);
        return mPlugin.hasView ? MakeFakeView(mPlugin) : nullptr;
    }

    int32 PLUGIN_API getUnitCount() override { return static_cast<int32>(mPlugin.units.size()); }
    tresult PLUGIN_API getUnitInfo(int32 index, UnitInfo& info) override
    {
        info = mPlugin.units[static_cast<std::size_t>(index)];
        return kResultOk;
    }
    int32 PLUGIN_API getProgramListCount() override { return static_cast<int32>(mPlugin.programLists.size()); }
    tresult PLUGIN_API getProgramListInfo(int32 index, ProgramListInfo& info) override
    {
        const FakeProgramList& list = mPlugin.programLists[static_cast<std::size_t>(index)];
        info.id = list.id;
        info.programCount = list.count;
        return kResultOk;
    }
    tresult PLUGIN_API getProgramName(ProgramListID id, int32 index, String128 name) override
    {
        for (const FakeProgramList& list : mPlugin.programLists)
        {
            if (list.id != id || index >= list.count)
                continue;
            const std::string number = std::to_string(index);
            const std::u16string text = list.prefix + std::u16string(number.begin(), number.end());
            std::copy(text.begin(), text.end(), name);
            return kResultOk;
        }
        return kResultFalse;
    }
    tresult PLUGIN_API getProgramInfo(ProgramListID, int32, Vst::CString, String128) override
    {
        return kNotImplemented;
    }
    tresult PLUGIN_API hasProgramPitchNames(ProgramListID, int32) override { return kResultFalse; }
    tresult PLUGIN_API getProgramPitchName(ProgramListID, int32, int16, String128) override
    {
        return kNotImplemented;
    }
    UnitID PLUGIN_API getSelectedUnit() override { return kRootUnitId; }
    tresult PLUGIN_API selectUnit(UnitID) override { return kNotImplemented; }
    tresult PLUGIN_API getUnitByBus(MediaType, BusDirection, int32, int32, UnitID&) override
    {
        return kNotImplemented;
    }
    tresult PLUGIN_API setUnitProgramData(int32, int32, IBStream*) override { return kNotImplemented; }

    tresult PLUGIN_API connect(IConnectionPoint* /*other*/) override
    {
        mPlugin.Call("controller.connect");
        return kResultOk;
    }
    tresult PLUGIN_API disconnect(IConnectionPoint* /*other*/) override
    {
        mPlugin.Call("controller.disconnect");
        return kResultOk;
    }
    tresult PLUGIN_API notify(IMessage* /*message*/) override { return kResultOk; }

    void PLUGIN_API SetBrightness(float brightness) override
    {
        mPlugin.Call("vendor.SetBrightness" + Number(static_cast<double>(brightness)));
    }
    void PLUGIN_API SetBrightnessFlag(bool flag) override
    {
        mPlugin.Call(flag ? "vendor.SetBrightnessFlag 1" : "vendor.SetBrightnessFlag 0");
    }
    int32 PLUGIN_API GainFocus(bool forward) override { return forward ? 5 : 0; }
    int32 PLUGIN_API SetCurrentFocus() override { return -1; }
    bool PLUGIN_API IsDirty() override { return mPlugin.dirty; }

private:
    FakePlugin& mPlugin;
    FakeCount mCount;
};

class FakeView final : public IPlugView
{
public:
    explicit FakeView(FakePlugin& plugin) : mPlugin(plugin), mCount(plugin, "view") {}

    tresult PLUGIN_API queryInterface(const TUID asked, void** obj) override
    {
        *obj = nullptr;
        return Answer<IPlugView>(asked, this, obj) ? kResultOk : kNoInterface;
    }
    uint32 PLUGIN_API addRef() override { return mCount.Add(); }
    uint32 PLUGIN_API release() override { return mCount.Release(this); }

    tresult PLUGIN_API isPlatformTypeSupported(FIDString type) override
    {
        const auto& types = mPlugin.viewTypes;
        return std::find(types.begin(), types.end(), type) != types.end() ? kResultOk : kResultFalse;
    }
    tresult PLUGIN_API attached(void* /*parent*/, FIDString type) override
    {
        mPlugin.Call(std::string("view.attached ") + type);
        return mPlugin.attachedResult;
    }
    tresult PLUGIN_API removed() override
    {
        mPlugin.Call("view.removed");
        return kResultOk;
    }
    tresult PLUGIN_API onWheel(float) override { return kResultFalse; }
    tresult PLUGIN_API onKeyDown(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API onKeyUp(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API getSize(ViewRect* size) override
    {
        *size = mPlugin.viewSize;
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API onSize(ViewRect*) override
    {
        mPlugin.Call("view.onSize");
        return kResultOk;
    }
    tresult PLUGIN_API onFocus(TBool) override { return kResultOk; }
    tresult PLUGIN_API setFrame(IPlugFrame* frame) override
    {
        mPlugin.Call(frame ? "view.setFrame" : "view.setFrame null");
        mPlugin.frame = frame;
        return kResultOk;
    }
    tresult PLUGIN_API canResize() override { return kResultFalse; }
    tresult PLUGIN_API checkSizeConstraint(ViewRect*) override { return kResultFalse; }

private:
    FakePlugin& mPlugin;
    FakeCount mCount;
};

} // namespace

IEditController* MakeFakeController(FakePlugin& plugin)
{
    return new FakeController(plugin);
}

IPlugView* MakeFakeView(FakePlugin& plugin)
{
    return new FakeView(plugin);
}

} // namespace fakeplugin
