// Factory presets, and the unit's class info as a preset.

#include "foundation/zebcore/Trace.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUAudioFilter.h"

namespace zebaudiofilterhost::xau
{

namespace
{

// A property list as bytes in binary form; null if it cannot be written.
CFOwner PrintBinary(CFPropertyListRef list)
{
    CFWriteStreamRef stream = CFWriteStreamCreateWithAllocatedBuffers(kCFAllocatorDefault, kCFAllocatorDefault);
    const CFOwner owner(stream);
    if (!stream || CFWriteStreamOpen(stream) == 0)
        return nullptr;
    const CFIndex written = CFPropertyListWrite(list, stream, kCFPropertyListBinaryFormat_v1_0, 0, nullptr);
    CFOwner bytes(written > 0 ? CFWriteStreamCopyProperty(stream, kCFStreamPropertyDataWritten) : nullptr);
    CFWriteStreamClose(stream);
    return bytes;
}

// Null if the bytes are no property list.
CFOwner ParseBytes(const std::vector<unsigned char>& bytes)
{
    CFReadStreamRef stream = CFReadStreamCreateWithBytesNoCopy(kCFAllocatorDefault, bytes.data(),
                                                               static_cast<CFIndex>(bytes.size()), kCFAllocatorNull);
    const CFOwner owner(stream);
    if (!stream || CFReadStreamOpen(stream) == 0)
        return nullptr;
    CFOwner list(
        CFPropertyListCreateWithStream(kCFAllocatorDefault, stream, 0, kCFPropertyListImmutable, nullptr, nullptr));
    CFReadStreamClose(stream);
    return list;
}

} // namespace

bool XAUAudioFilter::DoPresetsUseChunkData() const
{
    return true; // the class info is the preset
}

int XAUAudioFilter::GetNumFactoryPresets() const
{
    return mFactoryPresets ? static_cast<int>(CFArrayGetCount(mFactoryPresets)) : 0;
}

// Null if there is none.
const AUPreset* XAUAudioFilter::GetFactoryPreset(int index) const
{
    if (index < 0 || index >= GetNumFactoryPresets())
        return nullptr;
    return static_cast<const AUPreset*>(CFArrayGetValueAtIndex(mFactoryPresets, index));
}

UTF16String XAUAudioFilter::GetFactoryPresetName(int index) const
{
    const AUPreset* preset = GetFactoryPreset(index);
    return preset ? MACtoZEB(preset->presetName) : UTF16String();
}

void XAUAudioFilter::SetFactoryPreset(int index)
{
    const AUPreset* preset = GetFactoryPreset(index);
    if (!preset)
        return;
    const OSStatus result = CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_PresentPreset,
                                                              kAudioUnitScope_Global, 0, preset, sizeof(*preset));
    DumpResultIfFailed(result, "AudioUnitSetProperty(kAudioUnitProperty_PresentPreset)");
    if (result == noErr)
        NotifyListeners(kAUParameterListener_AnyParameter, kAudioUnitScope_Global);
}

// The class info is deliberately not released: units disagree about whose it is, and a dead one would crash those
// that keep it.
bool XAUAudioFilter::SaveChunkData(PresetData& preset) const
{
    CFPropertyListRef classInfo = nullptr;
    UInt32 size = sizeof(classInfo);
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ClassInfo,
                                                              kAudioUnitScope_Global, 0, &classInfo, &size);
    DumpResultIfFailed(result, "AudioUnitGetProperty(kAudioUnitProperty_ClassInfo)");
    if (result != noErr)
        return false;
    const CFOwner bytes = classInfo ? PrintBinary(classInfo) : nullptr;
    const auto* data = static_cast<CFDataRef>(bytes.get());
    preset.SetChunkData(data ? CFDataGetBytePtr(data) : nullptr,
                        data ? static_cast<unsigned long>(CFDataGetLength(data)) : 0);
    preset.SetVersion(GetCurrentPresetVersion());
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    return true;
}

bool XAUAudioFilter::LoadChunkData(const PresetData& preset)
{
    std::vector<unsigned char> chunk;
    if (!preset.GetChunkData(chunk))
        return false;
    const CFOwner list = ParseBytes(chunk);
    if (!list)
        return false;
    CFPropertyListRef const classInfo = list.get();
    const OSStatus result = CallGuarded<AudioUnitSetProperty>(
        mInstance, kAudioUnitProperty_ClassInfo, kAudioUnitScope_Global, 0, &classInfo, sizeof(classInfo));
    DumpResultIfFailed(result, "AudioUnitSetProperty(kAudioUnitProperty_ClassInfo)");
    if (result == noErr)
        NotifyListeners(kAUParameterListener_AnyParameter, kAudioUnitScope_Global);
    return result == noErr;
}

} // namespace zebaudiofilterhost::xau
