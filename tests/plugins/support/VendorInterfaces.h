#pragma once

#include "examples/effects/support/Vst3.h"

namespace fixture
{

using namespace Steinberg;

// A maker's own extension of VST 3, as a cooperating plug-in declares it.
class VendorSpecificComponent : public FUnknown
{
public:
    virtual int32 PLUGIN_API GetDisplayNameLength() = 0;
    virtual void PLUGIN_API GetDisplayName(char* buffer) = 0;
    static const FUID iid;
};

class VendorSpecificHost : public FUnknown
{
public:
    virtual int32 PLUGIN_API GetUILanguage() = 0;
    virtual int32 PLUGIN_API GetThemeXMLLength() = 0;
    virtual void PLUGIN_API GetThemeXML(unsigned char* buffer) = 0;
    virtual void PLUGIN_API GainFocus(long direction) = 0;
    virtual const char* PLUGIN_API GetUILanguageString() = 0;
    static const FUID iid;
};

class VendorSpecificEffect : public FUnknown
{
public:
    virtual void PLUGIN_API SetBrightness(float brightness) = 0;
    virtual void PLUGIN_API SetBrightnessFlag(bool flag) = 0;
    virtual int32 PLUGIN_API GainFocus(bool forward) = 0;
    virtual int32 PLUGIN_API SetCurrentFocus() = 0;
    virtual bool PLUGIN_API IsDirty() = 0;
    static const FUID iid;
};

} // namespace fixture
