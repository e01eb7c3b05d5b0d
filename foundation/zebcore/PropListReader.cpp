#include "foundation/zebcore/internal/PropListReader.h"

#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/internal/PropListXml.h"
#include "foundation/zebcore/internal/XmlText.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <cstdint>
#include <limits>
#include <utility>

namespace zebcore::proplist
{

namespace
{

constexpr std::u8string_view kBlanks = u8" \t\r\n";

// Succeeds for the whole text only. `format` is a base or a std::chars_format.
template <typename T, typename... Format>
bool ParseNumber(std::u8string_view text, T& value, Format... format)
{
    const char* const begin = reinterpret_cast<const char*>(text.data());
    const char* const end = begin + text.size();
    const auto [stop, error] = std::from_chars(begin, end, value, format...);
    return error == std::errc() && stop == end;
}

bool ParseFloat(std::u8string_view text, float& value)
{
    static_assert(std::numeric_limits<float>::is_iec559);
    if (!text.starts_with(kNaNPrefix))
        return ParseNumber(text, value);
    std::uint32_t bits = 0;
    if (!ParseNumber(text.substr(kNaNPrefix.size()), bits, kNaNBase))
        return false;
    value = std::bit_cast<float>(bits);
    return true;
}

bool SetUTF16(PropList& list, const UTF8String& key, UTF8String& text)
{
    UTF16String value;
    xml::UnescapeXmlText(text, value);
    list.SetValue(key, std::move(value));
    return true;
}

// What holds no escape may be long, and goes on as it is.
bool SetUTF8(PropList& list, const UTF8String& key, UTF8String& text)
{
    UTF8String value;
    if (text.find(u8'\\') == UTF8String::npos)
        value.swap(text);
    else
        xml::UnescapeXmlText(text, value);
    list.SetValue(key, std::move(value));
    return true;
}

bool SetBool(PropList& list, const UTF8String& key, UTF8String& text)
{
    list.SetValue(key, text == kTrue);
    return text == kTrue || text == kFalse;
}

template <typename T>
bool SetInteger(PropList& list, const UTF8String& key, UTF8String& text)
{
    T value = 0;
    const bool isNumber = ParseNumber(text, value);
    list.SetValue(key, value);
    return isNumber;
}

bool SetFloat(PropList& list, const UTF8String& key, UTF8String& text)
{
    float value = 0;
    const bool isNumber = ParseFloat(text, value);
    list.SetValue(key, value);
    return isNumber;
}

bool SetFloats(PropList& list, const UTF8String& key, UTF8String& whole)
{
    const std::u8string_view text = whole;
    std::list<float> values;
    for (std::size_t begin = text.find_first_not_of(kBlanks); begin != std::u8string_view::npos;)
    {
        const std::size_t end = std::min(text.find_first_of(kBlanks, begin), text.size());
        if (!ParseFloat(text.substr(begin, end - begin), values.emplace_back()))
            return false;
        begin = text.find_first_not_of(kBlanks, end);
    }
    list.SetValue(key, values);
    return true;
}

bool IsBlank(char8_t unit)
{
    return unit == u8' ' || unit == u8'\t' || unit == u8'\r' || unit == u8'\n';
}

const xml::XmlAttribute* Find(const std::vector<xml::XmlAttribute>& attributes, std::u8string_view name)
{
    const auto found = std::find_if(attributes.begin(), attributes.end(),
                                    [name](const xml::XmlAttribute& attribute) { return attribute.mName == name; });
    return found == attributes.end() ? nullptr : &*found;
}

} // namespace

const PropListReader::ValueElement PropListReader::kValueElements[] = {
    {kUTF16Element, SetUTF16},      {kUTF8Element, SetUTF8},
    {kBoolElement, SetBool},        {kUnsignedElement, SetInteger<unsigned int>},
    {kIntElement, SetInteger<int>}, {kFloatElement, SetFloat},
    {kFloatsElement, SetFloats},
};

bool PropListReader::OnStartElement(const xml::XmlName& name, const std::vector<xml::XmlAttribute>& attributes)
{
    if (mOpenLists.empty())
        return StartRoot(name, attributes);
    const xml::XmlAttribute* const key = Find(attributes, kKeyAttribute);
    if (mOpenValue != nullptr || key == nullptr)
        return false;
    xml::UnescapeXmlText(key->mValue, mKey);
    return name.mQualified == kListElement ? StartSubList() : StartValue(name.mQualified);
}

bool PropListReader::OnEndElement(const xml::XmlName& /*name*/)
{
    if (mOpenValue == nullptr)
    {
        mOpenLists.pop_back();
        return true;
    }
    const ValueElement& value = *std::exchange(mOpenValue, nullptr);
    return value.mSet(*mOpenLists.back(), mKey, mText);
}

bool PropListReader::OnCharacters(std::u8string_view text)
{
    if (mOpenValue == nullptr)
        return std::all_of(text.begin(), text.end(), IsBlank);
    mText += text;
    return true;
}

bool PropListReader::StartRoot(const xml::XmlName& name, const std::vector<xml::XmlAttribute>& attributes)
{
    const xml::XmlAttribute* const format = Find(attributes, kFormatAttribute);
    mOpenLists.push_back(&mTarget);
    return name.mQualified == kRootElement && format != nullptr && format->mValue == kFormat;
}

bool PropListReader::StartSubList()
{
    if (mOpenLists.size() > utils::kMaxListDepth)
        return false;
    PropList& subList = mOpenLists.back()->GetOrCreateSubList(mKey);
    subList.Clear(); // of two with one key the later one counts, as with values
    mOpenLists.push_back(&subList);
    return true;
}

bool PropListReader::StartValue(std::u8string_view name)
{
    const auto* const found = std::find_if(std::begin(kValueElements), std::end(kValueElements),
                                           [name](const ValueElement& element) { return element.mName == name; });
    if (found == std::end(kValueElements))
        return false;
    mOpenValue = found;
    mText.clear();
    return true;
}

} // namespace zebcore::proplist
