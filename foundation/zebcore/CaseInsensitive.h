#pragma once

#include "foundation/zebcore/Locale.h"

#include <algorithm>
#include <locale>
#include <string_view>

namespace zebcore::utility::CaseInsensitive
{

/// Equality of two code units after folding "A" to "Z" onto "a" to "z". Nothing else is folded, whatever the locale
/// says, so that comparisons give the same result on every machine.
template <class Unit>
class EqualChar
{
public:
    EqualChar() = default;
    explicit EqualChar(const std::locale& /*nothing but ASCII is folded*/) {}

    constexpr bool operator()(Unit a, Unit b) const { return Fold(a) == Fold(b); }

private:
    static constexpr Unit Fold(Unit unit)
    {
        return unit >= Unit('A') && unit <= Unit('Z') ? static_cast<Unit>(unit - Unit('A') + Unit('a')) : unit;
    }
};

/// Equal length and EqualChar unit by unit.
inline bool Equal(std::u16string_view a, std::u16string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), EqualChar<char16_t>(Locale::Default()));
}

/// Whether the text ends in the suffix, by EqualChar.
inline bool EndsWith(std::u16string_view text, std::u16string_view suffix)
{
    return text.size() >= suffix.size() && Equal(text.substr(text.size() - suffix.size()), suffix);
}

} // namespace zebcore::utility::CaseInsensitive
