#include "foundation/zebcore/internal/Paths.h"

#include <algorithm>

namespace zebcore::filesupport
{

namespace
{

constexpr char16_t kSlash = u'/';

} // namespace

UTF16String WithoutTrailingSlashes(std::u16string_view path)
{
    const std::size_t last = path.find_last_not_of(kSlash);
    return UTF16String(last == std::u16string_view::npos ? path.substr(0, 1) : path.substr(0, last + 1));
}

UTF16String Join(const UTF16String& parent, std::u16string_view subPath)
{
    if (parent.empty())
        return WithoutTrailingSlashes(subPath);
    subPath.remove_prefix(std::min(subPath.find_first_not_of(kSlash), subPath.size()));
    if (subPath.empty())
        return parent;
    UTF16String joined = parent;
    if (joined.back() != kSlash)
        joined += kSlash;
    return WithoutTrailingSlashes(joined.append(subPath));
}

UTF16String ParentOf(const UTF16String& path)
{
    const std::size_t slash = path.rfind(kSlash);
    if (slash == UTF16String::npos)
        return {};
    const UTF16String parent = WithoutTrailingSlashes(std::u16string_view(path).substr(0, slash));
    return parent.empty() ? UTF16String(1, kSlash) : parent;
}

std::u16string_view LastComponent(std::u16string_view path)
{
    const std::size_t slash = path.rfind(kSlash);
    return slash == std::u16string_view::npos || path.size() == 1 ? path : path.substr(slash + 1);
}

} // namespace zebcore::filesupport
