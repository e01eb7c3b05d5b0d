#pragma once

#include "foundation/zebcore/RefCountedObject.h"
#include "host/src/VST3/src/HostObject.h"

#include <base/source/fstring.h>
#include <pluginterfaces/vst/ivstattributes.h>

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <cstdint>
#include <map>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The attributes of a message between a plug-in's halves. Belongs to the plug-in: one thread at a time. A null ID
/// counts as the empty one. Getters do not look at the kind of an attribute; a missing one gives kResultFalse.
class HostAttributeList : public Steinberg::Vst::IAttributeList
{
public:
    HostAttributeList();

    HostAttributeList(const HostAttributeList&) = delete;
    HostAttributeList& operator=(const HostAttributeList&) = delete;

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    Steinberg::tresult PLUGIN_API setInt(AttrID id, Steinberg::int64 value) override;
    Steinberg::tresult PLUGIN_API getInt(AttrID id, Steinberg::int64& value) override;
    Steinberg::tresult PLUGIN_API setFloat(AttrID id, double value) override;
    Steinberg::tresult PLUGIN_API getFloat(AttrID id, double& value) override;
    Steinberg::tresult PLUGIN_API setString(AttrID id, const Steinberg::Vst::TChar* string) override;
    /// `size` is a number of units here, not of bytes. No terminator is written.
    Steinberg::tresult PLUGIN_API getString(AttrID id, Steinberg::Vst::TChar* string,
                                            Steinberg::uint32 size) override;
    /// Stores the data and reports kResultFalse all the same: that is the answer that plug-ins know of this host.
    Steinberg::tresult PLUGIN_API setBinary(AttrID id, const void* data, Steinberg::uint32 size) override;
    /// `data` stays owned by the attribute.
    Steinberg::tresult PLUGIN_API getBinary(AttrID id, const void*& data, Steinberg::uint32& size) override;

    virtual ~HostAttributeList();

private:
    class HostAttribute;

    struct KeyOrder
    {
        bool operator()(const Steinberg::String& left, const Steinberg::String& right) const;
    };

    void removeAttrID(AttrID id);
    void Put(AttrID id, boost::intrusive_ptr<HostAttribute> attribute);
    const HostAttribute* Find(AttrID id) const;

    HostReferenceCount mReferenceCount;
    std::map<Steinberg::String, boost::intrusive_ptr<HostAttribute>, KeyOrder> mAttributes;
};

} // namespace zebaudiofilterhost::vst3
