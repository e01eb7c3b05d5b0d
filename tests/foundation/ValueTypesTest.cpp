#include "foundation/zebcore/CaseInsensitive.h"
#include "foundation/zebcore/Flags.h"
#include "foundation/zebcore/HighPrecisionTime.h"
#include "foundation/zebcore/Rect.h"
#include "foundation/zebcore/SmallBlockAllocator.h"

#include <gtest/gtest.h>

#include <new>
#include <numeric>
#include <vector>

using namespace zebcore::utility;

namespace
{

TEST(Flags, SetAndClearOnlyWhatTheMaskSays)
{
    Flags<unsigned long long> flags;
    EXPECT_EQ(0U, flags.Value());
    flags.Set((1ULL << 63) | 1);
    flags.Clear(1);
    EXPECT_EQ(1ULL << 63, flags.Value());
    EXPECT_TRUE(flags.IsSet((1ULL << 63) | 2)) << "any flag of the mask will do";
    EXPECT_FALSE(flags.IsSet(0));

    Flags<unsigned short> narrow(0xFFFF);
    narrow.Clear(0x8000);
    narrow |= Flags<unsigned short>(0x8001);
    EXPECT_TRUE(narrow == Flags<unsigned short>(0xFFFF));
}

TEST(Rect, DefaultIsAllZero)
{
    constexpr zebcore::geom::RectT<int> rect;
    EXPECT_TRUE((rect == zebcore::geom::RectT<int>{0, 0, 0, 0}));
    EXPECT_FALSE((rect == zebcore::geom::RectT<int>{0, 0, 0, 1}));
}

TEST(CaseInsensitive, FoldsAsciiLettersOnly)
{
    using CaseInsensitive::Equal;
    EXPECT_TRUE(Equal(u"AZaz09.vst", u"azAZ09.VST"));
    EXPECT_FALSE(Equal(u"@", u"`")) << "just below the letters";
    EXPECT_FALSE(Equal(u"[", u"{")) << "just above the letters";
    EXPECT_FALSE(Equal(u"\u00c9", u"\u00e9"));
    EXPECT_FALSE(Equal(u"\u0141", u"\u0161")) << "letters whose low byte is that of an ASCII letter";
    EXPECT_FALSE(Equal(u"abc", u"ab"));

    EXPECT_TRUE(CaseInsensitive::EndsWith(u"/a/Delay.VST3", u".vst3"));
    EXPECT_FALSE(CaseInsensitive::EndsWith(u"st3", u".vst3"));
}

TEST(SmallBlockAllocator, ServesContainers)
{
    std::vector<int, SmallBlockAllocator::STLAllocator<int>> values(1000);
    std::iota(values.begin(), values.end(), 0);
    const auto copy = values;
    EXPECT_EQ(499500, std::accumulate(copy.begin(), copy.end(), 0));

    SmallBlockAllocator::STLAllocator<int> allocator;
    EXPECT_THROW(allocator.allocate(~std::size_t{0} / 2), std::bad_array_new_length);
}

TEST(HighPrecisionTime, GoesForwardInNanoseconds)
{
    const unsigned long long before = HighPrecisionTime::GetCurrentTime();
    const unsigned long long after = HighPrecisionTime::GetCurrentTime();
    EXPECT_LE(before, after);
    EXPECT_GT(before, 0U);
    EXPECT_LE(HighPrecisionTime::ConvertToNanos(before), HighPrecisionTime::ConvertToNanos(after));
    EXPECT_EQ(0U, HighPrecisionTime::ConvertToNanos(0));
}

} // namespace
