#pragma once

#include "foundation/zebcore/internal/PositionTable.h"
#include "utility/CommonTypes.h"

#include <cstddef>
#include <string_view>
#include <utility>
#include <vector>

namespace zebaudiofilterhost
{

// Values under texts; the owner says how these are hashed and compared. What a look-up among ten thousand costs is
// what it has to fetch from memory: so the texts lie one behind another in a single block, and what leads there is
// small.
template <typename Value>
class TextTable
{
public:
    static constexpr std::size_t kNone = zebcore::utility::PositionTable::kNone;

    // Where the entry stands for which `isIt(text, value)` returns true, good until the next Add or Remove; kNone if
    // there is none.
    template <typename Predicate>
    std::size_t Find(std::size_t hash, const Predicate& isIt) const
    {
        return mPositions.Find(hash,
                               [this, &isIt](std::size_t position)
                               {
                                   const Entry& entry = mEntries[position];
                                   return isIt(TextOf(entry), entry.mValue);
                               });
    }

    std::u16string_view TextAt(std::size_t position) const { return TextOf(mEntries[position]); }
    const Value& ValueAt(std::size_t position) const { return mEntries[position].mValue; }
    Value& ValueAt(std::size_t position) { return mEntries[position].mValue; }

    // There must be no entry for the text yet.
    void Add(std::size_t hash, std::u16string_view text, Value value)
    {
        mEntries.push_back(Entry{hash, mTexts.size(), text.size(), std::move(value)});
        try
        {
            mTexts += text;
            mPositions.Insert(hash, mEntries.size() - 1);
        }
        catch (...)
        {
            mEntries.pop_back();
            throw;
        }
    }

    // What the entry took is given back when half of the table is such gaps.
    void Remove(std::size_t position)
    {
        mPositions.Remove(mEntries[position].mHash, position);
        mEntries[position] = Entry{0, kGap, 0, Value()};
        ++mGaps;
        if (2 * mGaps > mEntries.size())
        {
            CloseGaps();
        }
    }

    // Calls `show(text, value)` for each.
    template <typename Show>
    void ForEach(const Show& show) const
    {
        for (const Entry& entry : mEntries)
        {
            if (entry.mBegin != kGap)
            {
                show(TextOf(entry), entry.mValue);
            }
        }
    }

    std::size_t Size() const { return mEntries.size() - mGaps; }

private:
    static constexpr std::size_t kGap = static_cast<std::size_t>(-1);

    struct Entry
    {
        std::size_t mHash;
        std::size_t mBegin; // of the text; kGap if the entry was removed
        std::size_t mLength;
        Value mValue;
    };

    std::u16string_view TextOf(const Entry& entry) const
    {
        return std::u16string_view(mTexts).substr(entry.mBegin, entry.mLength);
    }

    void CloseGaps()
    {
        TextTable closed;
        for (const Entry& entry : mEntries)
        {
            if (entry.mBegin != kGap)
            {
                closed.Add(entry.mHash, TextOf(entry), entry.mValue);
            }
        }
        std::swap(*this, closed);
    }

    zebcore::utility::PositionTable mPositions;
    std::vector<Entry> mEntries;
    UTF16String mTexts;
    std::size_t mGaps = 0;
};

// Begins to fetch what a new reference to a counted object touches, which is where the object begins and where it
// ends, while something else is still being looked at. May be null.
template <typename Counted>
void PrefetchCounted(const Counted* object)
{
    __builtin_prefetch(object);
    __builtin_prefetch(static_cast<const char*>(static_cast<const void*>(object)) + sizeof(Counted) - 1, 1);
}

} // namespace zebaudiofilterhost
