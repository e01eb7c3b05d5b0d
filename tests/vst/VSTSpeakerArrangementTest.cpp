#include "host/src/VST/src/VSTSpeakerArrangement.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cstring>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst
{

namespace
{

const VstSpeakerProperties* Records(const VstSpeakerArrangement& arrangement)
{
    return std::bit_cast<const VstSpeakerProperties*>(std::bit_cast<const char*>(&arrangement) + 8);
}

bool IsZero(const void* memory, std::size_t size)
{
    const auto* bytes = static_cast<const char*>(memory);
    return std::all_of(bytes, bytes + size, [](char byte) { return byte == 0; });
}

struct Expected
{
    unsigned int azimuth; // bits
    float elevation;
    float radius;
    int type;
    const char* name;
};

void ExpectRecord(const VstSpeakerProperties& record, const Expected& expected)
{
    EXPECT_EQ(std::bit_cast<unsigned int>(record.azimuth), expected.azimuth) << expected.name;
    EXPECT_EQ(record.elevation, expected.elevation) << expected.name;
    EXPECT_EQ(record.radius, expected.radius) << expected.name;
    EXPECT_EQ(record.type, expected.type) << expected.name;
    EXPECT_STREQ(record.name, expected.name);
    EXPECT_EQ(record.reserved, 0.0F);
    EXPECT_TRUE(IsZero(record.future, sizeof(record.future)));
}

TEST(VSTSpeakerArrangement, SizeHoldsTheRecordsOfAnyCount)
{
    for (std::size_t count = 0; count <= 8; ++count)
        EXPECT_EQ(SpeakerArrangementSize(count), 904U) << count;
    EXPECT_EQ(SpeakerArrangementSize(9), 1016U);
    EXPECT_EQ(SpeakerArrangementSize(64), 7176U);
    for (std::size_t count = 9; count <= 1024; ++count)
        EXPECT_EQ(SpeakerArrangementSize(count), 8 + count * sizeof(VstSpeakerProperties)) << count;
}

TEST(VSTSpeakerArrangement, UsualCountsHaveTheirSpeakers)
{
    const std::vector<Expected> surround = {
        {0x40060a92, 0, 1, 1, "L"},    {0x3f860a92, 0, 1, 2, "R"},  {0x3fc90fdb, 0, 1, 3, "C"},
        {0x41200000, 10, 0, 4, "Lfe"}, {0xc032b8c3, 0, 1, 5, "Ls"}, {0xbeb2b8c3, 0, 1, 6, "Rs"},
        {0xc0060a92, 0, 1, 7, "Lc"},   {0x3eb2b8c3, 0, 1, 8, "Rc"},
    };
    struct Case
    {
        int type;
        std::vector<Expected> speakers;
    };
    for (const Case& expected :
         {Case{0, {{0x3fc90fdb, 0, 1, 0, "M"}}}, Case{1, {surround.begin(), surround.begin() + 2}},
          Case{15, {surround.begin(), surround.begin() + 6}}, Case{23, surround}})
    {
        const ChannelLayout layout(expected.speakers.size(), zebmediatypes::kAudioChannelLabel_LFE2);
        const SpeakerArrangementPtr arrangement = BuildSpeakerArrangement(layout);
        EXPECT_EQ(arrangement->type, expected.type);
        EXPECT_EQ(arrangement->numChannels, static_cast<int>(layout.size()));
        for (std::size_t index = 0; index < layout.size(); ++index)
            ExpectRecord(arrangement->speakers[index], expected.speakers[index]);
        EXPECT_TRUE(
            IsZero(arrangement->speakers + layout.size(), (8 - layout.size()) * sizeof(VstSpeakerProperties)));
    }
}

TEST(VSTSpeakerArrangement, OtherCountsHaveOneRecordNamedAfterTheLast)
{
    for (const std::size_t count : {3U, 4U, 5U, 7U, 9U, 10U, 16U, 64U, 100U})
    {
        const SpeakerArrangementPtr arrangement = BuildSpeakerArrangement(ChannelLayout(count));
        EXPECT_EQ(arrangement->type, -2);
        EXPECT_EQ(arrangement->numChannels, static_cast<int>(count));
        ExpectRecord(*Records(*arrangement), {0x3fc90fdb, 0, 1, 0, std::to_string(count).c_str()});
        EXPECT_TRUE(
            IsZero(Records(*arrangement) + 1, SpeakerArrangementSize(count) - 8 - sizeof(VstSpeakerProperties)))
            << count;
    }
    const SpeakerArrangementPtr empty = BuildSpeakerArrangement({});
    EXPECT_EQ(empty->numChannels, 0);
    EXPECT_TRUE(IsZero(Records(*empty), 896));
}

TEST(VSTSpeakerArrangement, CopyReadsNoMoreThanItMay)
{
    struct Case
    {
        int channels;
        int readable;
        std::size_t copied;
    };
    for (const Case& expected :
         {Case{2, 8, 2}, Case{8, 8, 8}, Case{12, 16, 12}, Case{12, 12, 12}, Case{64, 8, 8}, Case{64, 64, 64}})
    {
        // No byte more than the copy may look at, so that a sanitizer sees one that looks further.
        std::vector<char> memory(8 + expected.copied * sizeof(VstSpeakerProperties), 'x');
        auto* source = std::bit_cast<VstSpeakerArrangement*>(memory.data());
        source->type = 22;
        source->numChannels = expected.channels;
        const SpeakerArrangementPtr copy = CopySpeakerArrangement(*source, expected.readable);
        EXPECT_EQ(std::memcmp(copy.get(), source, memory.size()), 0) << expected.channels;
        EXPECT_TRUE(IsZero(Records(*copy) + expected.copied,
                           SpeakerArrangementSize(static_cast<std::size_t>(expected.channels)) - memory.size()))
            << expected.channels;
    }
}

} // namespace

} // namespace zebaudiofilterhost::vst
