#pragma once

#include "CoreFoundation/CFBase.h"

#include <plist/plist.h>

#include <memory>

namespace zebaudiofilterhost::xau::cf
{

struct FreeNode
{
    void operator()(void* node) const { plist_free(node); }
};

/// A tree of nodes, owned.
using NodePtr = std::unique_ptr<void, FreeNode>;

/// Deeper lists are refused: both ways recurse.
inline constexpr int kMaxPropertyListDepth = 256;

/// Null if a part of the object cannot stand in a property list.
NodePtr MakeNode(CFTypeRef object, int depth = 0);

/// With a reference for the caller. Null for a node of another kind than property lists have here.
CFTypeRef MakeObject(plist_t node, int depth = 0);

} // namespace zebaudiofilterhost::xau::cf
