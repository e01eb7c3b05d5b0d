// Life of the filter, and what it tells about itself.

#include "host/src/XAU/src/XAUAudioFilter.h"

#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/PluginModuleInfo.h"
#include "host/XAU/XAUTechnology.h"
#include "host/src/FilterIDPrefix.h"
#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUComponentID.h"

#include <cmath>
#include <limits>

namespace zebaudiofilterhost::xau
{

namespace
{

// What a unit gets until the application says more.
constexpr float kOpeningSampleRate = 44100.0F;
constexpr int kOpeningBlockSize = 512;

} // namespace

void DumpResultIfFailed(OSStatus code, const char* call)
{
    if (code != noErr)
        ZEB_TRACE("XAUAudioFilter", call << " failed with code " << code);
}

void DumpRealtimeResultIfFailed(OSStatus code, const char* call)
{
    if (code != noErr)
        ZEB_TRACE_REALTIME("XAUAudioFilter", call << " failed with code " << code);
}

boost::intrusive_ptr<XAUAudioFilter> XAUAudioFilter::Create(const UTF16String& filterID)
{
    ZEB_TRACE("XAUAudioFilter", "Create(" << filterID << ")");
    const bool lacksPrefix = filterID.size() > 2 && !HasTechnologyPrefix(filterID);
    const UTF16String prefixedID = lacksPrefix ? u"4:" + filterID : filterID;
    auto* const component = FindComponentForDescription(DecodeComponentID(prefixedID));
    AudioUnit instance = nullptr;
    if (!component || CallGuarded<AudioComponentInstanceNew>(component, &instance) != noErr || !instance)
        return {};
    try
    {
        return new XAUAudioFilter(prefixedID, component, instance);
    }
    catch (...) // for instance no memory for what the unit lists; it is disposed of already
    {
        return {};
    }
}

XAUAudioFilter::XAUAudioFilter(const UTF16String& filterID, AudioComponent component, AudioUnit instance)
    : AudioFilter(filterID, filterID), mComponent(component), mInstance(instance)
{
    try
    {
        SetUp();
    }
    catch (...)
    {
        TakeDown();
        throw;
    }
}

XAUAudioFilter::~XAUAudioFilter()
{
    if (mEditor)
        mEditor->ReleaseView();
    mEditor.reset();
    TakeDown();
}

void XAUAudioFilter::SetUp()
{
    UTF16String name;
    UTF16String vendor;
    GetNameAndManufacturer(mComponent, name, vendor);
    SetDisplayName(name);
    ZEB_TRACE("XAUAudioFilter", "XAUAudioFilter(), vendor: " << vendor << ", effect: " << name);
    UInt32 size = sizeof(CFArrayRef);
    if (CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_FactoryPresets, kAudioUnitScope_Global, 0,
                                          &mFactoryPresets, &size) != noErr)
        mFactoryPresets = nullptr;
    BuildParameterInfos();
    SetHostCallbacks();
    XAUAudioFilter::SetSampleRate(kOpeningSampleRate);
    XAUAudioFilter::SetBlockSize(kOpeningBlockSize);
    InitializeAU();
    ListenToUnit();
}

void XAUAudioFilter::TakeDown() noexcept
{
    if (mListener)
        AUListenerDispose(mListener);
    if (mAUInitialized)
        CallGuarded<AudioUnitUninitialize>(mInstance);
    if (mFactoryPresets)
        CFRelease(mFactoryPresets);
    // The infos ask the unit until the last moment; nobody may have kept one.
    CallGuarded<AudioComponentInstanceDispose>(mInstance);
}

void XAUAudioFilter::SetHostCallbacks()
{
    HostCallbackInfo callbacks = {};
    callbacks.hostUserData = this;
    callbacks.beatAndTempoProc = GetBeatAndTempo;
    callbacks.musicalTimeLocationProc = GetMusicalTimeLocation;
    callbacks.transportStateProc = GetTransportState;
    DumpResultIfFailed(CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_HostCallbacks,
                                                         kAudioUnitScope_Global, 0, &callbacks, sizeof(callbacks)),
                       "kAudioUnitProperty_HostCallbacks");
}

void XAUAudioFilter::InitializeAU()
{
    if (mAUInitialized)
        return;
    const OSStatus result = CallGuarded<AudioUnitInitialize>(mInstance);
    DumpResultIfFailed(result, "AudioUnitInitialize");
    mAUInitialized = result == noErr;
}

void XAUAudioFilter::UninitializeAU()
{
    if (!mAUInitialized)
        return;
    CallGuarded<AudioUnitUninitialize>(mInstance);
    mAUInitialized = false;
}

int XAUAudioFilter::GetMaxProcessingBlockSize() const
{
    return kMaxChunk;
}

int XAUAudioFilter::GetInitialDelay() const
{
    Float64 seconds = 0.0;
    UInt32 size = sizeof(seconds);
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_Latency,
                                                              kAudioUnitScope_Global, 0, &seconds, &size);
    DumpResultIfFailed(result, "kAudioUnitProperty_Latency");
    const double samples = seconds * static_cast<double>(mSampleRate);
    const bool isUsable = result == noErr && std::abs(samples) <= std::numeric_limits<int>::max();
    return isUsable ? static_cast<int>(samples) : 0;
}

boost::intrusive_ptr<AudioFilterDescriptor> XAUAudioFilter::CreateFilterDescriptor(const PluginLocator& /*locator*/,
                                                                                   bool /*skipCategory*/)
{
    UTF16String name;
    UTF16String vendor;
    GetNameAndManufacturer(mComponent, name, vendor);
    const UTF16String id = GetID();
    const PluginLocator locator(kTechnologyAudioUnit, WithoutTechnologyPrefix(id));
    const boost::intrusive_ptr<AudioFilterDescriptor> descriptor(
        new AudioFilterDescriptor(locator, name, vendor, 0, kCategoryNone, id, GetXAUFactoryGuid(), false));
    descriptor->SetSupportsMono(IsChannelFormatSupported(zebmediatypes::CreateMonoChannelLayout()));
    descriptor->SetSupportsStereo(IsChannelFormatSupported(zebmediatypes::CreateStereoChannelLayout()));
    return descriptor;
}

boost::intrusive_ptr<PluginModuleInfo>
XAUAudioFilter::EnumerateFilters(const PluginLocator& locator, int, int,
                                 std::vector<boost::intrusive_ptr<AudioFilterDescriptor>>& descriptors)
{
    descriptors.clear();
    const boost::intrusive_ptr<XAUAudioFilter> filter = Create(locator.ToString());
    if (!filter)
        return {};
    filter->UninitializeAU();
    filter->SetSampleRate(kOpeningSampleRate);
    filter->SetBlockSize(kOpeningBlockSize);
    const auto descriptor = filter->CreateFilterDescriptor(locator, false);
    if (!descriptor)
        return {};
    UInt32 version = 0;
    AudioComponentGetVersion(filter->mComponent, &version);
    descriptors.push_back(descriptor);
    return new PluginModuleInfo(locator, descriptor->GetName(), descriptor->GetVendorString(), version,
                                kTechnologyAudioUnit, true, false);
}

bool XAUAudioFilter::HasCustomEditor() const
{
    return true; // a unit without a view of its own gets a general one
}

boost::intrusive_ptr<AudioFilterEditor> XAUAudioFilter::CreateCustomEditor()
{
    if (!mEditor)
        mEditor = new XAUAudioFilterEditor(this, mInstance);
    return mEditor;
}

} // namespace zebaudiofilterhost::xau
