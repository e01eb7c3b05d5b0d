#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <string_view>
#include <vector>

namespace zebcore::xml
{

// A name in an XML document, in UTF-8.
struct XmlName
{
    std::u8string_view mQualified; // as written
    std::u8string_view mUri;       // empty outside of all namespaces
    std::u8string_view mLocal;
};

struct XmlAttribute
{
    std::u8string_view mName; // as written
    std::u8string_view mValue;
};

// Receives a document from ParseXml, in UTF-8. Views are good during the call only. Events that return false refuse
// the document: the parse ends there. What an event throws ends the parse and leaves it by ParseXml.
class XmlEvents
{
public:
    virtual ~XmlEvents() = default;

    virtual bool OnStartElement(const XmlName& name, const std::vector<XmlAttribute>& attributes) = 0;
    virtual bool OnEndElement(const XmlName& name) = 0;
    virtual bool OnCharacters(std::u8string_view text) = 0;
    virtual void OnStartCDATA() {}
    virtual void OnEndCDATA() {}
    virtual void OnComment(std::u8string_view /*text*/) {}
    virtual void OnStartPrefixMapping(std::u8string_view /*prefix*/, std::u8string_view /*uri*/) {}
    virtual void OnEndPrefixMapping(std::u8string_view /*prefix*/) {}
};

} // namespace zebcore::xml
