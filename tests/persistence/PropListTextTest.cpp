#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/XmlUtils.h"

#include <gtest/gtest.h>

#include <bit>
#include <clocale>
#include <cmath>
#include <cstdint>
#include <limits>
#include <locale>

using namespace zebcore;
using proplist::PropList;
using namespace proplist::utils;

namespace
{

PropList ThereAndBack(const PropList& list)
{
    UTF8String text = u8"stale";
    WritePropList(text, list);
    PropList read;
    EXPECT_TRUE(ReadPropList(text, read)) << utility::NarrowFromUTF8(text);
    return read;
}

template <typename T>
T ThereAndBack(const T& value)
{
    PropList list;
    list.SetValue(u8"key", value);
    T read{};
    EXPECT_TRUE(ThereAndBack(list).GetValue(u8"key", read));
    return read;
}

std::uint32_t Bits(float value)
{
    return std::bit_cast<std::uint32_t>(value);
}

template <typename Unit>
std::vector<std::basic_string<Unit>> HardTexts()
{
    std::vector<std::basic_string<Unit>> texts = {{}};
    for (const char* const text : {"\r",   "\n",        "\r\n",         "\n\r\n\r",      "\t",
                                   " ",    "  leading", "trailing  ",   "\t\n mixed \r", "a  b",
                                   "<",    "&",         "]]>",          "<![CDATA[x]]>", "&amp;",
                                   "&#0;", "\"'",       "<!-- -->",     "\\u0000",       "\\",
                                   "\\\\", "\x7f",      "nan:7fc00000", "true"})
    {
        const std::string_view view = text;
        texts.emplace_back(view.begin(), view.end());
    }
    for (int control = 0; control < 32; ++control)
    {
        texts.emplace_back(1, static_cast<Unit>(control));
        texts.emplace_back(64, static_cast<Unit>(control));
    }
    return texts;
}

constexpr float kInfinity = std::numeric_limits<float>::infinity();

const float kHardFloats[] = {
    0.0F,
    -0.0F,
    0.1F,
    1.0F / 3.0F,
    16777217.0F,
    std::numeric_limits<float>::min(),
    std::numeric_limits<float>::denorm_min(),
    -std::numeric_limits<float>::denorm_min(),
    std::numeric_limits<float>::max(),
    std::numeric_limits<float>::lowest(),
    kInfinity,
    -kInfinity,
    std::nextafter(1.0F, 2.0F),
    std::numeric_limits<float>::quiet_NaN(),
    -std::numeric_limits<float>::quiet_NaN(),
    std::numeric_limits<float>::signaling_NaN(),
    std::bit_cast<float>(0x7FC12345U),
    std::bit_cast<float>(0xFFFFFFFFU),
};

} // namespace

TEST(PropListText, LooksAsDocumented)
{
    PropList list;
    list.SetValue(u8"version", 2U);
    PropList& subList = list.GetOrCreateSubList(u8"plugin_info0");
    subList.SetValue(u8"name", u"Hall & Room");
    subList.SetValue(u8"enabled", true);
    list.SetValue(u8"a\n\"b\"", u8"eight");
    list.SetValue(u8"number", -7);
    list.SetValue(u8"float", 0.1F);
    list.SetValue(u8"ParamList", std::list<float>{0.5F, -kInfinity, std::bit_cast<float>(0x7FC00001U)});
    list.GetOrCreateSubList(u8"empty");
    UTF8String text;
    WritePropList(text, list);
    EXPECT_TRUE(text == u8R"(<?xml version="1.0" encoding="UTF-8"?>
<proplist format="1">
  <uint key="version">2</uint>
  <list key="plugin_info0">
    <text key="name">Hall &amp; Room</text>
    <bool key="enabled">true</bool>
  </list>
  <utf8 key="a&#10;&quot;b&quot;">eight</utf8>
  <int key="number">-7</int>
  <float key="float">0.1</float>
  <floats key="ParamList">0.5 -inf nan:7fc00001</floats>
  <list key="empty">
  </list>
</proplist>
)") << utility::NarrowFromUTF8(text);
}

