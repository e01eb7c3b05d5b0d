#include "foundation/zebcore/Tokenizer.h"

#include "foundation/zebcore/StringTypes.h"

#include <gtest/gtest.h>

#include <vector>

using namespace zebcore;
using zebcore::utility::Tokenizer;

namespace
{

struct Case
{
    UTF16String mText;
    UTF16String mDelimiters;
    bool mSkipRepeated;
    std::vector<UTF16String> mTokens; ///< What successive calls give.
    std::size_t mCount;
};

const Case kCases[] = {
    {u"", u",", false, {u"", u""}, 0},
    {u"one", u",", false, {u"one", u"", u""}, 1},
    {u"one,two", u",", false, {u"one", u"two", u""}, 2},
    {u"one,two,", u",", false, {u"one", u"two", u""}, 2},
    {u"one,,two", u",", false, {u"one", u"", u"two", u""}, 1},
    {u"one,,two", u",", true, {u"one", u"two", u""}, 2},
    {u",one", u",", false, {u"", u"one", u""}, 0},
    {u",,one", u",", true, {u"", u"one", u""}, 0},
    {u"a;b, c", u",; ", true, {u"a", u"b", u"c", u""}, 3},
    {u"a,,,", u",", true, {u"a", u"", u""}, 1},
    {u"a,b", u"", false, {u"a,b", u""}, 1},
};

TEST(Tokenizer, CutsAtDelimiters)
{
    for (const Case& text : kCases)
    {
        Tokenizer<UTF16String> tokenizer(text.mText, text.mDelimiters, text.mSkipRepeated);
        for (const UTF16String& token : text.mTokens)
            EXPECT_TRUE(tokenizer.NextToken() == token);
    }
}

TEST(Tokenizer, CountsUpToTheFirstEmptyToken)
{
    for (const Case& text : kCases)
    {
        Tokenizer<UTF16String> tokenizer(text.mText, text.mDelimiters, text.mSkipRepeated);
        EXPECT_EQ(text.mCount, tokenizer.NumTokens());
        tokenizer.NextToken();
        EXPECT_EQ(text.mCount, tokenizer.NumTokens()) << "the count is that of the whole text";
    }
}

TEST(Tokenizer, CountingDoesNotMoveIt)
{
    Tokenizer<UTF16String> tokenizer(u"a,b", u",", false);
    tokenizer.NumTokens();
    EXPECT_TRUE(tokenizer.NextToken() == u"a");
}

} // namespace
