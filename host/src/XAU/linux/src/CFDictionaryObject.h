#pragma once

#include "CoreFoundation/CFDictionary.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <cstddef>
#include <unordered_map>
#include <vector>

struct CFOpaqueDictionary final : zebaudiofilterhost::xau::cf::Object
{
    struct Entry
    {
        const void* key;
        const void* value;
    };

    /// Null callbacks: bare pointers.
    CFOpaqueDictionary(const CFDictionaryKeyCallBacks* keyCallBacks,
                       const CFDictionaryValueCallBacks* valueCallBacks);
    ~CFOpaqueDictionary() override;

    /// Null if there is none.
    const Entry* Find(const void* key) const;
    void Set(const void* key, const void* value);
    void Remove(const void* key);

    bool Equals(const Object& other) const override;
    CFHashCode Hash() const override { return mEntries.size(); }

    const std::vector<Entry>& GetEntries() const { return mEntries; }

private:
    CFHashCode HashKey(const void* key) const;
    bool AreKeysEqual(const void* a, const void* b) const;
    // The number of entries if there is none.
    std::size_t FindIndex(const void* key) const;

    CFDictionaryKeyCallBacks mKeyCallBacks = {};
    CFDictionaryValueCallBacks mValueCallBacks = {};
    std::vector<Entry> mEntries;                               // in the order of setting
    std::unordered_multimap<CFHashCode, std::size_t> mIndices; // by the key's hash
};
