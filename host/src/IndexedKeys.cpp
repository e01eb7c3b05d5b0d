#include "host/src/IndexedKeys.h"

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListVisitor.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

constexpr std::size_t kMaxDigits = std::numeric_limits<std::size_t>::digits10 + 1;

// The index of a key of the series, if the key is exactly what IndexedKey makes of it.
std::optional<std::size_t> ParseIndex(std::u8string_view key, std::u8string_view base)
{
    if (!key.starts_with(base) || key.size() - base.size() > kMaxDigits)
    {
        return std::nullopt;
    }
    const std::string digits(key.begin() + static_cast<std::ptrdiff_t>(base.size()), key.end());
    std::size_t index = 0;
    const char* const end = digits.data() + digits.size();
    const auto [stopped, error] = std::from_chars(digits.data(), end, index);
    const bool canonical = digits.size() == 1 || (!digits.empty() && digits.front() != '0');
    const bool parsed = error == std::errc() && stopped == end && canonical;
    return parsed ? std::optional<std::size_t>(index) : std::nullopt;
}

class IndexCollector : public zebcore::proplist::PropListVisitor
{
public:
    IndexCollector(const UTF8String& base, std::size_t limit) : mBase(base), mLimit(limit) {}

    using PropListVisitor::VisitValue;
    void VisitValue(const UTF8String& key, const UTF16String&) override { Collect(key); }
    void VisitSubList(const UTF8String& key, const PropList&) override { Collect(key); }

    std::vector<std::size_t> TakeSorted()
    {
        std::sort(mIndices.begin(), mIndices.end());
        return std::move(mIndices);
    }

private:
    void Collect(const UTF8String& key)
    {
        const std::optional<std::size_t> index = ParseIndex(key, mBase);
        if (index && *index < mLimit)
        {
            mIndices.push_back(*index);
        }
    }

    const UTF8String& mBase;
    std::size_t mLimit;
    std::vector<std::size_t> mIndices;
};

} // namespace

UTF8String IndexedKey(const UTF8String& base, std::size_t index)
{
    std::array<char, kMaxDigits> digits{};
    const auto [end, error] = std::to_chars(digits.data(), digits.data() + digits.size(), index);
    return base + UTF8String(digits.data(), end);
}

std::vector<std::size_t> PresentIndices(const PropList& list, const UTF8String& base, int count)
{
    if (count < 1)
    {
        return {};
    }
    IndexCollector collector(base, static_cast<std::size_t>(count));
    list.Visit(collector);
    return collector.TakeSorted();
}

} // namespace zebaudiofilterhost
