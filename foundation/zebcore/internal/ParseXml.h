#pragma once

#include "foundation/zebcore/internal/XmlEvents.h"

#include <functional>
#include <string>
#include <string_view>

namespace zebcore::xml
{

// Elements within elements that are followed.
inline constexpr unsigned int kMaxXmlDepth = 1000;

struct XmlResult
{
    int mCode = 0;      // 0: the document is well-formed and was taken
    std::string mFault; // otherwise what is wrong, with its line
};

// Runs the events over a whole document. Nothing outside the text is opened, and a document type with declarations of
// its own is refused, so that work and memory stay in proportion to the text.
XmlResult ParseXml(std::u8string_view text, XmlEvents& events);

// Puts the next bytes of a document into the buffer and returns how many: fewer than there is room for at the end
// only.
using XmlSource = std::function<unsigned int(unsigned char* buffer, unsigned int size)>;

// The same over a document that never stands in memory as a whole. What the source throws leaves it too.
XmlResult ParseXml(const XmlSource& source, XmlEvents& events);

} // namespace zebcore::xml
