#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"

#include <gtest/gtest.h>

#include <random>
#include <string>

using namespace zebcore;
using proplist::PropList;
using namespace proplist::utils;

namespace
{

UTF8String RealText()
{
    PropList list;
    list.SetValue(u8"version", 2U);
    list.SetValue(u8"num_plugin_infos", 2);
    for (const char8_t* const key : {u8"plugin_info0", u8"plugin_info1"})
    {
        PropList& record = list.GetOrCreateSubList(key);
        record.SetValue(u8"locator", u"3:/opt/Hall & Room/\u00e9.vst3");
        record.SetValue(u8"name", UTF16String(u"padded\0\0", 8));
        record.SetValue(u8"enabled", true);
    }
    list.SetValue(u8"ParamList", std::list<float>{0.5F, 1.0F});
    list.SetValue(u8"ChunkData", u8"AAECAwQF");
    UTF8String text;
    WritePropList(text, list);
    return text;
}

// Collects what is traced in the category of property lists.
class TraceLines
{
public:
    TraceLines()
    {
        debug::SetTraceSink([this](std::string_view line) { mLines += line; });
        debug::SetTraceCategoryEnabled("PropList", true);
    }
    TraceLines(const TraceLines&) = delete;
    TraceLines& operator=(const TraceLines&) = delete;
    ~TraceLines()
    {
        debug::SetAllTraceEnabled(false);
        debug::SetTraceSink({});
    }

    std::string mLines;
};

} // namespace

TEST(PropListDamage, MalformedTextLeavesTheListEmptyAndIsTraced)
{
    const char8_t* const malformed[] = {
        u8"",
        u8"plain text",
        u8"<other/>",
        u8"<proplist/>",
        u8"<proplist format='2'/>",
        u8"<proplist format='1'>",
        u8"<proplist format='1'/><proplist format='1'/>",
        u8"<proplist format='1'>text</proplist>",
        u8"<proplist format='1'><int>1</int></proplist>",
        u8"<proplist format='1'><int key='a'>1</int><double key='b'>1</double></proplist>",
        u8"<proplist format='1'><int key='a'></int></proplist>",
        u8"<proplist format='1'><int key='a'> 1</int></proplist>",
        u8"<proplist format='1'><int key='a'>1x</int></proplist>",
        u8"<proplist format='1'><int key='a'>2147483648</int></proplist>",
        u8"<proplist format='1'><uint key='a'>-1</uint></proplist>",
        u8"<proplist format='1'><bool key='a'>1</bool></proplist>",
        u8"<proplist format='1'><float key='a'>0,5</float></proplist>",
        u8"<proplist format='1'><float key='a'>1e999</float></proplist>",
        u8"<proplist format='1'><float key='a'>nan:1ffffffff</float></proplist>",
        u8"<proplist format='1'><floats key='a'>1 x</floats></proplist>",
        u8"<proplist format='1'><text key='a'><text key='b'/></text></proplist>",
        u8"<proplist format='1'><list key='a'>text</list></proplist>",
        u8"<proplist format='1'><text key='a'>\xFF</text></proplist>",
        u8"<proplist format='1'><text key='a'>&unknown;</text></proplist>",
        u8"<!DOCTYPE proplist SYSTEM 'file:///etc/passwd'><proplist format='1'><text key='a'>&x;</text></proplist>",
        u8"<!DOCTYPE proplist [<!ENTITY x 'y'>]><proplist format='1'><text key='a'>&x;</text></proplist>",
    };
    for (const char8_t* const text : malformed)
    {
        TraceLines trace;
        PropList list;
        list.SetValue(u8"stale", 1);
        EXPECT_FALSE(ReadPropList(text, list)) << utility::NarrowFromUTF8(text);
        EXPECT_TRUE(list.IsEmpty()) << utility::NarrowFromUTF8(text);
        EXPECT_NE(trace.mLines.find("<PropList>"), std::string::npos) << utility::NarrowFromUTF8(text);
    }
}

TEST(PropListDamage, ExpansionBombIsRefused)
{
    std::string bomb = "<!DOCTYPE proplist [<!ENTITY a0 '0123456789'>";
    for (int i = 1; i < 20; ++i)
    {
        bomb += "<!ENTITY a" + std::to_string(i) + " '";
        for (int copy = 0; copy < 10; ++copy)
            bomb += "&a" + std::to_string(i - 1) + ";";
        bomb += "'>";
    }
    bomb += "]><proplist format='1'><text key='x'>&a19;</text></proplist>";
    PropList list;
    EXPECT_FALSE(ReadPropList(utility::UTF8FromNarrow(bomb), list));
    EXPECT_TRUE(list.IsEmpty());
}

TEST(PropListDamage, DeepNestingIsRefused)
{
    UTF8String text = u8"<proplist format='1'>";
    for (int i = 0; i < 200000; ++i)
        text += u8"<list key='l'>";
    PropList list;
    EXPECT_FALSE(ReadPropList(text, list));
    EXPECT_TRUE(list.IsEmpty());
}

TEST(PropListDamage, TruncationAtEveryByteReadsAsEmpty)
{
    const UTF8String whole = RealText();
    const std::size_t needed = whole.rfind(u8'>') + 1;
    for (std::size_t length = 0; length < needed; ++length)
    {
        PropList list;
        ASSERT_FALSE(ReadPropList(whole.substr(0, length), list)) << length;
        ASSERT_TRUE(list.IsEmpty()) << length;
    }
    PropList list;
    EXPECT_TRUE(ReadPropList(whole.substr(0, needed), list));
}

// A damaged text is refused, or is a list that can be written and read again.
TEST(PropListDamage, RandomDamageIsSurvived)
{
    const UTF8String whole = RealText();
    std::mt19937 random(20240611);
    const auto below = [&random](std::size_t limit)
    {
        return random() % limit;
    };
    int refused = 0;
    constexpr int kRounds = 4000;
    for (int round = 0; round < kRounds; ++round)
    {
        UTF8String text = whole;
        for (std::size_t change = 0; change <= below(4); ++change)
        {
            const std::size_t at = below(text.size());
            if (below(3) == 0)
                text.erase(at, below(20));
            else if (below(2) == 0)
                text.insert(at, whole.substr(below(whole.size()), below(40)));
            else
                text[at] = static_cast<char8_t>(below(256));
        }
        PropList list;
        if (!ReadPropList(text, list))
        {
            ++refused;
            ASSERT_TRUE(list.IsEmpty());
        }
        UTF8String written;
        UTF8String again;
        WritePropList(written, list);
        PropList reread;
        ASSERT_TRUE(ReadPropList(written, reread)) << utility::NarrowFromUTF8(text);
        WritePropList(again, reread);
        ASSERT_TRUE(written == again) << utility::NarrowFromUTF8(text);
    }
    EXPECT_GT(refused, 0);
    EXPECT_LT(refused, kRounds);
}
