#include "foundation/zebcore/PropList.h"

#include "foundation/zebcore/PropListVisitor.h"
#include "foundation/zebcore/internal/PropListCopier.h"
#include "foundation/zebcore/internal/PropListEntries.h"

#include <type_traits>
#include <typeinfo>
#include <utility>

namespace zebcore::proplist
{

namespace
{

template <typename T, typename Value>
bool Get(const Value* stored, T& target)
{
    const T* const value = stored == nullptr ? nullptr : std::get_if<T>(stored);
    if (value != nullptr)
        target = *value;
    return value != nullptr;
}

} // namespace

// A wrapper has its own idea of setting a value.
template <typename Text>
void PropList::Take(const UTF8String& key, Text&& value)
{
    if (typeid(*this) == typeid(PropList))
        mEntries->Set(key, std::forward<Text>(value));
    else
        SetValue(key, std::as_const(value));
}

void PropList::SetValue(const UTF8String& key, UTF16String&& value)
{
    Take(key, std::move(value));
}

void PropList::SetValue(const UTF8String& key, UTF8String&& value)
{
    Take(key, std::move(value));
}

PropList::PropList() : mEntries(std::make_unique<Entries>())
{
}

PropList::PropList(const PropList& other) : PropList()
{
    PropListCopier copier(*this);
    other.Visit(copier);
}

PropList& PropList::operator=(const PropList& other)
{
    PropList copy(other); // first: `other` may be one of our own sub-lists
    Swap(copy);
    return *this;
}

PropList::~PropList() = default;

bool PropList::GetValue(const UTF8String& key, UTF16String& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const UTF16String& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, UTF8String& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const UTF8String& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, bool& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const bool& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, unsigned int& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const unsigned int& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, int& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const int& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, float& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const float& value)
{
    mEntries->Set(key, value);
}

bool PropList::GetValue(const UTF8String& key, std::list<float>& value) const
{
    return Get(mEntries->Find(key), value);
}

void PropList::SetValue(const UTF8String& key, const std::list<float>& value)
{
    mEntries->Set(key, value);
}

const PropList* PropList::GetSubList(const UTF8String& key) const
{
    const Entries::Value* const stored = std::as_const(*mEntries).Find(key);
    const auto* const subList = stored == nullptr ? nullptr : std::get_if<Entries::SubList>(stored);
    return subList == nullptr ? nullptr : subList->get();
}

PropList& PropList::GetOrCreateSubList(const UTF8String& key)
{
    if (PropList* const existing = GetSubList(key))
        return *existing;
    return *std::get<Entries::SubList>(mEntries->Set(key, std::make_unique<PropList>()));
}

void PropList::Clear()
{
    mEntries->Clear();
}

void PropList::Visit(PropListVisitor& visitor) const
{
    for (const auto& [key, stored] : mEntries->InOrder())
        std::visit(
            [&visitor, &entryKey = key](const auto& value)
            {
                if constexpr (std::is_same_v<std::decay_t<decltype(value)>, Entries::SubList>)
                    visitor.VisitSubList(entryKey, *value);
                else
                    visitor.VisitValue(entryKey, value);
            },
            stored);
}

PropList* PropList::GetSubList(const UTF8String& key)
{
    // The sub-list belongs to this list, which the caller may change.
    return const_cast<PropList*>(std::as_const(*this).GetSubList(key));
}

bool PropList::IsEmpty() const
{
    return mEntries->InOrder().empty();
}

void PropList::RemoveValue(const UTF8String& key)
{
    mEntries->Remove(key);
}

std::vector<UTF8String> PropList::GetSubListKeys() const
{
    class KeyCollector final : public PropListVisitor
    {
    public:
        void VisitSubList(const UTF8String& key, const PropList& /*subList*/) override { mKeys.push_back(key); }
        std::vector<UTF8String> mKeys;
    };
    KeyCollector collector;
    Visit(collector);
    return std::move(collector.mKeys);
}

void PropList::Swap(PropList& other) noexcept
{
    mEntries.swap(other.mEntries);
}

} // namespace zebcore::proplist
