#include "host/src/VST/src/VSTSpeakerArrangement.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstdint>
#include <cstring>
#include <new>
#include <span>
#include <string>
#include <string_view>

namespace zebaudiofilterhost::vst
{

namespace
{

// In radians. The bits are what plug-ins get; the decimal forms beside them are rounded.
constexpr float kPI = std::bit_cast<float>(0x40490fdbU);                 // 3.1415927
constexpr float kCenterPosition = std::bit_cast<float>(0x3fc90fdbU);     // 1.5707964
constexpr float kFrontLeftPosition = std::bit_cast<float>(0x40060a92U);  // 2.0943952
constexpr float kFrontRightPosition = std::bit_cast<float>(0x3f860a92U); // 1.0471976
constexpr float kRearLeftPosition = std::bit_cast<float>(0xc032b8c3U);   // -2.7925270
constexpr float kRearRightPosition = std::bit_cast<float>(0xbeb2b8c3U);  // -0.3490659

struct Speaker
{
    float mAzimuth;
    float mElevation;
    float mRadius;
    VstSpeakerType mType;
    std::string_view mName;
};

constexpr Speaker kMonoSpeaker = {kCenterPosition, 0.0F, 1.0F, kSpeakerM, "M"};

// Stereo has the first two of these, 5.1 the first six.
constexpr std::array<Speaker, 8> kSurroundSpeakers = {{
    {kFrontLeftPosition, 0.0F, 1.0F, kSpeakerL, "L"},
    {kFrontRightPosition, 0.0F, 1.0F, kSpeakerR, "R"},
    {kCenterPosition, 0.0F, 1.0F, kSpeakerC, "C"},
    {10.0F, 10.0F, 0.0F, kSpeakerLfe, "Lfe"},
    {kRearLeftPosition, 0.0F, 1.0F, kSpeakerLs, "Ls"},
    {kRearRightPosition, 0.0F, 1.0F, kSpeakerRs, "Rs"},
    {-120.0F * kPI / 180.0F, 0.0F, 1.0F, kSpeakerLc, "Lc"},
    {20.0F * kPI / 180.0F, 0.0F, 1.0F, kSpeakerRc, "Rc"},
}};

SpeakerArrangementPtr Allocate(std::size_t channelCount)
{
    const std::size_t size = SpeakerArrangementSize(channelCount);
    void* const memory = ::operator new(size);
    return SpeakerArrangementPtr(static_cast<VstSpeakerArrangement*>(std::memset(memory, 0, size)));
}

void Fill(VstSpeakerProperties& record, const Speaker& speaker)
{
    record.azimuth = speaker.mAzimuth;
    record.elevation = speaker.mElevation;
    record.radius = speaker.mRadius;
    record.type = speaker.mType;
    const std::size_t length = std::min(speaker.mName.size(), sizeof(record.name) - 1);
    speaker.mName.copy(record.name, length);
    record.name[length] = '\0';
}

// The speakers of a layout that has a name of its own, with that name; none and "user defined" for all others.
struct NamedArrangement
{
    VstSpeakerArrangementType mType = kSpeakerArrUserDefined;
    std::span<const Speaker> mSpeakers;
};

NamedArrangement FindNamedArrangement(std::size_t channelCount)
{
    switch (channelCount)
    {
    case 1:
        return {kSpeakerArrMono, {&kMonoSpeaker, 1}};
    case 2:
        return {kSpeakerArrStereo, std::span(kSurroundSpeakers).first(2)};
    case 6:
        return {kSpeakerArr51, std::span(kSurroundSpeakers).first(6)};
    case 8:
        return {kSpeakerArr71Music, kSurroundSpeakers};
    default:
        return {};
    }
}

} // namespace

void FreeSpeakerArrangement::operator()(VstSpeakerArrangement* arrangement) const noexcept
{
    ::operator delete(arrangement);
}

SpeakerArrangementPtr BuildSpeakerArrangement(const ChannelLayout& layout)
{
    const std::size_t count = layout.size();
    SpeakerArrangementPtr arrangement = Allocate(count);
    const NamedArrangement named = FindNamedArrangement(count);
    arrangement->type = named.mType;
    arrangement->numChannels = static_cast<std::int32_t>(count);
    std::size_t index = 0;
    for (const Speaker& speaker : named.mSpeakers)
        Fill(arrangement->speakers[index++], speaker);
    // Deliberate: plug-ins expect one record, with the number of the last channel for a name, and empty ones behind
    // it.
    if (named.mSpeakers.empty() && count > 0)
    {
        Speaker last = kMonoSpeaker;
        const std::string name = std::to_string(count);
        last.mName = name;
        Fill(arrangement->speakers[0], last);
    }
    return arrangement;
}

SpeakerArrangementPtr CopySpeakerArrangement(const VstSpeakerArrangement& source, int readable)
{
    SpeakerArrangementPtr copy = Allocate(static_cast<std::size_t>(source.numChannels));
    const auto records = static_cast<std::size_t>(std::clamp(source.numChannels, 0, std::max(readable, 0)));
    // As bytes: the records go on behind the declared eight.
    std::memcpy(copy.get(), &source,
                offsetof(VstSpeakerArrangement, speakers) + records * sizeof(VstSpeakerProperties));
    return copy;
}

} // namespace zebaudiofilterhost::vst
