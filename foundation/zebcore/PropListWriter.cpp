#include "foundation/zebcore/internal/PropListWriter.h"

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/internal/PropListXml.h"
#include "foundation/zebcore/internal/XmlText.h"

#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <utility>

namespace zebcore::proplist
{

namespace
{

constexpr std::size_t kLongText = std::size_t{1} << 16U;

// `format` is a base or nothing.
template <typename T, typename... Format>
void AppendNumber(UTF8String& out, T value, Format... format)
{
    std::array<char, 32> digits{};
    const char* const end = std::to_chars(digits.data(), digits.data() + digits.size(), value, format...).ptr;
    out.append(std::as_const(digits).data(), end);
}

// The shortest text that reads back as the same number. A NaN is written as its bits, for the sign and the payload.
void AppendFloat(UTF8String& out, float value)
{
    if (!std::isnan(value))
        return AppendNumber(out, value);
    out += kNaNPrefix;
    AppendNumber(out, std::bit_cast<std::uint32_t>(value), kNaNBase);
}

} // namespace

void PropListWriter::WriteDocument(const PropList& list)
{
    mOut += u8"<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<";
    mOut.append(kRootElement)
        .append(u8" ")
        .append(kFormatAttribute)
        .append(u8"=\"")
        .append(kFormat)
        .append(u8"\">\n");
    list.Visit(*this);
    Close(kRootElement);
}

void PropListWriter::VisitValue(const UTF8String& key, const UTF16String& value)
{
    Open(kUTF16Element, key);
    xml::AppendXmlText(mOut, value);
    Close(kUTF16Element);
}

void PropListWriter::VisitValue(const UTF8String& key, const UTF8String& value)
{
    Open(kUTF8Element, key);
    xml::AppendXmlText(mOut, value);
    Close(kUTF8Element);
}

void PropListWriter::VisitValue(const UTF8String& key, bool value)
{
    Open(kBoolElement, key);
    mOut += value ? kTrue : kFalse;
    Close(kBoolElement);
}

void PropListWriter::VisitValue(const UTF8String& key, unsigned int value)
{
    Open(kUnsignedElement, key);
    AppendNumber(mOut, value);
    Close(kUnsignedElement);
}

void PropListWriter::VisitValue(const UTF8String& key, int value)
{
    Open(kIntElement, key);
    AppendNumber(mOut, value);
    Close(kIntElement);
}

void PropListWriter::VisitValue(const UTF8String& key, float value)
{
    Open(kFloatElement, key);
    AppendFloat(mOut, value);
    Close(kFloatElement);
}

void PropListWriter::VisitValue(const UTF8String& key, const std::list<float>& value)
{
    Open(kFloatsElement, key);
    std::u8string_view separator;
    for (const float number : value)
    {
        mOut += separator;
        AppendFloat(mOut, number);
        separator = u8" ";
    }
    Close(kFloatsElement);
}

void PropListWriter::VisitSubList(const UTF8String& key, const PropList& subList)
{
    Open(kListElement, key);
    mOut += u8'\n';
    PropListWriter writer(mOut, mDepth + 1, mDrain);
    subList.Visit(writer);
    Indent();
    Close(kListElement);
}

void PropListWriter::Open(std::u8string_view element, const UTF8String& key)
{
    Indent();
    mOut.append(u8"<").append(element).append(u8" ").append(kKeyAttribute).append(u8"=\"");
    xml::AppendXmlText(mOut, key);
    mOut += u8"\">";
}

void PropListWriter::Close(std::u8string_view element)
{
    mOut.append(u8"</").append(element).append(u8">\n");
    if (mDrain == nullptr || mOut.size() < kLongText)
        return;
    (*mDrain)(mOut);
    mOut.clear();
}

void PropListWriter::Indent()
{
    mOut.append(2 * (mDepth + 1), u8' ');
}

} // namespace zebcore::proplist
