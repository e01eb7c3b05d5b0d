// What plug-ins ask their host: handlers of an instance first, then the instance, then the static answers. Any thread
// may call, the process thread included, so the answers neither lock nor allocate. What a plug-in tells of its
// parameters and its view is another matter: that fires signals, which do both.

#include "foundation/zebcore/Trace.h"
#include "host/PluginModule.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTParameterSetting.h"
#include "host/src/VST/src/VSTText.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <string_view>

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr long long kHostVstVersion = 2400;
constexpr long long kVendorVersion = 4;
constexpr const char* kVendor = "Corvane Systems";
constexpr const char* kProduct = "Opal";

// Vendor-specific selectors, which travel in the index.
constexpr int kIsVendorHost = 0x2e903f43;
constexpr int kGetLanguage = 0x70400000;
constexpr long long kVendorAnswer = 0x11005678;

// The plug-in's buffer has the published size.
long long CopyText(const char* text, void* ptr)
{
    if (!ptr)
        return 0;
    std::memcpy(ptr, text, std::strlen(text) + 1);
    return 1;
}

// The code is the place in this list; 0 is any other language.
std::int64_t GetLanguageCode()
{
    constexpr std::array<std::string_view, 7> kLocales = {"de_DE", "fr_FR", "ja_JP", "es_ES",
                                                          "it_IT", "ko_KR", "zh_CN"};
    const auto* const found = std::find(kLocales.begin(), kLocales.end(), PluginModule::GetLocaleIdentifier());
    return found == kLocales.end() ? 0 : found - kLocales.begin() + 1;
}

long long AnswerVendorSpecific(int index, void* ptr)
{
    if (index == kIsVendorHost)
        return kVendorAnswer;
    if (index != kGetLanguage || !ptr)
        return 0;
    const std::int64_t code = GetLanguageCode();
    std::memcpy(ptr, &code, sizeof(code)); // the plug-in's memory may lie anywhere
    return kVendorAnswer;
}

long long AnswerCanDo(const void* ptr)
{
    ZEB_TRACE("VSTAudioFilter::StaticAudioMasterCallback",
              "audioMasterCanDo->" << (ptr ? static_cast<const char*>(ptr) : ""));
    return EqualsText(ptr, "shellCategory") || EqualsText(ptr, "sendVstTimeInfo") ? 1 : 0;
}

// Without an instance, or when it has nothing to say. Plug-ins that report new latencies or pins get no reaction.
long long AnswerStatically(int opcode, int index, void* ptr)
{
    switch (opcode)
    {
    case audioMasterVersion:
        return kHostVstVersion;
    case audioMasterCurrentId:
        return VSTAudioFilter::GetCurrentFilterID();
    case audioMasterGetVendorString:
        return CopyText(kVendor, ptr);
    case audioMasterGetProductString:
        return CopyText(kProduct, ptr);
    case audioMasterGetVendorVersion:
        return kVendorVersion;
    case audioMasterVendorSpecific:
        return AnswerVendorSpecific(index, ptr);
    case audioMasterCanDo:
        return AnswerCanDo(ptr);
    case audioMasterGetLanguage:
        return kVstLangEnglish; // whatever the locale
    default:
        return 0;
    }
}

} // namespace

// Never destroyed: plug-ins call from their own threads up to the end of the process.
AudioMasterHandlerMap& VSTAudioFilter::sCallbackMap = *new AudioMasterHandlerMap;
std::atomic<int> VSTAudioFilter::sCurrentFilterID = 0;

int VSTAudioFilter::GetCurrentFilterID()
{
    return sCurrentFilterID.load(std::memory_order_relaxed); // says nothing about other data
}

void VSTAudioFilter::SetCurrentFilterID(int filterID)
{
    sCurrentFilterID.store(filterID, std::memory_order_relaxed);
}

long long VSTAudioFilter::StaticAudioMasterCallback(AEffect* effect, std::int32_t opcode, std::int32_t index,
                                                    long long value, void* ptr, float opt)
{
    const long long answer = sCallbackMap.CallOne(effect, opcode, index, value, ptr, opt);
    return answer != 0 ? answer : AnswerStatically(opcode, index, ptr);
}

long long VSTAudioFilter::AudioMasterCallback(int opcode, int index, long long value, void* ptr, float opt)
{
    if (const long long answer = mHandlers.CallAll(opcode, index, value, ptr, opt); answer != 0)
        return answer;
    switch (opcode)
    {
    case audioMasterAutomate:
        Automate(index, opt);
        return 0;
    case audioMasterPinConnected:
        return PinConnected(index, value);
    case audioMasterGetTime:
        return GetTime(value);
    default:
        return 0;
    }
}

void VSTAudioFilter::AddAudioMasterHandler(void* owner, const AudioMasterHandler& handler)
{
    mHandlers.Insert(owner, handler);
}

void VSTAudioFilter::RemoveAudioMasterHandler(void* owner)
{
    mHandlers.Erase(owner);
}

// A plug-in that reports a parameter from the very call that sets it, or two parameters that report each other, would
// be set again without end. The plug-in has that value already, so everybody else is told, and it is not.
void VSTAudioFilter::Automate(int index, float value)
{
    if (!VSTParameterSetting::IsUnderWay(this, index))
        return SetParameterAutomated(index, value);
    AudioFilter::SetParameter(index, value);
    FireAutomatedParameterChange(index, value);
}

// 0 says that the pin is connected. Pins count as far as the buses have channels, not as far as the plug-in has pins.
long long VSTAudioFilter::PinConnected(int index, long long value) const
{
    constexpr long long kInput = 0;
    constexpr long long kOutput = 1;
    const bool connected = (value == kInput && index < mFirstInputBusChannels.load(std::memory_order_relaxed)) ||
                           (value == kOutput && index < mFirstOutputBusChannels.load(std::memory_order_relaxed));
    return connected ? 0 : 1;
}

// The record's address as a number.
long long VSTAudioFilter::GetTime(long long wanted)
{
    if (mSuspended.load(std::memory_order_relaxed))
        return 0;
    UpdateTimeInfo(wanted);
    return std::bit_cast<long long>(&mTimeInfo);
}

} // namespace zebaudiofilterhost::vst
