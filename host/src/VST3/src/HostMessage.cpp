#include "host/src/VST3/src/HostMessage.h"

namespace zebaudiofilterhost::vst3
{

using Steinberg::tresult;
using Steinberg::uint32;

tresult PLUGIN_API HostMessage::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::Vst::IMessage>(*this, interfaceID, object);
}

uint32 PLUGIN_API HostMessage::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API HostMessage::release()
{
    const uint32 count = mReferenceCount.Remove();
    if (count == 0)
        delete this;
    return count;
}

Steinberg::FIDString PLUGIN_API HostMessage::getMessageID()
{
    return mMessageID.c_str();
}

void PLUGIN_API HostMessage::setMessageID(Steinberg::FIDString id)
{
    mMessageID = id ? id : "";
}

Steinberg::Vst::IAttributeList* PLUGIN_API HostMessage::getAttributes()
{
    if (!mAttributes)
        mAttributes = PluginPtr<HostAttributeList>::Adopt(new HostAttributeList);
    return mAttributes.Get();
}

} // namespace zebaudiofilterhost::vst3
