// The shapes that the example effects come in.
#pragma once

#include "examples/effects/support/ConnectionPart.h"
#include "examples/effects/support/ControllerPart.h"
#include "examples/effects/support/ProcessorPart.h"

namespace effects
{

// A component whose controller is a class of its own.
using Processor = ConnectionPart<ProcessorPart<Implements<IComponent, IAudioProcessor, IConnectionPoint>>>;

// That controller. It shows the component's parameters and keeps no state of its own.
class Controller : public ConnectionPart<ControllerPart<Implements<IEditController, IConnectionPoint>>>
{
public:
    using ConnectionPart::ConnectionPart;

    tresult PLUGIN_API initialize(FUnknown* context) override
    {
        mHost = FUnknownPtr<IHostApplication>(context);
        return kResultOk;
    }

    tresult PLUGIN_API terminate() override
    {
        mHandler = nullptr;
        mHost = nullptr;
        return kResultOk;
    }

    tresult PLUGIN_API setState(IBStream*) override { return kResultOk; }
    tresult PLUGIN_API getState(IBStream*) override { return kResultOk; }

protected:
    IPtr<IHostApplication> mHost; // null if the host offers none
};

// Component and controller in one object, with one set of values and one state, and whatever other interfaces it has.
template <class... More>
class SingleComponentWith
    : public ControllerPart<ProcessorPart<Implements<IComponent, IAudioProcessor, IEditController, More...>>>
{
    using Parts = ControllerPart<ProcessorPart<Implements<IComponent, IAudioProcessor, IEditController, More...>>>;

public:
    using Parts::Parts;

    tresult PLUGIN_API terminate() override
    {
        this->mHandler = nullptr;
        return Parts::terminate();
    }

    tresult PLUGIN_API setState(IBStream* state) override { return this->mParameters.Load(state); }
    tresult PLUGIN_API getState(IBStream* state) override { return this->mParameters.Save(state); }
};

using SingleComponent = SingleComponentWith<>;

} // namespace effects
