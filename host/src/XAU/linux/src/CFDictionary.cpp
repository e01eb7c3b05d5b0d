#include "CoreFoundation/CFDictionary.h"

#include "host/src/XAU/linux/src/CFDictionaryObject.h"
#include "host/src/XAU/linux/src/CFObjectCallBacks.h"

#include <algorithm>
#include <functional>

using namespace zebaudiofilterhost::xau;

const CFDictionaryKeyCallBacks kCFTypeDictionaryKeyCallBacks = {0,       cf::RetainValue, cf::ReleaseValue,
                                                                nullptr, CFEqual,         CFHash};
const CFDictionaryValueCallBacks kCFTypeDictionaryValueCallBacks = {0, cf::RetainValue, cf::ReleaseValue, nullptr,
                                                                    CFEqual};

CFOpaqueDictionary::CFOpaqueDictionary(const CFDictionaryKeyCallBacks* keyCallBacks,
                                       const CFDictionaryValueCallBacks* valueCallBacks)
    : Object(cf::TypeID::Dictionary)
{
    if (keyCallBacks)
        mKeyCallBacks = *keyCallBacks;
    if (valueCallBacks)
        mValueCallBacks = *valueCallBacks;
}

CFOpaqueDictionary::~CFOpaqueDictionary()
{
    for (const Entry& entry : mEntries)
    {
        if (mKeyCallBacks.release)
            mKeyCallBacks.release(nullptr, entry.key);
        if (mValueCallBacks.release)
            mValueCallBacks.release(nullptr, entry.value);
    }
}

CFHashCode CFOpaqueDictionary::HashKey(const void* key) const
{
    return mKeyCallBacks.hash ? mKeyCallBacks.hash(key) : std::hash<const void*>()(key);
}

bool CFOpaqueDictionary::AreKeysEqual(const void* a, const void* b) const
{
    return a == b || (mKeyCallBacks.equal != nullptr && mKeyCallBacks.equal(a, b) != 0);
}

std::size_t CFOpaqueDictionary::FindIndex(const void* key) const
{
    const auto [begin, end] = mIndices.equal_range(HashKey(key));
    const auto found =
        std::find_if(begin, end, [&](const auto& item) { return AreKeysEqual(mEntries[item.second].key, key); });
    return found == end ? mEntries.size() : found->second;
}

const CFOpaqueDictionary::Entry* CFOpaqueDictionary::Find(const void* key) const
{
    const std::size_t index = FindIndex(key);
    return index < mEntries.size() ? &mEntries[index] : nullptr;
}

void CFOpaqueDictionary::Set(const void* key, const void* value)
{
    const void* kept = mValueCallBacks.retain ? mValueCallBacks.retain(nullptr, value) : value;
    const std::size_t index = FindIndex(key);
    if (index < mEntries.size())
    {
        if (mValueCallBacks.release)
            mValueCallBacks.release(nullptr, mEntries[index].value);
        mEntries[index].value = kept;
        return;
    }
    mEntries.push_back({mKeyCallBacks.retain ? mKeyCallBacks.retain(nullptr, key) : key, kept});
    mIndices.emplace(HashKey(key), index);
}

void CFOpaqueDictionary::Remove(const void* key)
{
    const std::size_t index = FindIndex(key);
    if (index >= mEntries.size())
        return;
    const Entry entry = mEntries[index];
    mEntries.erase(mEntries.begin() + static_cast<std::ptrdiff_t>(index));
    mIndices.clear();
    for (std::size_t left = 0; left < mEntries.size(); ++left)
        mIndices.emplace(HashKey(mEntries[left].key), left);
    if (mKeyCallBacks.release)
        mKeyCallBacks.release(nullptr, entry.key);
    if (mValueCallBacks.release)
        mValueCallBacks.release(nullptr, entry.value);
}

bool CFOpaqueDictionary::Equals(const Object& other) const
{
    const auto& dictionary = static_cast<const CFOpaqueDictionary&>(other);
    return mEntries.size() == dictionary.mEntries.size() &&
           std::all_of(mEntries.begin(), mEntries.end(),
                       [&](const Entry& entry)
                       {
                           const Entry* match = dictionary.Find(entry.key);
                           return match != nullptr && (match->value == entry.value ||
                                                       (mValueCallBacks.equal != nullptr &&
                                                        mValueCallBacks.equal(match->value, entry.value) != 0));
                       });
}

CFTypeID CFDictionaryGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Dictionary);
}

CFDictionaryRef CFDictionaryCreate(CFAllocatorRef /*allocator*/, const void** keys, const void** values,
                                   CFIndex count, const CFDictionaryKeyCallBacks* keyCallBacks,
                                   const CFDictionaryValueCallBacks* valueCallBacks)
{
    auto* dictionary = new CFOpaqueDictionary(keyCallBacks, valueCallBacks);
    for (CFIndex index = 0; index < count; ++index)
    {
        if (!dictionary->Find(keys[index]))
            dictionary->Set(keys[index], values[index]);
    }
    return dictionary;
}

CFMutableDictionaryRef CFDictionaryCreateMutable(CFAllocatorRef /*allocator*/, CFIndex /*capacity*/,
                                                 const CFDictionaryKeyCallBacks* keyCallBacks,
                                                 const CFDictionaryValueCallBacks* valueCallBacks)
{
    return new CFOpaqueDictionary(keyCallBacks, valueCallBacks);
}

CFIndex CFDictionaryGetCount(CFDictionaryRef dictionary)
{
    return static_cast<CFIndex>(dictionary->GetEntries().size());
}

const void* CFDictionaryGetValue(CFDictionaryRef dictionary, const void* key)
{
    const CFOpaqueDictionary::Entry* entry = dictionary->Find(key);
    return entry ? entry->value : nullptr;
}

Boolean CFDictionaryContainsKey(CFDictionaryRef dictionary, const void* key)
{
    return dictionary->Find(key) ? 1 : 0;
}

void CFDictionaryGetKeysAndValues(CFDictionaryRef dictionary, const void** keys, const void** values)
{
    for (const CFOpaqueDictionary::Entry& entry : dictionary->GetEntries())
    {
        if (keys)
            *keys++ = entry.key;
        if (values)
            *values++ = entry.value;
    }
}

void CFDictionarySetValue(CFMutableDictionaryRef dictionary, const void* key, const void* value)
{
    dictionary->Set(key, value);
}

void CFDictionaryRemoveValue(CFMutableDictionaryRef dictionary, const void* key)
{
    dictionary->Remove(key);
}
