#pragma once

#include "examples/effects/support/Implements.h"

namespace effects
{

// One end of the line between an effect's two halves, IConnectionPoint. The host connects them; messages, which the
// host makes, are the only way for them to talk that works when they don't share a process.
template <class Base>
class ConnectionPart : public Base
{
public:
    using Base::Base;

    tresult PLUGIN_API connect(IConnectionPoint* other) override
    {
        mOther = other;
        return kResultOk;
    }

    tresult PLUGIN_API disconnect(IConnectionPoint*) override
    {
        mOther = nullptr;
        return kResultOk;
    }

    tresult PLUGIN_API notify(IMessage*) override { return kResultFalse; }

protected:
    // Makes a message, lets `fill(IAttributeList&)` fill it and sends it. Allocates: not for the audio thread.
    template <class Fill>
    void Send(IHostApplication* host, FIDString name, Fill fill)
    {
        if (host == nullptr || mOther == nullptr)
            return;
        const IPtr<IMessage> message(allocateMessage(host), false);
        if (message == nullptr)
            return;
        message->setMessageID(name);
        if (IAttributeList* attributes = message->getAttributes())
            fill(*attributes);
        mOther->notify(message);
    }

    static bool IsCalled(IMessage* message, FIDString name)
    {
        return message != nullptr && FIDStringsEqual(message->getMessageID(), name);
    }

    IPtr<IConnectionPoint> mOther; // the other half, or what the host puts between; null if not connected
};

} // namespace effects
