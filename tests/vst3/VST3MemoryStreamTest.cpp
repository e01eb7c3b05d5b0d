#include "host/src/VST3/src/VST3MemoryStream.h"

#include <gtest/gtest.h>

#include <array>
#include <limits>
#include <string>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::int32;
using Steinberg::int64;

constexpr int64 kFarLeft = std::numeric_limits<int64>::min();
constexpr int64 kFarRight = std::numeric_limits<int64>::max();
constexpr int32 kHuge = std::numeric_limits<int32>::max();

int64 PositionOf(VST3MemoryStream& stream)
{
    int64 position = 0;
    EXPECT_EQ(stream.tell(&position), Steinberg::kResultOk);
    return position;
}

std::string ContentOf(const VST3MemoryStream& stream)
{
    return stream.GetSize() == 0 ? std::string() : std::string(stream.GetData(), stream.GetData() + stream.GetSize());
}

int32 Write(VST3MemoryStream& stream, std::string text)
{
    int32 written = -1;
    EXPECT_EQ(stream.write(text.data(), static_cast<int32>(text.size()), &written), Steinberg::kResultOk);
    return written;
}

std::string Read(VST3MemoryStream& stream, int32 count)
{
    std::array<char, 64> buffer{};
    int32 read = -1;
    EXPECT_EQ(stream.read(buffer.data(), count, &read), Steinberg::kResultOk);
    return {buffer.data(), static_cast<std::size_t>(read)};
}

void SeekTo(VST3MemoryStream& stream, int64 position)
{
    int64 result = ~position;
    EXPECT_EQ(stream.seek(position, Steinberg::IBStream::kIBSeekSet, &result), Steinberg::kResultOk);
    EXPECT_EQ(result, position);
}

TEST(VST3MemoryStream, AWriteCutsOffWhatLiesBehindIt)
{
    VST3MemoryStream stream;
    EXPECT_EQ(Write(stream, "0123456789"), 10);
    SeekTo(stream, 2);
    EXPECT_EQ(Write(stream, "abc"), 3);
    EXPECT_EQ(ContentOf(stream), "01abc");
    EXPECT_EQ(PositionOf(stream), 5);
    SeekTo(stream, 1);
    EXPECT_EQ(Write(stream, ""), 0) << "also a write of nothing cuts";
    EXPECT_EQ(ContentOf(stream), "0");
}

TEST(VST3MemoryStream, GapsAreFilledWithZeros)
{
    VST3MemoryStream stream;
    SeekTo(stream, 4);
    EXPECT_EQ(Write(stream, "x"), 1);
    EXPECT_EQ(ContentOf(stream), std::string("\0\0\0\0x", 5));
}

TEST(VST3MemoryStream, ReadsGiveWhatIsThere)
{
    VST3MemoryStream stream;
    Write(stream, "hello");
    EXPECT_EQ(Read(stream, 3), "") << "at the end";
    SeekTo(stream, 1);
    EXPECT_EQ(Read(stream, 3), "ell");
    EXPECT_EQ(Read(stream, 10), "o");
    EXPECT_EQ(PositionOf(stream), 5);
    SeekTo(stream, 2);
    EXPECT_EQ(Read(stream, 0), "");
    EXPECT_EQ(PositionOf(stream), 2);
    SeekTo(stream, 2);
    std::array<char, 8> buffer{};
    EXPECT_EQ(stream.read(buffer.data(), 2, nullptr), Steinberg::kResultOk);
    EXPECT_EQ(buffer[1], 'l');
}

TEST(VST3MemoryStream, AReadBeyondTheEndComesBackToIt)
{
    VST3MemoryStream stream;
    SeekTo(stream, 100);
    EXPECT_EQ(Read(stream, 1), "");
    EXPECT_EQ(PositionOf(stream), 0);
}

TEST(VST3MemoryStream, SeeksFromEverywhereToEverywhere)
{
    struct Case
    {
        int64 mFrom, mOffset;
        int32 mMode;
        int64 mResult;
    };
    const Case cases[] = {
        {3, 7, 0, 7},
        {3, -7, 0, -7},
        {3, 4, 1, 7},
        {3, -4, 1, -1},
        {3, 0, 2, 5},
        {3, -2, 2, 3},
        {3, 9, 2, 14},
        {3, 9, 3, 3},
        {3, 9, -1, 3},
        {3, kFarRight, 1, kFarRight},
        {-3, kFarLeft, 1, kFarLeft},
        {3, kFarRight, 2, kFarRight},
    };
    for (const Case& test : cases)
    {
        VST3MemoryStream stream;
        Write(stream, "hello");
        SeekTo(stream, test.mFrom);
        int64 result = 0;
        EXPECT_EQ(stream.seek(test.mOffset, test.mMode, &result), Steinberg::kResultOk);
        EXPECT_EQ(result, test.mResult) << test.mFrom << " " << test.mOffset << " " << test.mMode;
        EXPECT_EQ(PositionOf(stream), test.mResult);
        EXPECT_EQ(stream.seek(test.mOffset, test.mMode, nullptr), Steinberg::kResultOk);
    }
}

