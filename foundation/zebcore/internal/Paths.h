#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <string_view>

// Path arithmetic: no access to the disk.
namespace zebcore::filesupport
{

// Without slashes at the end; the root keeps its own.
UTF16String WithoutTrailingSlashes(std::u16string_view path);

// One slash between the two, unless one of them is empty.
UTF16String Join(const UTF16String& parent, std::u16string_view subPath);

// What stands before the last component: "/" for "/a", empty for "a".
UTF16String ParentOf(const UTF16String& path);

std::u16string_view LastComponent(std::u16string_view path);

} // namespace zebcore::filesupport
