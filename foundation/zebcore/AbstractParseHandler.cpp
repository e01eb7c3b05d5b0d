#include "foundation/zebcore/AbstractParseHandler.h"

namespace zebcore::xml
{

AbstractParseHandler::~AbstractParseHandler() = default;

void AbstractParseHandler::StartDocument()
{
}
void AbstractParseHandler::StartElement(const UTF16String& /*name*/, const Attributes& /*attributes*/)
{
}
void AbstractParseHandler::StartElementWithNamespace(const UTF16String& /*uri*/, const UTF16String& /*localName*/,
                                                     const Attributes& /*attributes*/)
{
}
void AbstractParseHandler::EndElement(const UTF16String& /*name*/)
{
}
void AbstractParseHandler::EndElementWithNamespace(const UTF16String& /*uri*/, const UTF16String& /*localName*/)
{
}
void AbstractParseHandler::StartCDATA()
{
}
void AbstractParseHandler::EndCDATA()
{
}
void AbstractParseHandler::Characters(const UTF16String& /*text*/)
{
}
void AbstractParseHandler::Comment(const UTF16String& /*text*/)
{
}
void AbstractParseHandler::EndDocument()
{
}
void AbstractParseHandler::StartPrefixMapping(const UTF16String& /*prefix*/, const UTF16String& /*uri*/)
{
}
void AbstractParseHandler::EndPrefixMapping(const UTF16String& /*prefix*/)
{
}

} // namespace zebcore::xml
