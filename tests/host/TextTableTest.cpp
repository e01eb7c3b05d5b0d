#include "host/src/TextTable.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <random>
#include <string>

namespace zebaudiofilterhost::testing
{

namespace
{

// A table beside a map that does the same.
class Churn
{
public:
    // Enters what is not there, removes what is.
    void Step()
    {
        const UTF16String text(mRandom() % 40, static_cast<char16_t>(u'a' + mRandom() % 5));
        if (mExpected.erase(text) != 0)
        {
            mTable.Remove(Find(text));
            return;
        }
        mTable.Add(Hash(text), text, mNext);
        mExpected.emplace(text, mNext++);
    }

    void Check() const
    {
        EXPECT_EQ(mTable.Size(), mExpected.size());
        std::map<UTF16String, int> shown;
        mTable.ForEach([&shown](std::u16string_view text, int value) { shown.emplace(text, value); });
        EXPECT_TRUE(shown == mExpected);
        for (std::size_t length = 0; length < 40; ++length)
        {
            const UTF16String text(length, u'c');
            const std::size_t found = Find(text);
            const auto expected = mExpected.find(text);
            ASSERT_EQ(found == TextTable<int>::kNone, expected == mExpected.end()) << length;
            if (expected != mExpected.end())
            {
                EXPECT_EQ(mTable.ValueAt(found), expected->second) << length;
                EXPECT_TRUE(mTable.TextAt(found) == text) << length;
            }
        }
    }

private:
    // Few, so that the comparison decides.
    static std::size_t Hash(const UTF16String& text) { return text.size() % 3; }

    std::size_t Find(const UTF16String& text) const
    {
        return mTable.Find(Hash(text), [&text](std::u16string_view known, int) { return known == text; });
    }

    TextTable<int> mTable;
    std::map<UTF16String, int> mExpected;
    std::mt19937 mRandom{1};
    int mNext = 0;
};

} // namespace

TEST(TextTableTest, HoldsWhatWasEnteredAndNotRemoved)
{
    Churn churn;
    churn.Check();
    for (int round = 0; round < 100; ++round)
    {
        for (int step = 0; step < 20; ++step)
        {
            churn.Step();
        }
        churn.Check();
    }
}

TEST(TextTableTest, CopyIsIndependentAndValuesCanChangeInTheirPlace)
{
    const auto isIt = [](std::u16string_view text, int)
    {
        return text == u"a";
    };
    TextTable<int> table;
    table.Add(1, u"a", 1);
    TextTable<int> copy = table;
    copy.ValueAt(copy.Find(1, isIt)) = 2;
    table.Remove(table.Find(1, isIt));
    EXPECT_EQ(table.Find(1, isIt), TextTable<int>::kNone);
    EXPECT_EQ(copy.ValueAt(copy.Find(1, isIt)), 2);
}

} // namespace zebaudiofilterhost::testing
