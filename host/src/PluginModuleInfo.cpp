#include "host/PluginModuleInfo.h"

#include "foundation/zebcore/PropList.h"
#include "host/src/EntryKeys.h"

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_Type = u8"type";
const UTF8String kKey_IsShell = u8"isShell";
const UTF8String kKey_HasNonSynth = u8"hasNonSynth";

} // namespace

PluginModuleInfo::PluginModuleInfo(const PluginLocator& locator, const UTF16String& name, const UTF16String& vendor,
                                   unsigned int version, TechnologyType type, bool enabled, bool isShell)
    : mLocator(locator)
    , mName(name)
    , mVendor(vendor)
    , mVersion(version)
    , mType(type)
    , mEnabled(enabled)
    , mIsShell(isShell)
    , mHasAnyNonSynthEffect(false)
{
}

PluginModuleInfo::PluginModuleInfo(const PropList& list)
{
    Read(list);
}

PluginModuleInfo::~PluginModuleInfo() = default;

const PluginLocator& PluginModuleInfo::GetLocator() const
{
    return mLocator;
}

const UTF16String& PluginModuleInfo::GetName() const
{
    return mName;
}

const UTF16String& PluginModuleInfo::GetVendor() const
{
    return mVendor;
}

unsigned int PluginModuleInfo::GetVersion() const
{
    return mVersion;
}

TechnologyType PluginModuleInfo::GetType() const
{
    return mType;
}

bool PluginModuleInfo::IsEnabled() const
{
    return mEnabled;
}

bool PluginModuleInfo::IsShell() const
{
    return mIsShell;
}

bool PluginModuleInfo::HasAnyNonSynthEffect() const
{
    return mHasAnyNonSynthEffect;
}

void PluginModuleInfo::SetEnabled(bool enabled)
{
    mEnabled = enabled;
}

void PluginModuleInfo::SetHasAnyNonSynthEffect(bool hasAny)
{
    mHasAnyNonSynthEffect = hasAny;
}

void PluginModuleInfo::Read(const PropList& list)
{
    UTF16String locator;
    list.GetValue(kKey_Locator, locator);
    mLocator.FromString(locator);
    list.GetValue(kKey_Name, mName);
    list.GetValue(kKey_Vendor, mVendor);
    list.GetValue(kKey_Version, mVersion);
    int type = kTechnologyNone;
    list.GetValue(kKey_Type, type);
    mType = static_cast<TechnologyType>(type);
    list.GetValue(kKey_Enabled, mEnabled);
    list.GetValue(kKey_IsShell, mIsShell);
    list.GetValue(kKey_HasNonSynth, mHasAnyNonSynthEffect);
}

void PluginModuleInfo::Write(PropList& list) const
{
    list.SetValue(kKey_Locator, mLocator.ToString());
    list.SetValue(kKey_Name, mName);
    list.SetValue(kKey_Vendor, mVendor);
    list.SetValue(kKey_Version, mVersion);
    list.SetValue(kKey_Type, static_cast<int>(mType));
    list.SetValue(kKey_Enabled, mEnabled);
    list.SetValue(kKey_IsShell, mIsShell);
    list.SetValue(kKey_HasNonSynth, mHasAnyNonSynthEffect);
}

} // namespace zebaudiofilterhost
