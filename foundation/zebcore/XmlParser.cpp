#include "foundation/zebcore/XmlParser.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/internal/ParseXml.h"

namespace zebcore::xml
{

namespace
{

constexpr int kUnreadableFile = -1;

// Hands the events of a document to a handler, in UTF-16.
class HandlerEvents final : public XmlEvents
{
public:
    explicit HandlerEvents(AbstractParseHandler& handler) : mHandler(handler) {}

    bool OnStartElement(const XmlName& name, const std::vector<XmlAttribute>& attributes) override
    {
        AbstractParseHandler::Attributes converted;
        for (const XmlAttribute& attribute : attributes)
            converted.emplace(utility::UTF8to16(attribute.mName), utility::UTF8to16(attribute.mValue));
        mHandler.StartElement(utility::UTF8to16(name.mQualified), converted);
        if (!name.mUri.empty())
            mHandler.StartElementWithNamespace(utility::UTF8to16(name.mUri), utility::UTF8to16(name.mLocal),
                                               converted);
        return true;
    }

    bool OnEndElement(const XmlName& name) override
    {
        if (!name.mUri.empty())
            mHandler.EndElementWithNamespace(utility::UTF8to16(name.mUri), utility::UTF8to16(name.mLocal));
        mHandler.EndElement(utility::UTF8to16(name.mQualified));
        return true;
    }

    bool OnCharacters(std::u8string_view text) override
    {
        mHandler.Characters(utility::UTF8to16(text));
        return true;
    }

    void OnStartCDATA() override { mHandler.StartCDATA(); }
    void OnEndCDATA() override { mHandler.EndCDATA(); }
    void OnComment(std::u8string_view text) override { mHandler.Comment(utility::UTF8to16(text)); }

    void OnStartPrefixMapping(std::u8string_view prefix, std::u8string_view uri) override
    {
        mHandler.StartPrefixMapping(utility::UTF8to16(prefix), utility::UTF8to16(uri));
    }

    void OnEndPrefixMapping(std::u8string_view prefix) override
    {
        mHandler.EndPrefixMapping(utility::UTF8to16(prefix));
    }

private:
    AbstractParseHandler& mHandler;
};

} // namespace

XmlParser::XmlParser(std::unique_ptr<AbstractParseHandler> handler) : mHandler(std::move(handler))
{
    if (!mHandler)
        mHandler = std::make_unique<AbstractParseHandler>();
}

XmlParser::~XmlParser() = default;

int XmlParser::Parse(const UTF16String& path)
{
    UTF8String text;
    try
    {
        text = utility::FileUtils::SimpleReadStringFromFile(path);
    }
    catch (const filesupport::file_exception& failure)
    {
        ZEB_TRACE("XmlParser", failure.what());
        return kUnreadableFile;
    }
    mHandler->StartDocument();
    HandlerEvents events(*mHandler);
    const XmlResult result = ParseXml(text, events);
    if (result.mCode != 0)
        ZEB_TRACE("XmlParser", path << ": " << result.mFault);
    else
        mHandler->EndDocument();
    return result.mCode;
}

std::unique_ptr<XmlParser> GetParser(std::unique_ptr<AbstractParseHandler>& handler)
{
    return std::make_unique<XmlParser>(std::move(handler));
}

} // namespace zebcore::xml
