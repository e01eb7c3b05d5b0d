#pragma once

#include <cstddef>
#include <string_view>

namespace zebaudiofilterhost::xau::cf
{

/// Looks at the tags of a list in XML before the parser does.
class XMLListGuard
{
public:
    explicit XMLListGuard(std::string_view text) : mText(text) {}

    /// False for too many nodes, for too deep ones, and for what is no XML.
    bool IsSafe();

private:
    bool StartsAsXML() const;
    bool SkipNoElement();
    bool SkipBehind(std::string_view end);
    bool CountTag();
    std::size_t FindTagEnd() const;

    std::string_view mText; // what is left
    std::size_t mNodes = 0;
    int mDepth = 0;
};

} // namespace zebaudiofilterhost::xau::cf
