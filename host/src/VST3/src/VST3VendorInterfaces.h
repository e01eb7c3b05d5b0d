#pragma once

#include <pluginterfaces/base/funknown.h>

namespace zebaudiofilterhost::vst3
{

/// The maker's own extension of VST 3: a cooperating plug-in gets the host's language, and the host gets the
/// plug-in's display name, brightness, focus and whether it has unsaved changes.

/// On the plug-in's component.
class IVST3CorvaneVendorSpecificComponent : public Steinberg::FUnknown
{
public:
    /// In bytes, 0 for none.
    virtual Steinberg::int32 PLUGIN_API GetDisplayNameLength() = 0;
    /// UTF-8, without a terminator, into a buffer of that length.
    virtual void PLUGIN_API GetDisplayName(char* buffer) = 0;

    static const Steinberg::FUID iid;
};

/// On the host context.
class IVST3CorvaneVendorSpecificHost : public Steinberg::FUnknown
{
public:
    /// 0 for a language without a code.
    virtual Steinberg::int32 PLUGIN_API GetUILanguage() = 0;
    virtual Steinberg::int32 PLUGIN_API GetThemeXMLLength() = 0;
    virtual void PLUGIN_API GetThemeXML(unsigned char* buffer) = 0;
    /// Hands the keyboard focus back to the host: forward for 1.
    virtual void PLUGIN_API GainFocus(long direction) = 0;
    /// A locale identifier such as "en_US"; owned by the host.
    virtual const char* PLUGIN_API GetUILanguageString() = 0;

    static const Steinberg::FUID iid;
};

/// On the plug-in's controller.
class IVST3CorvaneVendorSpecificEffect : public Steinberg::FUnknown
{
public:
    virtual void PLUGIN_API SetBrightness(float brightness) = 0;
    virtual void PLUGIN_API SetBrightnessFlag(bool flag) = 0;
    /// Both non-zero when the plug-in took the focus.
    virtual Steinberg::int32 PLUGIN_API GainFocus(bool forward) = 0;
    virtual Steinberg::int32 PLUGIN_API SetCurrentFocus() = 0;
    virtual bool PLUGIN_API IsDirty() = 0;

    static const Steinberg::FUID iid;
};

DECLARE_CLASS_IID(IVST3CorvaneVendorSpecificComponent, 0x872ee790, 0x61b243a2, 0x8dba33c1, 0xd9262d3e)
DECLARE_CLASS_IID(IVST3CorvaneVendorSpecificHost, 0x7fcbcfce, 0x2862476a, 0xbff2219b, 0xca70789d)
DECLARE_CLASS_IID(IVST3CorvaneVendorSpecificEffect, 0x3c8a2f25, 0x14114bf7, 0x851b13cb, 0x9c55ac92)

} // namespace zebaudiofilterhost::vst3
