#include "foundation/zebcore/internal/ParseXml.h"

#include <expat.h>

#include <algorithm>
#include <exception>
#include <forward_list>
#include <memory>
#include <optional>
#include <type_traits>

namespace zebcore::xml
{

namespace
{

constexpr XML_Char kNameSeparator = '\n';
// Expat copies each block that it is given, and reads an unfinished attribute or tag again with each: blocks grow
// while one takes all of them. Those of a text that stands in memory, and those that are read into Expat's own
// buffer:
constexpr int kFirstBlockSize = 1 << 20;
constexpr int kFirstReadSize = 1 << 16;
constexpr int kLargestSize = 1 << 28;

std::u8string_view View(const XML_Char* text)
{
    return text == nullptr ? std::u8string_view() : std::u8string_view(reinterpret_cast<const char8_t*>(text));
}

// One run of Expat over a document. Expat is C: nothing may be thrown through it, so what an event throws waits here.
class Run
{
public:
    explicit Run(XmlEvents& events) : mEvents(events), mParser(XML_ParserCreateNS(nullptr, kNameSeparator))
    {
        if (!mParser)
            throw std::bad_alloc();
        XML_SetReturnNSTriplet(mParser.get(), 1);
        XML_SetUserData(mParser.get(), this);
        XML_SetElementHandler(mParser.get(), StartElement, EndElement);
        XML_SetCharacterDataHandler(mParser.get(), Characters);
        XML_SetCdataSectionHandler(mParser.get(), StartCDATA, EndCDATA);
        XML_SetCommentHandler(mParser.get(), Comment);
        XML_SetNamespaceDeclHandler(mParser.get(), StartPrefixMapping, EndPrefixMapping);
        XML_SetStartDoctypeDeclHandler(mParser.get(), StartDoctype);
        XML_SetSkippedEntityHandler(mParser.get(), SkippedEntity);
    }

    XmlResult Parse(std::u8string_view text)
    {
        XML_Status status = XML_STATUS_OK;
        int size = kFirstBlockSize;
        for (bool last = false; !last && status == XML_STATUS_OK;)
        {
            const std::u8string_view block = text.substr(0, static_cast<std::size_t>(size));
            const XML_Index before = XML_GetCurrentByteIndex(mParser.get());
            text.remove_prefix(block.size());
            last = text.empty();
            status = XML_Parse(mParser.get(), reinterpret_cast<const char*>(block.data()),
                               static_cast<int>(block.size()), last ? XML_TRUE : XML_FALSE);
            size = NextSize(size, before);
        }
        return Conclude(status);
    }

    XmlResult Parse(const XmlSource& source)
    {
        XML_Status status = XML_STATUS_OK;
        int size = kFirstReadSize;
        for (bool last = false; !last && status == XML_STATUS_OK;)
        {
            void* const buffer = XML_GetBuffer(mParser.get(), size);
            if (buffer == nullptr)
                return Fault();
            const XML_Index before = XML_GetCurrentByteIndex(mParser.get());
            const auto read =
                static_cast<int>(source(static_cast<unsigned char*>(buffer), static_cast<unsigned int>(size)));
            last = read < size;
            status = XML_ParseBuffer(mParser.get(), read, last ? XML_TRUE : XML_FALSE);
            size = NextSize(size, before);
        }
        return Conclude(status);
    }

private:
    // `before`: where the parser stood ahead of a block of so many bytes.
    int NextSize(int size, XML_Index before) const
    {
        return XML_GetCurrentByteIndex(mParser.get()) == before ? std::min(2 * size, kLargestSize) : size;
    }

    XmlResult Conclude(XML_Status status) const
    {
        if (mThrown)
            std::rethrow_exception(mThrown);
        return status == XML_STATUS_OK ? XmlResult() : Fault();
    }

    XmlResult Fault() const
    {
        const XML_Error code = XML_GetErrorCode(mParser.get());
        const char* const reason = mRefusal == nullptr ? XML_ErrorString(code) : mRefusal;
        return {static_cast<int>(code),
                std::string(reason) + " in line " + std::to_string(XML_GetCurrentLineNumber(mParser.get()))};
    }

    void Refuse(const char* reason)
    {
        mRefusal = reason;
        XML_StopParser(mParser.get(), XML_FALSE);
    }

