#include "host/PluginLocator.h"

#include "foundation/zebcore/CompareFileNames.h"
#include "foundation/zebcore/StringStreams.h"

#include <array>
#include <charconv>
#include <limits>
#include <string_view>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

constexpr char16_t kSeparator = u':';

// Every technology there is has a number of one digit. A stream costs more than all the rest of a locator.
bool IsOneDigit(std::u16string_view text)
{
    return text.size() == 1 && text.front() >= u'0' && text.front() <= u'9';
}

TechnologyType ParseTechnologyType(const UTF16String& text)
{
    if (IsOneDigit(text))
    {
        return static_cast<TechnologyType>(text.front() - u'0');
    }
    zebcore::utility::iUTF16StringStream stream(text);
    long value = 0;
    if (!(stream >> value))
    {
        return kTechnologyNone;
    }
    using Limits = std::numeric_limits<std::int32_t>;
    const bool fits = value >= Limits::min() && value <= Limits::max();
    return fits ? static_cast<TechnologyType>(value) : kTechnologyNone;
}

} // namespace

PluginLocator::PluginLocator() = default;

PluginLocator::PluginLocator(TechnologyType type, const UTF16String& path) : mType(type), mPath(path)
{
}

PluginLocator::PluginLocator(const PluginLocator& other) = default;

PluginLocator& PluginLocator::operator=(const PluginLocator& other)
{
    PluginLocator copy(other);
    Swap(copy);
    return *this;
}

PluginLocator::~PluginLocator() = default;

void PluginLocator::Swap(PluginLocator& other) noexcept
{
    std::swap(mType, other.mType);
    mPath.swap(other.mPath);
}

bool PluginLocator::operator<(const PluginLocator& other) const
{
    if (mType != other.mType)
    {
        return mType < other.mType;
    }
    return zebcore::filesupport::CompareFileNames(mPath, other.mPath) < 0;
}

bool PluginLocator::operator==(const PluginLocator& other) const
{
    return mType == other.mType && zebcore::filesupport::CompareFileNames(mPath, other.mPath) == 0;
}

bool PluginLocator::operator!=(const PluginLocator& other) const
{
    return !(*this == other);
}

std::size_t hash_value(const PluginLocator& locator)
{
    return zebcore::filesupport::HashFileName(locator.mPath) ^ static_cast<std::size_t>(locator.mType);
}

TechnologyType PluginLocator::GetTechnologyType() const
{
    return mType;
}

UTF16String PluginLocator::GetPath() const
{
    return mPath;
}

UTF16String PluginLocator::ToString() const
{
    std::array<char, std::numeric_limits<std::int32_t>::digits10 + 2> number{};
    const char* const end =
        std::to_chars(number.data(), number.data() + number.size(), static_cast<std::int32_t>(mType)).ptr;
    UTF16String text;
    text.reserve(number.size() + 1 + mPath.size());
    text.append(std::as_const(number).data(), end).append(1, kSeparator).append(mPath);
    return text;
}

void PluginLocator::FromString(const UTF16String& text)
{
    PluginLocator parsed;
    // Only the first colon separates: a path may hold more.
    const std::size_t colon = text.find(kSeparator);
    if (colon != UTF16String::npos)
    {
        parsed.mType = ParseTechnologyType(text.substr(0, colon));
        parsed.mPath = text.substr(colon + 1);
    }
    Swap(parsed);
}

} // namespace zebaudiofilterhost
