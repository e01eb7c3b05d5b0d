#include "tests/plugins/support/FixtureClasses.h"

#include <cstring>

namespace fixture
{

tresult PLUGIN_API FixtureComponent::getControllerClassId(TUID classID)
{
    if (IsOn(Knob::kControllerIDZero))
        std::memset(classID, 0, sizeof(TUID));
    else
        ControllerID(mIndex).toTUID(classID);
    return GetInt(Knob::kControllerIDResult);
}

tresult PLUGIN_API FixtureComponent::connect(IConnectionPoint* other)
{
    Record("component.connect", other != nullptr ? 1 : 0);
    return kResultOk;
}

tresult PLUGIN_API FixtureComponent::disconnect(IConnectionPoint* other)
{
    Record("component.disconnect", other != nullptr ? 1 : 0);
    return kResultOk;
}

tresult PLUGIN_API FixtureComponent::notify(IMessage* message)
{
    Record("component.notify", std::string_view(message->getMessageID()));
    return kResultOk;
}

int32 PLUGIN_API FixtureComponent::GetDisplayNameLength()
{
    return static_cast<int32>(TheBehaviour().displayName.size());
}

void PLUGIN_API FixtureComponent::GetDisplayName(char* buffer)
{
    std::memcpy(buffer, TheBehaviour().displayName.data(), TheBehaviour().displayName.size());
}

tresult PLUGIN_API FixtureController::initialize(FUnknown*)
{
    Record("controller.initialize");
    return GetInt(Knob::kControllerInitializeResult);
}

tresult PLUGIN_API FixtureController::terminate()
{
    Record("controller.terminate");
    return kResultOk;
}

tresult PLUGIN_API FixtureController::setState(IBStream* state)
{
    mState = ReadAll(state);
    mStateIsSet = GetInt(Knob::kSetControllerStateResult) == kResultOk;
    Record("controller.setState", Summary(mState));
    return GetInt(Knob::kSetControllerStateResult);
}

tresult PLUGIN_API FixtureController::getState(IBStream* state)
{
    Record("controller.getState");
    if (IsOn(Knob::kControllerStateResult))
        return GetInt(Knob::kControllerStateResult);
    return WriteAll(state, mStateIsSet ? mState : Pattern(static_cast<std::size_t>(Get(Knob::kControllerStateSize))));
}

tresult PLUGIN_API FixtureController::connect(IConnectionPoint* other)
{
    Record("controller.connect", other != nullptr ? 1 : 0);
    return kResultOk;
}

tresult PLUGIN_API FixtureController::disconnect(IConnectionPoint* other)
{
    Record("controller.disconnect", other != nullptr ? 1 : 0);
    return kResultOk;
}

tresult PLUGIN_API FixtureController::notify(IMessage* message)
{
    Record("controller.notify", std::string_view(message->getMessageID()));
    return kResultOk;
}

void PLUGIN_API FixtureController::SetBrightness(float brightness)
{
    Record("controller.SetBrightness", brightness);
}

void PLUGIN_API FixtureController::SetBrightnessFlag(bool flag)
{
    Record("controller.SetBrightnessFlag", flag ? 1 : 0);
}

int32 PLUGIN_API FixtureController::GainFocus(bool forward)
{
    Record("controller.GainFocus", forward ? 1 : 0);
    return GetInt(Knob::kGainFocusResult);
}

int32 PLUGIN_API FixtureController::SetCurrentFocus()
{
    Record("controller.SetCurrentFocus");
    return GetInt(Knob::kSetCurrentFocusResult);
}

bool PLUGIN_API FixtureController::IsDirty()
{
    return IsOn(Knob::kDirty);
}

} // namespace fixture
