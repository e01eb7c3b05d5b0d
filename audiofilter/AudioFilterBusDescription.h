// A named group of channels of a plug-in or of the application.
#pragma once

#include "foundation/zebcore/Export.h"
#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost
{

/// Name, channel layout and role of a bus: a plain value. [any]
class ZEB_EXPORT AudioFilterBusDescription
{
public:
    enum Type
    {
        kBusType_Main = 0,
        kBusType_SideChain = 1
    };

    /// No name, no channels, kBusType_Main.
    AudioFilterBusDescription();
    AudioFilterBusDescription(UTF16String name, ChannelLayout layout, Type type);
    AudioFilterBusDescription(const AudioFilterBusDescription& other);
    AudioFilterBusDescription& operator=(const AudioFilterBusDescription& other);
    ~AudioFilterBusDescription();

    void swap(AudioFilterBusDescription& other) noexcept;

    void SetName(const UTF16String& name);
    UTF16String GetName() const;

    void SetLayout(const ChannelLayout& layout);
    ChannelLayout GetLayout() const;

    void SetType(Type type);
    Type GetType() const;

    /// Number of channels of the layout.
    int GetChannelCount() const;

    /// Name, layout and type.
    bool operator==(const AudioFilterBusDescription& other) const;
    bool operator!=(const AudioFilterBusDescription& other) const;

    /// Whether the layouts are equal, or with `compareLayouts` false only their channel counts. Name and type play no
    /// part.
    bool IsEquivalent(const AudioFilterBusDescription& other, bool compareLayouts) const;

    static AudioFilterBusDescription CreateMono(const UTF16String& name, Type type);
    static AudioFilterBusDescription CreateStereo(const UTF16String& name, Type type);
    static AudioFilterBusDescription CreateSurround51(const UTF16String& name, Type type);
    static AudioFilterBusDescription CreateSurround71(const UTF16String& name, Type type);

private:
    UTF16String mName;
    ChannelLayout mLayout;
    Type mType = kBusType_Main;
};

/// Whether both lists have the same length and the same layout at each place. The layouts are compared whatever the
/// flag says. [any]
ZEB_EXPORT bool AreAudioFilterBusDescriptionsEquivalent(const std::vector<AudioFilterBusDescription>& a,
                                                        const std::vector<AudioFilterBusDescription>& b,
                                                        bool compareLayouts);

} // namespace zebaudiofilterhost
