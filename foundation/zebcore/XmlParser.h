#pragma once

#include "foundation/zebcore/AbstractParseHandler.h"
#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <memory>

namespace zebcore::xml
{

/// Runs a handler over XML files. Not loaded, and refused, is what makes a small file large or reaches for another
/// one: a document type with declarations of its own. Belongs to one thread at a time. [any]
class ZEB_EXPORT XmlParser
{
public:
    /// `handler` may be null: the file is checked only.
    explicit XmlParser(std::unique_ptr<AbstractParseHandler> handler);

    XmlParser(const XmlParser&) = delete;
    XmlParser& operator=(const XmlParser&) = delete;
    ~XmlParser();

    /// Returns 0 on success, else a code of the parser's, or -1 if the file can't be read. The handler has then seen
    /// what stands before the fault. The fault is traced in category "XmlParser".
    int Parse(const UTF16String& path);

private:
    std::unique_ptr<AbstractParseHandler> mHandler;
};

/// Makes a parser that takes the handler over; `handler` is null afterwards.
ZEB_EXPORT std::unique_ptr<XmlParser> GetParser(std::unique_ptr<AbstractParseHandler>& handler);

} // namespace zebcore::xml
