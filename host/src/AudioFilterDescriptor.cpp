#include "host/AudioFilterDescriptor.h"

#include "foundation/zebcore/Localizer.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/RefCountedInterface.h"
#include "host/src/EntryKeys.h"

#include <map>

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_Category = u8"category";
const UTF8String kKey_ID = u8"id";
const UTF8String kKey_FactoryGuid = u8"factory_guid";
const UTF8String kKey_Synth = u8"synth";
const UTF8String kKey_Mono = u8"mono";
const UTF8String kKey_Stereo = u8"stereo";

const UTF16String& InternalVendor()
{
    static const UTF16String sVendor = u"Corvane Systems";
    return sVendor;
}

using CategoryKeys = std::map<AudioFilterCategory, const char*>;

const CategoryKeys& GetCategoryKeys()
{
    static const CategoryKeys sKeys = {
        {kCategoryEffect, "$$$/zebaudiofilterhost/componentdescriptor/category/Effect=Effect"},
        {kCategorySynth, "$$$/zebaudiofilterhost/componentdescriptor/category/Synth=Synth"},
        {kCategoryAnalysis, "$$$/zebaudiofilterhost/componentdescriptor/category/Analysis=Analysis"},
        {kCategoryMastering, "$$$/zebaudiofilterhost/componentdescriptor/category/Mastering=Mastering"},
        {kCategorySpacializer, "$$$/zebaudiofilterhost/componentdescriptor/category/Spacializer=Spacializer"},
        {kCategoryRoomFx, "$$$/zebaudiofilterhost/componentdescriptor/category/RoomFx=RoomFx"},
        {kCategorySurroundFx, "$$$/zebaudiofilterhost/componentdescriptor/category/SurroundFx=SurroundFx"},
        {kCategoryRestoration, "$$$/zebaudiofilterhost/componentdescriptor/category/Restoration=Restoration"},
        {kCategoryOfflineProcess, "$$$/zebaudiofilterhost/componentdescriptor/category/OfflineProcess=Offline"},
        {kCategoryGenerator, "$$$/zebaudiofilterhost/componentdescriptor/category/Generator=Generator"},
        {kCategoryVST3Analyzer, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Analyzer=Analyzer"},
        {kCategoryVST3Delay, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Delay=Delay"},
        {kCategoryVST3Distortion, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Distortion=Distortion"},
        {kCategoryVST3Dynamics, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Dynamics=Dynamics"},
        {kCategoryVST3EQ, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3EQ=EQ"},
        {kCategoryVST3Filter, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Filter=Filter"},
        {kCategoryVST3Instrument, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Instrument=Instrument"},
        {kCategoryVST3Spatial, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Spatial=Spatial"},
        {kCategoryVST3Generator, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Generator=Generator"},
        {kCategoryVST3Mastering, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Mastering=Mastering"},
        {kCategoryVST3Modulation, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Modulation=Modulation"},
        {kCategoryVST3PitchShift, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3PitchShift=Pitch Shift"},
        {kCategoryVST3Restoration, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Restoration=Restoration"},
        {kCategoryVST3Reverb, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Reverb=Reverb"},
        {kCategoryVST3Surround, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Surround=Surround"},
        {kCategoryVST3Tools, "$$$/zebaudiofilterhost/componentdescriptor/category/Vst3Tools=Tools"},
    };
    return sKeys;
}

} // namespace

AudioFilterDescriptor::AudioFilterDescriptor(const PluginLocator& locator, const UTF16String& name,
                                             const UTF16String& vendor, unsigned int version,
                                             AudioFilterCategory category, const UTF16String& id,
                                             const Guid& factoryGuid, bool synth)
    : mLocator(locator)
    , mName(name)
    , mVendor(vendor)
    , mVersion(version)
    , mCategory(category)
    , mUniqueID(id)
    , mFactoryGuid(factoryGuid)
    , mSynth(synth)
{
}

AudioFilterDescriptor::AudioFilterDescriptor(const UTF16String& name, unsigned int version,
                                             AudioFilterCategory category, const UTF16String& id,
                                             const Guid& factoryGuid, bool synth)
    : AudioFilterDescriptor(PluginLocator(kTechnologyInternal, UTF16String()), name, InternalVendor(), version,
                            category, id, factoryGuid, synth)
{
}

AudioFilterDescriptor::AudioFilterDescriptor(const PropList& list)
{
    Read(list);
}

AudioFilterDescriptor::~AudioFilterDescriptor() = default;

const PluginLocator& AudioFilterDescriptor::GetLocator() const
{
    return mLocator;
}

const UTF16String& AudioFilterDescriptor::GetName() const
{
    return mName;
}

const UTF16String& AudioFilterDescriptor::GetVendorString() const
{
    return mVendor;
}

unsigned int AudioFilterDescriptor::GetVersion() const
{
    return mVersion;
}

AudioFilterCategory AudioFilterDescriptor::GetCategory() const
{
    return mCategory;
}

const UTF16String& AudioFilterDescriptor::GetUniqueID() const
{
    return mUniqueID;
}

const Guid& AudioFilterDescriptor::GetFactoryGuid() const
{
    return mFactoryGuid;
}

bool AudioFilterDescriptor::IsEnabled() const
{
    return mEnabled;
}

bool AudioFilterDescriptor::IsSynth() const
{
    return mSynth;
}

bool AudioFilterDescriptor::GetSupportsMono() const
{
    return mSupportsMono;
}

bool AudioFilterDescriptor::GetSupportsStereo() const
{
    return mSupportsStereo;
}

bool AudioFilterDescriptor::IsInternal() const
{
    return mLocator.GetTechnologyType() == kTechnologyInternal;
}

UTF16String AudioFilterDescriptor::GetCategoryName() const
{
    const CategoryKeys& keys = GetCategoryKeys();
    const auto found = keys.find(mCategory);
    return found == keys.end() ? UTF16String() : zebcore::config::Localizer::Get().Localize(found->second);
}

void AudioFilterDescriptor::SetEnabled(bool enabled)
{
    mEnabled = enabled;
}

void AudioFilterDescriptor::SetSupportsMono(bool supports)
{
    mSupportsMono = supports;
}

void AudioFilterDescriptor::SetSupportsStereo(bool supports)
{
    mSupportsStereo = supports;
}

void AudioFilterDescriptor::Read(const PropList& list)
{
    UTF16String locator;
    list.GetValue(kKey_Locator, locator);
    mLocator.FromString(locator);
    list.GetValue(kKey_Name, mName);
    list.GetValue(kKey_Vendor, mVendor);
    list.GetValue(kKey_Version, mVersion);
    int category = kCategoryNone;
    list.GetValue(kKey_Category, category);
    mCategory = static_cast<AudioFilterCategory>(category);
    list.GetValue(kKey_ID, mUniqueID);
    UTF16String guid;
    list.GetValue(kKey_FactoryGuid, guid);
    mFactoryGuid = Guid::StringToGUID(guid);
    list.GetValue(kKey_Enabled, mEnabled);
    list.GetValue(kKey_Synth, mSynth);
    list.GetValue(kKey_Mono, mSupportsMono);
    list.GetValue(kKey_Stereo, mSupportsStereo);
}

void AudioFilterDescriptor::Write(PropList& list) const
{
    list.SetValue(kKey_Locator, mLocator.ToString());
    list.SetValue(kKey_Name, mName);
    list.SetValue(kKey_Vendor, mVendor);
    list.SetValue(kKey_Version, mVersion);
    list.SetValue(kKey_Category, static_cast<int>(mCategory));
    list.SetValue(kKey_ID, mUniqueID);
    list.SetValue(kKey_FactoryGuid, mFactoryGuid.AsString());
    list.SetValue(kKey_Enabled, mEnabled);
    list.SetValue(kKey_Synth, mSynth);
    list.SetValue(kKey_Mono, mSupportsMono);
    list.SetValue(kKey_Stereo, mSupportsStereo);
}

void intrusive_ptr_add_ref(AudioFilterDescriptor* descriptor)
{
    descriptor->AddRefCount();
}

void intrusive_ptr_release(AudioFilterDescriptor* descriptor)
{
    descriptor->ReleaseRefCount();
}

} // namespace zebaudiofilterhost
