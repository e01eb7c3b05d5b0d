#include "foundation/zebcore/internal/XmlText.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/XmlUtils.h"

#include <gtest/gtest.h>

using namespace zebcore;

namespace
{

UTF16String Encode(const UTF16String& in)
{
    UTF16String out = u"stale";
    xml::utils::EncodeReservedCharacters(in, out);
    return out;
}

template <typename String>
String ThereAndBack(const String& text)
{
    UTF8String written;
    xml::AppendXmlText(written, text);
    // No entity occurs in the samples that go through here, so the text is what a parser would give.
    String read;
    xml::UnescapeXmlText(written, read);
    return read;
}

// Puts together all texts of up to `length` of the pieces.
template <typename String, typename Check>
void ForAllTexts(const std::vector<String>& pieces, int length, const String& begin, const Check& check)
{
    check(begin);
    if (length > 0)
        for (const String& piece : pieces)
            ForAllTexts(pieces, length - 1, begin + piece, check);
}

} // namespace

TEST(XmlText, EscapesAsDocumented)
{
    const std::pair<UTF16String, UTF16String> samples[] = {
        {u"", u""},
        {u"/Library/Audio/Plug-Ins/VST3", u"/Library/Audio/Plug-Ins/VST3"},
        {u"/home/\u00fcser/M\u00fasica \u97f3\u697d/\U0001F3B5 a.vst3",
         u"/home/\u00fcser/M\u00fasica \u97f3\u697d/\U0001F3B5 a.vst3"},
        {u"/opt/Hall & Room/<x>", u"/opt/Hall &amp; Room/&lt;x&gt;"},
        {u"\"it's\"", u"&quot;it&apos;s&quot;"},
        {u"  a\tb\r\nc ", u"  a&#9;b&#13;&#10;c "},
        {UTF16String(u"a\0\x1f", 3), u"a\\u0000\\u001f"},
        {{0xD800, u'a', 0xDFFF}, u"\\ud800a\\udfff"},
        {{0xFFFE, 0xFFFF, 0xFFFD, 0x7F, 0x85}, u"\\ufffe\\uffff\uFFFD\u007F\u0085"},
        {u"C:\\users\\x", u"C:\\users\\x"},
        {u"\\u0041 \\x41 \\u004 \\U0041", u"\\u005cu0041 \\u005cx41 \\u004 \\U0041"},
    };
    for (const auto& [in, out] : samples)
        EXPECT_TRUE(Encode(in) == out) << utility::NarrowFromUTF16(in) << " -> "
                                       << utility::NarrowFromUTF16(Encode(in));
}

TEST(XmlText, InAndOutMayBeOneString)
{
    UTF16String text = u"a&b";
    xml::utils::EncodeReservedCharacters(text, text);
    EXPECT_TRUE(text == u"a&amp;b");
}

// Whatever its neighbours are, each unit comes back: no escape arises by chance and none is cut in two.
TEST(XmlText, EveryCombinationOfHardUnitsComesBack)
{
    const std::vector<UTF16String> pieces = {
        u"\\",
        u"u",
        u"x",
        u"0",
        u"00",
        u"41",
        u"d",
        UTF16String(1, u'\0'),
        UTF16String(1, 0xD83D),
        UTF16String(1, 0xDE00),
    };
    ForAllTexts<UTF16String>(pieces, 5, {}, [](const UTF16String& text) { ASSERT_TRUE(ThereAndBack(text) == text); });
}

TEST(XmlText, EveryCombinationOfHardBytesComesBack)
{
    const auto byte = [](int value)
    {
        return UTF8String(1, static_cast<char8_t>(value));
    };
    const std::vector<UTF8String> pieces = {
        u8"\\", u8"x", u8"u", u8"0c", byte(0), byte(0xC3), byte(0xA9), byte(0xED), byte(0xF0), byte(0x80), byte(0xFF),
    };
    ForAllTexts<UTF8String>(pieces, 5, {}, [](const UTF8String& text) { ASSERT_TRUE(ThereAndBack(text) == text); });
}

TEST(XmlText, PathIsFoundInAnythingBelowIt)
{
    for (const UTF16String path : {u"/a & b/\u00e9", u"C:\\x", u"/back\\slash", u"/tab\tand 'quote'"})
        EXPECT_TRUE(Encode(path + u"/\U0001F3B5/x.vst3").starts_with(Encode(path)));
}
