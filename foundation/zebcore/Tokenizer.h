#pragma once

#include <cstddef>
#include <utility>

namespace zebcore::utility
{

/// Cuts a string at any of a set of delimiter units. [one thread at a time]
template <class String>
class Tokenizer
{
public:
    /// skipRepeated: a run of delimiters counts as one.
    Tokenizer(String text, String delimiters, bool skipRepeated)
        : mText(std::move(text)), mDelimiters(std::move(delimiters)), mSkipRepeated(skipRepeated)
    {
    }

    /// The text up to the next delimiter, or to the end. Empty once everything has been given, but also for an empty
    /// field between two delimiters.
    String NextToken()
    {
        if (mPosition == kEnd)
            return String();

        const std::size_t delimiter = mText.find_first_of(mDelimiters, mPosition);
        if (delimiter == String::npos)
            return mText.substr(std::exchange(mPosition, kEnd));

        const std::size_t start = std::exchange(mPosition, delimiter + 1);
        SkipRepeated();
        if (mPosition >= mText.size())
            mPosition = kEnd;
        return mText.substr(start, delimiter - start);
    }

    /// Number of tokens from the start of the text up to the first empty one: an empty field in the middle ends the
    /// count. Where this tokenizer stands plays no part.
    std::size_t NumTokens() const
    {
        if (mText.empty())
            return 0;
        Tokenizer fresh(mText, mDelimiters, mSkipRepeated);
        std::size_t count = 0;
        while (!fresh.NextToken().empty())
            ++count;
        return count;
    }

private:
    void SkipRepeated()
    {
        while (mSkipRepeated && mPosition < mText.size() && mDelimiters.find(mText[mPosition]) != String::npos)
            ++mPosition;
    }

    static constexpr std::size_t kEnd = String::npos;

    String mText;
    String mDelimiters;
    bool mSkipRepeated;
    std::size_t mPosition = 0;
};

} // namespace zebcore::utility
