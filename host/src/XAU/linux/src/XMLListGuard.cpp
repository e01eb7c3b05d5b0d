#include "host/src/XAU/linux/src/XMLListGuard.h"

#include "host/src/XAU/linux/src/PropertyListGuard.h"
#include "host/src/XAU/linux/src/PropertyListNodes.h"

#include <algorithm>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

constexpr std::string_view kSpace = " \t\r\n";

bool IsContainer(std::string_view name)
{
    return name == "array" || name == "dict";
}

} // namespace

bool XMLListGuard::IsSafe()
{
    if (!StartsAsXML())
        return false;
    for (auto next = mText.find('<'); next != std::string_view::npos; next = mText.find('<'))
    {
        mText.remove_prefix(next);
        if (SkipNoElement())
            continue;
        if (!CountTag())
            return false;
    }
    return true;
}

// Newer parsers take other notations too, whose nesting nobody would count.
bool XMLListGuard::StartsAsXML() const
{
    constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
    const std::string_view text = mText.starts_with(kByteOrderMark) ? mText.substr(kByteOrderMark.size()) : mText;
    const auto first = text.find_first_not_of(kSpace);
    return first != std::string_view::npos && text[first] == '<';
}

// Passes over a comment and the like, where a tag is none.
bool XMLListGuard::SkipNoElement()
{
    if (mText.starts_with("<!--"))
        return SkipBehind("-->");
    if (mText.starts_with("<![CDATA["))
        return SkipBehind("]]>");
    if (mText.starts_with("<?"))
        return SkipBehind("?>");
    if (!mText.starts_with("<!"))
        return false;
    const auto end = mText.find_first_of("[>");
    return SkipBehind(end != std::string_view::npos && mText[end] == '[' ? "]>" : ">");
}

bool XMLListGuard::SkipBehind(std::string_view end)
{
    const auto found = mText.find(end);
    mText.remove_prefix(found == std::string_view::npos ? mText.size() : found + end.size());
    return true;
}

// False beyond a bound.
bool XMLListGuard::CountTag()
{
    const auto end = FindTagEnd();
    const std::string_view tag = mText.substr(1, end - 1);
    mText.remove_prefix(end);
    const bool isEmpty = tag.ends_with('/');
    const bool closes = tag.starts_with('/');
    const std::string_view start = tag.substr(closes ? 1 : 0);
    const std::string_view name = start.substr(0, start.find_first_of(" \t\r\n/"));
    if (closes)
    {
        mDepth = std::max(0, mDepth - (IsContainer(name) ? 1 : 0));
        return true;
    }
    if (!isEmpty && IsContainer(name))
        ++mDepth;
    return ++mNodes <= kMaxPropertyListNodes && mDepth <= kMaxPropertyListDepth + 1;
}

// A bracket in quotes is no end.
std::size_t XMLListGuard::FindTagEnd() const
{
    std::size_t at = 1;
    while (at < mText.size() && mText[at] != '>' && mText[at] != '<')
    {
        const char letter = mText[at];
        const auto partner = letter == '"' || letter == '\'' ? mText.find(letter, at + 1) : at;
        at = partner == std::string_view::npos ? mText.size() : partner + 1;
    }
    return at;
}

} // namespace zebaudiofilterhost::xau::cf
