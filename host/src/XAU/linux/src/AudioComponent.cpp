#include "AudioToolbox/AudioComponent.h"

#include "host/src/XAU/linux/src/ComponentInstance.h"
#include "host/src/XAU/linux/src/ComponentRegistry.h"

#include <memory>

using namespace zebaudiofilterhost;
using namespace zebaudiofilterhost::xau;

namespace
{

OSStatus Open(AudioComponent component, AudioComponentInstance& instance)
{
    AudioComponentFactoryFunction const factory = component->GetFactory();
    AudioComponentPlugInInterface* unit = factory ? factory(&component->mListing.description) : nullptr;
    if (!unit)
        return kAudioComponentErr_InstanceInvalidated;

    auto record = std::make_unique<ComponentInstanceRecord>(component, unit);
    for (std::size_t selector = 0; unit->Lookup && selector < record->mMethods.size(); ++selector)
        record->mMethods[selector] = unit->Lookup(static_cast<SInt16>(selector));
    const OSStatus result = unit->Open ? unit->Open(unit, record.get()) : noErr;
    if (result != noErr)
        return result; // without Close: an instance whose Open fails has deleted itself
    instance = record.release();
    return noErr;
}

} // namespace

AudioComponent AudioComponentFindNext(AudioComponent after, const AudioComponentDescription* description)
{
    ComponentRegistry& registry = ComponentRegistry::GetInstance();
    if (!after)
        registry.Update();
    return description ? registry.FindNext(after, *description) : nullptr;
}

UInt32 AudioComponentCount(const AudioComponentDescription* description)
{
    UInt32 count = 0;
    for (AudioComponent found = AudioComponentFindNext(nullptr, description); found;
         found = AudioComponentFindNext(found, description))
        ++count;
    return count;
}

OSStatus AudioComponentCopyName(AudioComponent component, CFStringRef* name)
{
    if (!component || !name)
        return kAudio_ParamError;
    const UTF16String& text = component->mListing.name;
    *name = CFStringCreateWithCharacters(nullptr, text.data(), static_cast<CFIndex>(text.size()));
    return noErr;
}

OSStatus AudioComponentGetDescription(AudioComponent component, AudioComponentDescription* description)
{
    if (!component || !description)
        return kAudio_ParamError;
    *description = component->mListing.description;
    return noErr;
}

OSStatus AudioComponentGetVersion(AudioComponent component, UInt32* version)
{
    if (!component || !version)
        return kAudio_ParamError;
    *version = component->mListing.version;
    return noErr;
}

AudioComponent AudioComponentRegister(const AudioComponentDescription* description, CFStringRef name, UInt32 version,
                                      AudioComponentFactoryFunction factory)
{
    if (!description || !factory)
        return nullptr;
    ComponentRegistry& registry = ComponentRegistry::GetInstance();
    if (AudioComponent known = registry.Find(*description))
        return known;
    UTF16String text(name ? static_cast<std::size_t>(CFStringGetLength(name)) : 0, u'\0');
    if (name)
        CFStringGetCharacters(name, CFRangeMake(0, CFStringGetLength(name)), text.data());
    return registry.Add({*description, text, version, {}, {}}, factory);
}

OSStatus AudioComponentInstanceNew(AudioComponent component, AudioComponentInstance* instance)
{
    if (!component || !instance)
        return kAudio_ParamError;
    *instance = nullptr;
    try
    {
        return Open(component, *instance);
    }
    catch (...) // of the unit's
    {
        return kAudioComponentErr_InstanceInvalidated;
    }
}

OSStatus AudioComponentInstanceDispose(AudioComponentInstance instance)
{
    if (!instance)
        return kAudio_ParamError;
    const std::unique_ptr<ComponentInstanceRecord> owner(instance);
    instance->mListeners->Close(); // first: listeners of other threads ask the unit for values
    return instance->mUnit->Close ? instance->mUnit->Close(instance->mUnit) : noErr;
}

AudioComponent AudioComponentInstanceGetComponent(AudioComponentInstance instance)
{
    return instance ? instance->mComponent : nullptr;
}