TEST(PropListText, StringsComeBackUnitForUnit)
{
    for (const UTF16String& text : HardTexts<char16_t>())
        EXPECT_TRUE(ThereAndBack(text) == text) << utility::NarrowFromUTF16(text);
    for (const UTF8String& text : HardTexts<char8_t>())
        EXPECT_TRUE(ThereAndBack(text) == text) << utility::NarrowFromUTF8(text);
}

TEST(PropListText, EveryCodeUnitComesBack)
{
    UTF16String units;
    for (unsigned int unit = 0; unit <= 0xFFFF; ++unit)
        units += static_cast<char16_t>(unit);
    EXPECT_TRUE(ThereAndBack(units) == units);
    EXPECT_TRUE(ThereAndBack(UTF16String(units.rbegin(), units.rend())) == UTF16String(units.rbegin(), units.rend()));
    UTF8String bytes;
    for (int first = 0; first < 256; ++first)
        for (int second = 0; second < 256; ++second)
            (bytes += static_cast<char8_t>(first)) += static_cast<char8_t>(second);
    EXPECT_TRUE(ThereAndBack(bytes) == bytes);
}

// Names that travel in fields of 64 units come padded with zeros.
TEST(PropListText, PaddedNamesComeBack)
{
    UTF16String name = u"Plug-in";
    name.resize(64);
    EXPECT_TRUE(ThereAndBack(name) == name);
}

