#pragma once

#include "host/src/VST3/src/HostAttributeList.h"
#include "host/src/VST3/src/HostObject.h"
#include "host/src/VST3/src/PluginPtr.h"

#include <pluginterfaces/vst/ivstmessage.h>

#include <string>

namespace zebaudiofilterhost::vst3
{

/// What a plug-in gets when it asks the host for a message to send between its halves. Belongs to the plug-in: one
/// thread at a time.
class HostMessage : public Steinberg::Vst::IMessage
{
public:
    HostMessage() = default;

    HostMessage(const HostMessage&) = delete;
    HostMessage& operator=(const HostMessage&) = delete;

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    /// Never null; valid until the next setMessageID.
    Steinberg::FIDString PLUGIN_API getMessageID() override;
    /// Null empties it.
    void PLUGIN_API setMessageID(Steinberg::FIDString id) override;
    /// Made at the first call. Owned by the message.
    Steinberg::Vst::IAttributeList* PLUGIN_API getAttributes() override;

    virtual ~HostMessage() = default;

private:
    HostReferenceCount mReferenceCount;
    std::string mMessageID;
    PluginPtr<HostAttributeList> mAttributes;
};

} // namespace zebaudiofilterhost::vst3
