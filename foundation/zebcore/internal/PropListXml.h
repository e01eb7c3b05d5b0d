#pragma once

#include <string_view>

// The vocabulary of property lists as XML, described in docs/PROPERTY-LISTS.md.
namespace zebcore::proplist
{

inline constexpr std::u8string_view kRootElement = u8"proplist";
inline constexpr std::u8string_view kFormatAttribute = u8"format";
inline constexpr std::u8string_view kFormat = u8"1";

inline constexpr std::u8string_view kKeyAttribute = u8"key";

inline constexpr std::u8string_view kListElement = u8"list";
inline constexpr std::u8string_view kUTF16Element = u8"text";
inline constexpr std::u8string_view kUTF8Element = u8"utf8";
inline constexpr std::u8string_view kBoolElement = u8"bool";
inline constexpr std::u8string_view kUnsignedElement = u8"uint";
inline constexpr std::u8string_view kIntElement = u8"int";
inline constexpr std::u8string_view kFloatElement = u8"float";
inline constexpr std::u8string_view kFloatsElement = u8"floats";

inline constexpr std::u8string_view kTrue = u8"true";
inline constexpr std::u8string_view kFalse = u8"false";

inline constexpr std::u8string_view kNaNPrefix = u8"nan:"; // the bits follow, to this base
inline constexpr int kNaNBase = 16;

} // namespace zebcore::proplist