TEST(VST3MemoryStream, NullPointersAreInvalid)
{
    VST3MemoryStream stream;
    Write(stream, "hello");
    SeekTo(stream, 2);
    int32 count = -1;
    EXPECT_EQ(stream.write(nullptr, 3, &count), Steinberg::kInvalidArgument);
    EXPECT_EQ(stream.tell(nullptr), Steinberg::kInvalidArgument);
    EXPECT_EQ(stream.read(nullptr, 3, &count), Steinberg::kResultOk);
    EXPECT_EQ(count, 0);
    EXPECT_EQ(ContentOf(stream), "hello");
    EXPECT_EQ(PositionOf(stream), 2);
}

TEST(VST3MemoryStream, SurvivesCountsAndPositionsThatLie)
{
    char byte = 'x';
    for (const int64 position : {kFarLeft, int64(-1), int64(0), int64(3), int64(100), kFarRight})
        for (const int32 count : {std::numeric_limits<int32>::min(), -1, kHuge})
        {
            SCOPED_TRACE(testing::Message() << position << " " << count);
            VST3MemoryStream stream;
            Write(stream, "hello");
            SeekTo(stream, position);
            std::array<char, 8> buffer{};
            int32 read = -1;
            EXPECT_EQ(stream.read(buffer.data(), count, &read), Steinberg::kResultOk);
            EXPECT_GE(read, 0);
            EXPECT_LE(read, 5);
            SeekTo(stream, position);
            int32 written = -1;
            stream.write(&byte, count, &written);
            EXPECT_EQ(written, 0);
            EXPECT_LE(stream.GetSize(), 100);
        }
}

TEST(VST3MemoryStream, RefusesWhatNobodyCanStore)
{
    VST3MemoryStream stream;
    Write(stream, "hello");
    SeekTo(stream, VST3MemoryStream::kMaxSize);
    char byte = 'x';
    int32 written = -1;
    EXPECT_EQ(stream.write(&byte, 1, &written), Steinberg::kOutOfMemory);
    EXPECT_EQ(written, 0);
    EXPECT_EQ(ContentOf(stream), "hello");
    EXPECT_FALSE(stream.SetSize(kFarRight));
    SeekTo(stream, -1);
    EXPECT_EQ(stream.write(&byte, 1, &written), Steinberg::kInvalidArgument);
    EXPECT_EQ(ContentOf(stream), "hello");
}

TEST(VST3MemoryStream, WritingLeavesBorrowedBytesAlone)
{
    const std::string lent = "abcdef";
    VST3MemoryStream stream;
    Write(stream, "before");
    stream.Borrow(lent);
    EXPECT_EQ(PositionOf(stream), 0);
    EXPECT_EQ(ContentOf(stream), lent);
    std::array<char, 8> bytes{};
    int32 read = 0;
    stream.read(bytes.data(), 3, &read);
    EXPECT_EQ(std::string(bytes.data(), 3), "abc");
    EXPECT_EQ(Write(stream, "X"), 1);
    EXPECT_EQ(ContentOf(stream), "abcX");
    EXPECT_EQ(lent, "abcdef");

    stream.Borrow(lent);
    EXPECT_TRUE(stream.SetSize(2));
    EXPECT_EQ(ContentOf(stream), "ab");
}

TEST(VST3MemoryStream, SetSizeLeavesThePosition)
{
    VST3MemoryStream stream;
    Write(stream, "hello");
    EXPECT_TRUE(stream.SetSize(2));
    EXPECT_EQ(ContentOf(stream), "he");
    EXPECT_EQ(PositionOf(stream), 5);
    EXPECT_TRUE(stream.SetSize(4));
    EXPECT_EQ(ContentOf(stream), std::string("he\0\0", 4));
    EXPECT_TRUE(stream.SetSize(-1));
    EXPECT_EQ(stream.GetSize(), 0);
}

} // namespace

} // namespace zebaudiofilterhost::vst3
