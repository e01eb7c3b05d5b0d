#include "foundation/zebcore/PropList.h"

#include "foundation/zebcore/PropListVisitor.h"
#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

#include <string>

using namespace zebcore;
using proplist::PropList;

namespace
{

// The keys in the order in which they are visited; those of sub-lists in brackets.
class Order final : public proplist::PropListVisitor
{
public:
    explicit Order(const PropList& list) { list.Visit(*this); }

    void VisitValue(const UTF8String& key, const UTF16String& /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, const UTF8String& /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, bool /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, unsigned int /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, int /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, float /*value*/) override { mKeys += key; }
    void VisitValue(const UTF8String& key, const std::list<float>& /*value*/) override { mKeys += key; }
    void VisitSubList(const UTF8String& key, const PropList& subList) override
    {
        mKeys += u8'[' + key + Order(subList).mKeys + u8']';
    }

    UTF8String mKeys;
};

template <typename T>
struct Sample;
template <>
struct Sample<UTF16String>
{
    static UTF16String Value() { return u"sixteen"; }
};
template <>
struct Sample<UTF8String>
{
    static UTF8String Value() { return u8"eight"; }
};
template <>
struct Sample<bool>
{
    static bool Value() { return true; }
};
template <>
struct Sample<unsigned int>
{
    static unsigned int Value() { return 4000000000U; }
};
template <>
struct Sample<int>
{
    static int Value() { return -5; }
};
template <>
struct Sample<float>
{
    static float Value() { return 0.1F; }
};
template <>
struct Sample<std::list<float>>
{
    static std::list<float> Value() { return {1.0F, -0.5F}; }
};

template <typename T>
bool IsReadAs(const PropList& list, T before)
{
    T value = before;
    const bool isThere = list.GetValue(u8"key", value);
    EXPECT_TRUE(isThere || value == before) << "a getter that fails leaves its target";
    return isThere;
}

int CountReadableTypes(const PropList& list)
{
    return static_cast<int>(IsReadAs<UTF16String>(list, u"before")) +
           static_cast<int>(IsReadAs<UTF8String>(list, u8"before")) + static_cast<int>(IsReadAs<bool>(list, false)) +
           static_cast<int>(IsReadAs<unsigned int>(list, 7U)) + static_cast<int>(IsReadAs<int>(list, 7)) +
           static_cast<int>(IsReadAs<float>(list, 7.0F)) + static_cast<int>(IsReadAs<std::list<float>>(list, {7.0F}));
}

template <typename T>
class PropListTypes : public testing::Test
{
};

using AllTypes = testing::Types<UTF16String, UTF8String, bool, unsigned int, int, float, std::list<float>>;
TYPED_TEST_SUITE(PropListTypes, AllTypes);

} // namespace

TYPED_TEST(PropListTypes, ReadAsWhatWasStoredAndNothingElse)
{
    PropList list;
    EXPECT_EQ(CountReadableTypes(list), 0);
    list.SetValue(u8"key", Sample<TypeParam>::Value());
    TypeParam value{};
    EXPECT_TRUE(list.GetValue(u8"key", value));
    EXPECT_TRUE(value == Sample<TypeParam>::Value());
    EXPECT_EQ(CountReadableTypes(list), 1);
    EXPECT_EQ(list.GetSubList(u8"key"), nullptr);
}

TYPED_TEST(PropListTypes, SetterReplacesWhatIsThere)
{
    PropList list;
    list.SetValue(u8"before", 1);
    list.GetOrCreateSubList(u8"key").SetValue(u8"x", 1);
    list.SetValue(u8"after", 1);
    list.SetValue(u8"key", Sample<TypeParam>::Value());
    EXPECT_EQ(CountReadableTypes(list), 1);
    EXPECT_EQ(list.GetSubList(u8"key"), nullptr);
    EXPECT_TRUE(Order(list).mKeys == u8"beforekeyafter") << "in its place";
    list.GetOrCreateSubList(u8"key");
    EXPECT_EQ(CountReadableTypes(list), 0);
}

TEST(PropList, LiteralsAreStringsAndNotBool)
{
    PropList list;
    list.SetValue(u8"sixteen", u"a");
    list.SetValue(u8"eight", u8"b");
    UTF16String sixteen;
    UTF8String eight;
    EXPECT_TRUE(list.GetValue(u8"sixteen", sixteen) && sixteen == u"a");
    EXPECT_TRUE(list.GetValue(u8"eight", eight) && eight == u8"b");
}

TEST(PropList, KeepsInsertionOrder)
{
    PropList list;
    for (const char8_t* const key : {u8"z", u8"a", u8"m", u8"b"})
        list.SetValue(key, 1);
    list.GetOrCreateSubList(u8"l").SetValue(u8"x", true);
    list.SetValue(u8"a", u"again");
    list.RemoveValue(u8"m");
    list.SetValue(u8"m", 2.0F);
    list.RemoveValue(u8"unknown");
    EXPECT_TRUE(Order(list).mKeys == u8"zab[lx]m");
}

