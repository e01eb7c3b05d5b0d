#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <map>

namespace zebcore::xml
{

/// Receives an XML document from a parser, piece by piece in document order. Override what you need; the default
/// bodies do nothing. What an override throws ends the parse and leaves it by Parse.
class ZEB_EXPORT AbstractParseHandler
{
public:
    using Attributes = std::map<UTF16String, UTF16String>; // by name as written, without namespace declarations

    virtual ~AbstractParseHandler();

    virtual void StartDocument();

    /// Every element, under its name as written, prefix included.
    virtual void StartElement(const UTF16String& name, const Attributes& attributes);

    /// After StartElement, for an element in a namespace: its URI and its name without prefix.
    virtual void StartElementWithNamespace(const UTF16String& uri, const UTF16String& localName,
                                           const Attributes& attributes);

    virtual void EndElement(const UTF16String& name);

    /// Before EndElement, for an element in a namespace.
    virtual void EndElementWithNamespace(const UTF16String& uri, const UTF16String& localName);

    virtual void StartCDATA();
    virtual void EndCDATA();

    /// A run of text may arrive in several pieces.
    virtual void Characters(const UTF16String& text);

    virtual void Comment(const UTF16String& text);

    /// Not called when the document turns out to be malformed.
    virtual void EndDocument();

    /// Around the element that declares the prefix; the default namespace has an empty one.
    virtual void StartPrefixMapping(const UTF16String& prefix, const UTF16String& uri);
    virtual void EndPrefixMapping(const UTF16String& prefix);
};

} // namespace zebcore::xml
