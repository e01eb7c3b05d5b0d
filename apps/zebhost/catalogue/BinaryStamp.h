#pragma once

#include "output/JsonDocument.h"

#include <host/PluginLocator.h>

#include <cstdint>

namespace zebhost
{

// What tells a plug-in's binary from the one that stood in its place before.
struct BinaryStamp
{
    std::int64_t time = 0; // of its last change, in nanoseconds since 1970
    std::uint64_t size = 0;

    bool operator==(const BinaryStamp&) const = default;
    // Nothing is known of the binary.
    bool IsEmpty() const { return *this == BinaryStamp(); }
};

// Of the binary inside a bundle, or of the file that the locator names itself. Opens nothing. Empty if there is none.
BinaryStamp StampOf(const zebaudiofilterhost::PluginLocator& locator);

Json ToJson(const BinaryStamp& stamp);
// Of the "binary" of an entry; empty if it has none.
BinaryStamp StampIn(const Json& entry);

} // namespace zebhost