TEST(PropList, KeysOfAnyBytesAreDistinct)
{
    PropList list;
    list.SetValue(UTF8String(), 1);
    list.SetValue(UTF8String(1, u8'\0'), 2);
    int value = 0;
    EXPECT_TRUE(list.GetValue(UTF8String(1, u8'\0'), value));
    EXPECT_EQ(value, 2);
    EXPECT_TRUE(list.GetValue(u8"", value));
    EXPECT_EQ(value, 1);
}

TEST(PropList, SubListsAreOwnedAndStayWhereTheyAre)
{
    PropList list;
    PropList& first = list.GetOrCreateSubList(u8"list0");
    first.SetValue(u8"x", 1);
    for (int i = 1; i < 1000; ++i)
    {
        const std::string index = std::to_string(i);
        list.GetOrCreateSubList(UTF8String(u8"list").append(index.begin(), index.end()));
    }
    EXPECT_EQ(&list.GetOrCreateSubList(u8"list0"), &first);
    EXPECT_EQ(list.GetSubList(u8"list0"), &first);
    EXPECT_EQ(list.GetSubList(u8"list1000"), nullptr);
    EXPECT_FALSE(first.IsEmpty());
    const std::vector<UTF8String> keys = list.GetSubListKeys();
    ASSERT_EQ(keys.size(), 1000U);
    EXPECT_TRUE(keys[10] == u8"list10");
}

TEST(PropList, ClearAndRemoveEmptyIt)
{
    PropList list;
    EXPECT_TRUE(list.IsEmpty());
    list.GetOrCreateSubList(u8"list");
    EXPECT_FALSE(list.IsEmpty());
    list.RemoveValue(u8"list");
    EXPECT_TRUE(list.IsEmpty());
    EXPECT_EQ(list.GetSubList(u8"list"), nullptr);
    list.SetValue(u8"a", 1);
    list.Clear();
    EXPECT_TRUE(list.IsEmpty());
    int value = 5;
    EXPECT_FALSE(list.GetValue(u8"a", value));
}

// Long lists are searched in another way than short ones.
TEST(PropList, ManyKeysAreFoundWhileTheyComeAndGo)
{
    const auto key = [](int index)
    {
        return zebcore::utility::UTF8FromNarrow("key" + std::to_string(index));
    };
    PropList list;
    for (int index = 0; index < 100; ++index)
    {
        list.SetValue(key(index), index);
        list.SetValue(key(index / 2), index / 2);
    }
    for (int index = 0; index < 100; index += 3)
        list.RemoveValue(key(index));
    for (int index = 0; index < 100; ++index)
    {
        int value = -1;
        EXPECT_EQ(list.GetValue(key(index), value), index % 3 != 0) << index;
        EXPECT_EQ(value, index % 3 == 0 ? -1 : index);
    }
    for (int index = 0; index < 95; ++index)
        list.RemoveValue(key(index));
    list.SetValue(u8"last", true);
    int value = 0;
    EXPECT_TRUE(list.GetValue(key(97), value));
    EXPECT_FALSE(list.GetValue(key(94), value));
}

TEST(PropList, CopiesAreDeep)
{
    PropList list;
    list.SetValue(u8"a", std::list<float>{1.0F});
    list.GetOrCreateSubList(u8"outer").GetOrCreateSubList(u8"inner").SetValue(u8"x", 1);
    const PropList copy(list);
    list.GetSubList(u8"outer")->GetSubList(u8"inner")->SetValue(u8"y", 2);
    list.RemoveValue(u8"a");
    EXPECT_TRUE(Order(copy).mKeys == u8"a[outer[innerx]]");
    EXPECT_TRUE(Order(list).mKeys == u8"[outer[innerxy]]");
}

TEST(PropList, AssignmentFromItselfAndFromOwnSubList)
{
    PropList list;
    list.GetOrCreateSubList(u8"outer").GetOrCreateSubList(u8"inner").SetValue(u8"x", 1);
    const PropList& same = list;
    list = same;
    EXPECT_TRUE(Order(list).mKeys == u8"[outer[innerx]]");
    list = *list.GetSubList(u8"outer");
    EXPECT_TRUE(Order(list).mKeys == u8"[innerx]");
    list.GetOrCreateSubList(u8"inner") = list;
    EXPECT_TRUE(Order(list).mKeys == u8"[inner[innerx]]");
}

TEST(PropList, SwapKeepsSubListsAlive)
{
    PropList a;
    PropList b;
    PropList& subList = a.GetOrCreateSubList(u8"s");
    b.SetValue(u8"v", 1);
    a.Swap(b);
    EXPECT_EQ(b.GetSubList(u8"s"), &subList);
    a.SetValue(u8"w", 1);
    EXPECT_TRUE(Order(a).mKeys == u8"vw");
}