TEST(PropListText, NumbersComeBackBitForBit)
{
    for (const float value : kHardFloats)
        EXPECT_EQ(Bits(ThereAndBack(value)), Bits(value));
    for (std::uint32_t bits = 0; bits < 0xFFFF0000U; bits += 0x40321U)
        ASSERT_EQ(Bits(ThereAndBack(std::bit_cast<float>(bits))), bits);
    for (const int value : {0, -1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
        EXPECT_EQ(ThereAndBack(value), value);
    for (const unsigned int value : {0U, 1U, std::numeric_limits<unsigned int>::max()})
        EXPECT_EQ(ThereAndBack(value), value);
    EXPECT_TRUE(ThereAndBack(true));
    EXPECT_FALSE(ThereAndBack(false));
}

TEST(PropListText, FloatListsComeBack)
{
    EXPECT_TRUE(ThereAndBack(std::list<float>()).empty());
    std::list<float> values(std::begin(kHardFloats), std::end(kHardFloats));
    const std::list<float> read = ThereAndBack(values);
    ASSERT_EQ(read.size(), values.size());
    EXPECT_TRUE(
        std::equal(values.begin(), values.end(), read.begin(), [](float a, float b) { return Bits(a) == Bits(b); }));
}

TEST(PropListText, KeysOfAnyBytesComeBack)
{
    PropList list;
    int count = 0;
    for (const UTF8String& key : HardTexts<char8_t>())
        list.SetValue(key, ++count);
    list.SetValue(u8"\xFF\xC3", ++count);
    list.GetOrCreateSubList(u8"\u00e9 <x>\n").SetValue(u8"y", 1);
    UTF8String before;
    UTF8String after;
    WritePropList(before, list);
    const PropList read = ThereAndBack(list);
    WritePropList(after, read);
    EXPECT_TRUE(before == after);
    EXPECT_NE(read.GetSubList(u8"\u00e9 <x>\n"), nullptr);
    int value = 0;
    EXPECT_TRUE(read.GetValue(u8"\r\n", value));
    EXPECT_TRUE(read.GetValue(u8"\xFF\xC3", value));
    EXPECT_EQ(value, count);
}

TEST(PropListText, TypesAndOrderComeBack)
{
    PropList list;
    list.SetValue(u8"z", 1U);
    list.SetValue(u8"a", 1);
    list.GetOrCreateSubList(u8"m").GetOrCreateSubList(u8"n");
    list.SetValue(u8"b", u8"");
    UTF8String before;
    UTF8String after;
    WritePropList(before, list);
    WritePropList(after, ThereAndBack(list));
    EXPECT_TRUE(before == after);
    int number = 7;
    EXPECT_FALSE(ThereAndBack(list).GetValue(u8"z", number));
    EXPECT_EQ(number, 7);
}

TEST(PropListText, DoesNotDependOnTheLocale)
{
    struct Comma : std::numpunct<char>
    {
        char do_decimal_point() const override { return ','; }
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };
    const std::locale before = std::locale::global(std::locale(std::locale::classic(), new Comma));
    PropList list;
    list.SetValue(u8"f", 1234.5F);
    list.SetValue(u8"i", 1234567);
    UTF8String text;
    WritePropList(text, list);
    float value = 0;
    EXPECT_TRUE(ThereAndBack(list).GetValue(u8"f", value));
    std::locale::global(before);
    EXPECT_EQ(value, 1234.5F);
    EXPECT_NE(text.find(u8">1234.5<"), text.npos);
    EXPECT_NE(text.find(u8">1234567<"), text.npos);
}

TEST(PropListText, ReadReplacesWhatIsThere)
{
    PropList list;
    list.SetValue(u8"stale", 1);
    EXPECT_TRUE(ReadPropList(u8"<proplist format='1'><int key='fresh'>2</int></proplist>", list));
    int value = 0;
    EXPECT_FALSE(list.GetValue(u8"stale", value));
    EXPECT_TRUE(list.GetValue(u8"fresh", value));
}

TEST(PropListText, HandWrittenTextIsTaken)
{
    PropList list;
    ASSERT_TRUE(ReadPropList(u8"<!-- mine --><proplist format=\"1\" more=\"x\">\n"
                             u8"<text key='a'>one<!-- note --> <![CDATA[<two>]]> &#x33;</text>\r\n"
                             u8"<floats key='f'>\n  1\t2e1 \n</floats> <list key='l'><int key='x'>1</int></list>\n"
                             u8"<list key='l'><int key='y'>1</int></list>\n"
                             u8"<?pi x?></proplist>\n",
                             list));
    UTF16String text;
    EXPECT_TRUE(list.GetValue(u8"a", text) && text == u"one <two> 3");
    std::list<float> floats;
    EXPECT_TRUE(list.GetValue(u8"f", floats) && floats == (std::list<float>{1.0F, 20.0F}));
    int value = 0;
    EXPECT_FALSE(list.GetSubList(u8"l")->GetValue(u8"x", value)) << "of two equal keys the later counts";
    EXPECT_TRUE(list.GetSubList(u8"l")->GetValue(u8"y", value));
}

TEST(PropListText, EncodedPathStandsInTheText)
{
    const UTF16String path = u"/opt/Hall & Room/\u97f3\u697d 'x'/\\u0041\tz";
    PropList list;
    list.SetValue(u8"locator", u"3:" + path + u"/a.vst3");
    UTF8String text;
    WritePropList(text, list);
    UTF16String encoded;
    xml::utils::EncodeReservedCharacters(path, encoded);
    EXPECT_NE(utility::UTF8to16(text).find(encoded), UTF16String::npos);
}

TEST(PropListText, ListsNestToTheLimit)
{
    const auto nested = [](unsigned int depth)
    {
        PropList list;
        PropList* inner = &list;
        for (unsigned int i = 0; i < depth; ++i)
            inner = &inner->GetOrCreateSubList(u8"l");
        inner->SetValue(u8"x", 1);
        UTF8String text;
        WritePropList(text, list);
        return text;
    };
    PropList read;
    EXPECT_TRUE(ReadPropList(nested(kMaxListDepth), read));
    EXPECT_FALSE(read.IsEmpty());
    EXPECT_FALSE(ReadPropList(nested(kMaxListDepth + 1), read));
    EXPECT_TRUE(read.IsEmpty());
}
