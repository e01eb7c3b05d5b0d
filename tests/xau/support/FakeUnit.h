#pragma once

#include "host/src/XAU/src/XAUAudioFilter.h"

#include <AudioToolbox/AudioToolbox.h>

#include <cstddef>
#include <functional>
#include <map>
#include <set>
#include <span>
#include <string>
#include <tuple>
#include <vector>

namespace zebaudiofilterhost::xau
{

// A unit written on the published headers, whose every answer a test sets, and which keeps a list of what it is asked
// to do. It registers itself as a component of its own; it outlives the filters made of it.
class FakeUnit
{
public:
    // Property, scope and element.
    using Key = std::tuple<AudioUnitPropertyID, AudioUnitScope, AudioUnitElement>;
    using RenderFunction = std::function<OSStatus(UInt32 frames, AudioBufferList& data)>;

    explicit FakeUnit(OSType type = kAudioUnitType_Effect, const char* name = "Maker: Fake",
                      OSType manufacturer = 0x66616B65);
    ~FakeUnit();
    FakeUnit(const FakeUnit&) = delete;
    FakeUnit& operator=(const FakeUnit&) = delete;

    const AudioComponentDescription& GetDescription() const { return mDescription; }
    AudioComponent GetComponent() const { return mComponent; }
    UTF16String GetID() const; // without a prefix
    boost::intrusive_ptr<XAUAudioFilter> MakeFilter() const;
    /// Of the last instance.
    AudioUnit GetInstance() const { return mInstance; }

    template <typename T>
    void Answer(const Key& key, const T& value)
    {
        AnswerBytes(key, std::as_bytes(std::span(&value, 1)));
    }
    template <typename T>
    void AnswerList(const Key& key, const std::vector<T>& values)
    {
        AnswerBytes(key, std::as_bytes(std::span(values)));
    }
    void AnswerBytes(const Key& key, std::span<const std::byte> bytes);

    /// What a property was set to last.
    template <typename T>
    T Read(const Key& key) const
    {
        T value = {};
        const auto found = mProperties.find(key);
        if (found != mProperties.end() && found->second.size() == sizeof(value))
            std::copy(found->second.begin(), found->second.end(), reinterpret_cast<std::byte*>(&value));
        return value;
    }
    bool Has(const Key& key) const { return mProperties.count(key) != 0; }
    void Forget(const Key& key) { mProperties.erase(key); }

    /// So many elements with a format of so many channels.
    void SetElements(AudioUnitScope scope, const std::vector<UInt32>& channels);
    UInt32 GetChannels(AudioUnitScope scope, AudioUnitElement element) const;
    void SetParameters(const std::vector<AudioUnitParameterID>& ids, Float32 minimum, Float32 maximum);

    /// Calls the callback of an input as the unit does while it renders.
    OSStatus Pull(UInt32 bus, UInt32 frames, AudioBufferList& data) const;
    std::size_t CountCalls(const std::string& call) const;

    RenderFunction mRender = [](UInt32, AudioBufferList&)
    {
        return noErr;
    };
    std::set<Key> mRefused;           // not to be set
    std::map<Key, UInt32> mAnnounced; // sizes that differ from the truth
    std::map<std::pair<AudioUnitScope, AudioUnitParameterID>, Float32> mValues;
    std::vector<std::string> mCalls;
    std::vector<AudioTimeStamp> mTimes; // of the renders
    OSStatus mOpenResult = noErr;
    OSStatus mInitializeResult = noErr;
    std::set<std::string> mThrowsIn; // calls: "create", "open", "close", "initialize", "get property" and so on
    std::set<AudioUnitPropertyID> mThrowsOf; // where it is asked for one of these
    bool mIgnoresAnnouncedSize = false;      // writes all that it has, whatever room it was given
    bool mGivesInstance = true;

private:
    struct Calls;

    void ThrowIfWanted(const char* call) const;

    static AudioComponentPlugInInterface* Create(const AudioComponentDescription* description);

    AudioComponentDescription mDescription;
    AudioComponent mComponent;
    AudioUnit mInstance = nullptr;
    std::map<Key, std::vector<std::byte>> mProperties;
};

// Keys that are used often.
inline FakeUnit::Key Global(AudioUnitPropertyID property)
{
    return {property, kAudioUnitScope_Global, 0};
}
inline FakeUnit::Key FormatOf(AudioUnitScope scope, AudioUnitElement element = 0)
{
    return {kAudioUnitProperty_StreamFormat, scope, element};
}

} // namespace zebaudiofilterhost::xau
