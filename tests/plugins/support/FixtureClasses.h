#pragma once

#include "tests/plugins/support/FixtureControllerPart.h"
#include "tests/plugins/support/FixtureProcessorPart.h"

namespace fixture
{

// Component and processor of an effect whose controller is a class of its own.
class FixtureComponent : public FixtureProcessorPart<
                             FixtureObject<IComponent, IAudioProcessor, IConnectionPoint, VendorSpecificComponent>>
{
public:
    // `index` is the class's place in Behaviour::classes.
    explicit FixtureComponent(std::size_t index) : mIndex(index) {}

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API connect(IConnectionPoint* other) override;
    tresult PLUGIN_API disconnect(IConnectionPoint* other) override;
    tresult PLUGIN_API notify(IMessage* message) override;
    int32 PLUGIN_API GetDisplayNameLength() override;
    void PLUGIN_API GetDisplayName(char* buffer) override;

private:
    std::size_t mIndex;
};

class FixtureController
    : public FixtureUnits<
          FixtureControllerPart<FixtureObject<IEditController, IConnectionPoint, IUnitInfo, VendorSpecificEffect>>>
{
public:
    tresult PLUGIN_API initialize(FUnknown* context) override;
    tresult PLUGIN_API terminate() override;
    tresult PLUGIN_API setState(IBStream* state) override;
    tresult PLUGIN_API getState(IBStream* state) override;
    tresult PLUGIN_API connect(IConnectionPoint* other) override;
    tresult PLUGIN_API disconnect(IConnectionPoint* other) override;
    tresult PLUGIN_API notify(IMessage* message) override;

    void PLUGIN_API SetBrightness(float brightness) override;
    void PLUGIN_API SetBrightnessFlag(bool flag) override;
    int32 PLUGIN_API GainFocus(bool forward) override;
    int32 PLUGIN_API SetCurrentFocus() override;
    bool PLUGIN_API IsDirty() override;

private:
    std::string mState;
    bool mStateIsSet = false;
};

// Component and controller in one.
class FixtureSingle
    : public FixtureUnits<FixtureControllerPart<
          FixtureProcessorPart<FixtureObject<IComponent, IAudioProcessor, IEditController, IUnitInfo>>>>
{
};

} // namespace fixture
