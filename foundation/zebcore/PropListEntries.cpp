#include "foundation/zebcore/internal/PropListEntries.h"

#include <algorithm>
#include <functional>

namespace zebcore::proplist
{

namespace
{

constexpr std::size_t kFewEntries = 16;
constexpr std::size_t kFirstCapacity = 12; // A section of the settings file fits
constexpr std::size_t kNone = utility::PositionTable::kNone;

std::size_t Hash(std::u8string_view key)
{
    return std::hash<std::u8string_view>()(key);
}

} // namespace

std::size_t PropList::Entries::Position(std::u8string_view key) const
{
    if (!mIndex.IsEmpty())
        return mIndex.Find(Hash(key), [this, key](std::size_t position) { return mEntries[position].mKey == key; });
    const auto found =
        std::find_if(mEntries.begin(), mEntries.end(), [key](const Entry& entry) { return entry.mKey == key; });
    return found == mEntries.end() ? kNone : static_cast<std::size_t>(found - mEntries.begin());
}

const PropList::Entries::Value* PropList::Entries::Find(const UTF8String& key) const
{
    const std::size_t position = Position(key);
    return position == kNone ? nullptr : &mEntries[position].mValue;
}

PropList::Entries::Value* PropList::Entries::Find(const UTF8String& key)
{
    const std::size_t position = Position(key);
    return position == kNone ? nullptr : &mEntries[position].mValue;
}

PropList::Entries::Value& PropList::Entries::Set(const UTF8String& key, Value value)
{
    if (Value* const existing = Find(key))
    {
        // What was there dies last: the new value may have been made from it.
        std::swap(*existing, value);
        return *existing;
    }
    Append(key, std::move(value));
    return mEntries.back().mValue;
}

void PropList::Entries::Append(const UTF8String& key, Value&& value)
{
    if (mEntries.empty())
        mEntries.reserve(kFirstCapacity);
    mEntries.push_back(Entry{key, std::move(value)});
    try
    {
        if (!mIndex.IsEmpty())
            mIndex.Insert(Hash(mEntries.back().mKey), mEntries.size() - 1);
        else if (mEntries.size() > kFewEntries)
            BuildIndex();
    }
    catch (...)
    {
        mEntries.pop_back();
        throw;
    }
}

void PropList::Entries::BuildIndex()
{
    utility::PositionTable index;
    for (std::size_t position = 0; position < mEntries.size(); ++position)
        index.Insert(Hash(mEntries[position].mKey), position);
    std::swap(mIndex, index);
}

void PropList::Entries::Remove(const UTF8String& key)
{
    const std::size_t position = Position(key);
    if (position == kNone)
        return;
    const Value doomed = std::move(mEntries[position].mValue); // The key may be part of what it names
    mEntries.erase(mEntries.begin() + static_cast<std::ptrdiff_t>(position));
    mIndex.Clear();
    if (mEntries.size() > kFewEntries)
        BuildIndex();
}

void PropList::Entries::Clear()
{
    mIndex.Clear();
    mEntries.clear();
}

} // namespace zebcore::proplist