    // Names arrive as "local", "uri\nlocal" or "uri\nlocal\nprefix". Good until the next event.
    XmlName SplitName(const XML_Char* expatName)
    {
        const std::u8string_view whole = View(expatName);
        const std::size_t first = whole.find(char8_t{kNameSeparator});
        if (first == std::u8string_view::npos)
            return {whole, {}, whole};
        const std::u8string_view uri = whole.substr(0, first);
        const std::u8string_view rest = whole.substr(first + 1);
        const std::size_t second = rest.find(char8_t{kNameSeparator});
        const std::u8string_view local = rest.substr(0, second);
        if (second == std::u8string_view::npos)
            return {local, uri, local};
        UTF8String& qualified = mQualifiedNames.emplace_front(rest.substr(second + 1));
        return {qualified.append(u8":").append(local), uri, local};
    }

    // Runs one event. Expat may still deliver one or two after it was stopped: they are dropped.
    template <typename Event>
    static void Guard(void* userData, Event event) noexcept
    {
        Run& run = *static_cast<Run*>(userData);
        if (run.mRefusal != nullptr)
            return;
        try
        {
            event(run);
            run.mQualifiedNames.clear();
        }
        catch (...)
        {
            run.mThrown = std::current_exception();
            run.Refuse("exception");
        }
    }

    static void XMLCALL StartElement(void* userData, const XML_Char* name, const XML_Char** attributes)
    {
        Guard(userData,
              [name, attributes](Run& run)
              {
                  if (++run.mDepth > kMaxXmlDepth)
                      return run.Refuse("elements nested too deep");
                  run.mAttributes.clear();
                  for (const XML_Char** pair = attributes; *pair != nullptr; pair += 2)
                      run.mAttributes.push_back({run.SplitName(pair[0]).mQualified, View(pair[1])});
                  if (!run.mEvents.OnStartElement(run.SplitName(name), run.mAttributes))
                      run.Refuse("unexpected element");
              });
    }

    static void XMLCALL EndElement(void* userData, const XML_Char* name)
    {
        Guard(userData,
              [name](Run& run)
              {
                  --run.mDepth;
                  if (!run.mEvents.OnEndElement(run.SplitName(name)))
                      run.Refuse("unexpected content of an element");
              });
    }

    static void XMLCALL Characters(void* userData, const XML_Char* text, int length)
    {
        Guard(userData,
              [text, length](Run& run)
              {
                  const std::u8string_view view(reinterpret_cast<const char8_t*>(text),
                                                static_cast<std::size_t>(length));
                  if (!run.mEvents.OnCharacters(view))
                      run.Refuse("unexpected text");
              });
    }

    static void XMLCALL StartCDATA(void* userData)
    {
        Guard(userData, [](Run& run) { run.mEvents.OnStartCDATA(); });
    }

    static void XMLCALL EndCDATA(void* userData)
    {
        Guard(userData, [](Run& run) { run.mEvents.OnEndCDATA(); });
    }

    static void XMLCALL Comment(void* userData, const XML_Char* text)
    {
        Guard(userData, [text](Run& run) { run.mEvents.OnComment(View(text)); });
    }

    static void XMLCALL StartPrefixMapping(void* userData, const XML_Char* prefix, const XML_Char* uri)
    {
        Guard(userData, [prefix, uri](Run& run) { run.mEvents.OnStartPrefixMapping(View(prefix), View(uri)); });
    }

    static void XMLCALL EndPrefixMapping(void* userData, const XML_Char* prefix)
    {
        Guard(userData, [prefix](Run& run) { run.mEvents.OnEndPrefixMapping(View(prefix)); });
    }

    static void XMLCALL StartDoctype(void* userData, const XML_Char* /*name*/, const XML_Char* /*systemId*/,
                                     const XML_Char* /*publicId*/, int hasInternalSubset)
    {
        Guard(userData,
              [hasInternalSubset](Run& run)
              {
                  if (hasInternalSubset != 0)
                      run.Refuse("document type with declarations");
              });
    }

    static void XMLCALL SkippedEntity(void* userData, const XML_Char* /*name*/, int /*isParameterEntity*/)
    {
        Guard(userData, [](Run& run) { run.Refuse("undefined entity"); });
    }

    struct FreeParser
    {
        void operator()(XML_Parser parser) const { XML_ParserFree(parser); }
    };

    XmlEvents& mEvents;
    std::unique_ptr<std::remove_pointer_t<XML_Parser>, FreeParser> mParser;
    std::vector<XmlAttribute> mAttributes;
    std::forward_list<UTF8String> mQualifiedNames; // of the event that runs, those that had to be put together
    unsigned int mDepth = 0;
    const char* mRefusal = nullptr;
    std::exception_ptr mThrown;
};

} // namespace

XmlResult ParseXml(std::u8string_view text, XmlEvents& events)
{
    return Run(events).Parse(text);
}

XmlResult ParseXml(const XmlSource& source, XmlEvents& events)
{
    return Run(events).Parse(source);
}

} // namespace zebcore::xml
