// Life of the filter, and what it tells about itself.

#include "host/src/VST/src/VSTAudioFilter.h"

#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/VST/src/VSTEffectText.h"
#include "host/src/VST/src/VSTFilterID.h"
#include "host/src/VST/src/VSTParameterInfo.h"
#include "host/src/VST/src/VSTParameterSetting.h"

#include <algorithm>
#include <string_view>

namespace zebaudiofilterhost::vst
{

namespace
{

// The one plug-in that is known by its identity.
constexpr std::u16string_view kPlainFinisherComponentID = u"2:1517179725 PlainFinisher";

// What a plug-in gets until the application says more.
constexpr float kOpeningSampleRate = 44100.0F;
constexpr int kOpeningBlockSize = 2048;

// Parameters beyond these are a lie of the plug-in's.
constexpr int kMaxParameters = 32768;

// The first answer of effGetVstVersion that knows of categories is one above.
constexpr long long kLastVersionWithoutCategories = 1;

AudioFilterCategory MapCategory(long long plugCategory)
{
    if (plugCategory >= kPlugCategEffect && plugCategory <= kPlugCategOfflineProcess)
        return static_cast<AudioFilterCategory>(plugCategory);
    return plugCategory == kPlugCategGenerator ? kCategoryGenerator : kCategoryNone;
}

AudioFilterCategory QueryCategory(const VSTDispatcherBase& plugin)
{
    if (plugin.Dispatcher(effGetVstVersion, 0, 0, nullptr, 0.0F) <= kLastVersionWithoutCategories)
        return kCategoryNone;
    return MapCategory(plugin.Dispatcher(effGetPlugCategory, 0, 0, nullptr, 0.0F));
}

} // namespace

VSTAudioFilter::VSTAudioFilter(const UTF16String& filterID, const UTF16String& path, AEffect* effect, bool openFlag,
                               bool useFileTitle)
    : AudioFilter(filterID, UTF16String()), VSTDispatcherBase(effect), mOpenFlag(openFlag)
{
    if (filterID == kPlainFinisherComponentID)
        SetHasHighCPU(true);
    StartTimeInfo();
    // Ahead of the first dispatcher call, which may already call back.
    sCallbackMap.Insert(effect, [this](int opcode, int index, long long value, void* ptr, float opt)
                        { return AudioMasterCallback(opcode, index, value, ptr, opt); });
    try
    {
        OpenPlugin(path, useFileTitle);
    }
    catch (...) // no destructor follows
    {
        ClosePlugin();
        throw;
    }
}

void VSTAudioFilter::OpenPlugin(const UTF16String& path, bool useFileTitle)
{
    Dispatcher(effOpen, 0, 0, nullptr, 0.0F);
    Dispatcher(effSetSampleRate, 0, 0, nullptr, kOpeningSampleRate);
    Dispatcher(effSetBlockSize, 0, kOpeningBlockSize, nullptr, 0.0F);
    SetDisplayName(ChooseDisplayName(path, useFileTitle));
    BuildParameterInfos();
    BuildIOConfiguration();
}

// From here on the plug-in gets the static answers. Its calls that are still under way on threads of its own have
// ended when effClose returns, since these threads live in what it then takes down; all that such a call can reach is
// still there.
void VSTAudioFilter::ClosePlugin()
{
    sCallbackMap.Erase(GetEffect());
    Dispatcher(effClose, 0, 0, nullptr, 0.0F);
}

VSTAudioFilter::~VSTAudioFilter()
{
    ClosePlugin();
    FreeCurrentSpeakerArrangements();
    mEditor.reset();
}

UTF16String VSTAudioFilter::ChooseDisplayName(const UTF16String& path, bool useFileTitle) const
{
    UTF16String name = GetEffectName(GetEffect());
    if (name.empty() || useFileTitle)
        name = File(path).GetTitle();
    return name;
}

void VSTAudioFilter::BuildParameterInfos()
{
    const int count = VSTAudioFilter::GetParameterCount();
    mParameterInfos.reserve(static_cast<std::size_t>(count));
    for (int index = 0; index < count; ++index)
        mParameterInfos.emplace_back(new VSTParameterInfo(GetEffect(), index));
}

int VSTAudioFilter::GetParameterCount() const
{
    return GetEffect() ? std::clamp(GetEffect()->numParams, 0, kMaxParameters) : 0;
}

void VSTAudioFilter::SetParameter(int index, float value)
{
    if (index >= 0 && index < GetParameterCount() && GetEffect()->setParameter)
    {
        const VSTParameterSetting setting(this, index);
        GetEffect()->setParameter(GetEffect(), index, value);
    }
    AudioFilter::SetParameter(index, value);
}

float VSTAudioFilter::GetParameter(int index) const
{
    const bool exists = index >= 0 && index < GetParameterCount() && GetEffect()->getParameter != nullptr;
    return exists ? GetEffect()->getParameter(GetEffect(), index) : 0.0F;
}

boost::intrusive_ptr<AudioFilterParameterInfo> VSTAudioFilter::GetParameterInfo(int index) const
{
    if (index < 0 || static_cast<std::size_t>(index) >= mParameterInfos.size())
        return {};
    return mParameterInfos[static_cast<std::size_t>(index)];
}

bool VSTAudioFilter::CanMono() const
{
    return GetEffect() != nullptr && (GetEffect()->flags & effFlagsCanMono) != 0;
}

boost::intrusive_ptr<AudioFilterDescriptor> VSTAudioFilter::CreateFilterDescriptor(const PluginLocator& locator,
                                                                                   bool skipCategory)
{
    AEffect* const effect = GetEffect();
    if (!effect)
        return {};
    const auto version = static_cast<unsigned int>(Dispatcher(effGetVstVersion, 0, 0, nullptr, 0.0F));
    const bool synth = (effect->flags & effFlagsIsSynth) != 0;
    const UTF16String name = GetDisplayName();
    const UTF16String vendor = GetVendorString(effect);
    const AudioFilterCategory category = skipCategory ? kCategoryNotQueried : QueryCategory(*this);
    ZEB_TRACE("VST", "CreateFilterDescriptor, Effectname: " << name);
    const UTF16String path = locator.GetPath();
    const boost::intrusive_ptr<AudioFilterDescriptor> descriptor(new AudioFilterDescriptor(
        PluginLocator(kTechnologyVST, path), name, vendor, version, category,
        EncodeFilterID(static_cast<unsigned int>(effect->uniqueID), path), GetVSTFactoryGuid(), synth));
    descriptor->SetSupportsMono(IsChannelFormatSupported(zebmediatypes::CreateMonoChannelLayout()));
    descriptor->SetSupportsStereo(IsChannelFormatSupported(zebmediatypes::CreateStereoChannelLayout()));
    return descriptor;
}

} // namespace zebaudiofilterhost::vst
