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

// The entries of a series in the order of their indices.
class SeriesCollector : public zebcore::proplist::PropListVisitor
{
public:
    struct Entry
    {
        std::size_t mIndex;
        const PropList* mSubList; // null for a value
    };

    SeriesCollector(const UTF8String& base, std::size_t limit) : mBase(base), mLimit(limit) {}

    using PropListVisitor::VisitValue;
    void VisitValue(const UTF8String& key, const UTF16String&) override { Collect(key, nullptr); }
    void VisitSubList(const UTF8String& key, const PropList& subList) override { Collect(key, &subList); }

    std::vector<Entry> TakeSorted()
    {
        std::sort(mEntries.begin(), mEntries.end(),
                  [](const Entry& left, const Entry& right) { return left.mIndex < right.mIndex; });
        return std::move(mEntries);
    }

private:
    void Collect(const UTF8String& key, const PropList* subList)
    {
        const std::optional<std::size_t> index = ParseIndex(key, mBase);
        if (index && *index < mLimit)
        {
            mEntries.push_back({*index, subList});
        }
    }

    const UTF8String& mBase;
    std::size_t mLimit;
    std::vector<Entry> mEntries;
};

std::vector<SeriesCollector::Entry> CollectSeries(const PropList& list, const UTF8String& base, int count)
{
    if (count < 1)
    {
        return {};
    }
    SeriesCollector collector(base, static_cast<std::size_t>(count));
    list.Visit(collector);
    return collector.TakeSorted();
}

} // namespace

UTF8String IndexedKey(const UTF8String& base, std::size_t index)
{
    std::array<char, kMaxDigits> digits{};
    const auto [end, error] = std::to_chars(digits.data(), digits.data() + digits.size(), index);
    return base + UTF8String(digits.data(), end);
}

std::vector<std::size_t> PresentIndices(const PropList& list, const UTF8String& base, int count)
{
    std::vector<std::size_t> indices;
    for (const SeriesCollector::Entry& entry : CollectSeries(list, base, count))
    {
        indices.push_back(entry.mIndex);
    }
    return indices;
}

std::vector<const PropList*> PresentSubLists(const PropList& list, const UTF8String& base, int count)
{
    std::vector<const PropList*> subLists;
    for (const SeriesCollector::Entry& entry : CollectSeries(list, base, count))
    {
        if (entry.mSubList != nullptr)
        {
            subLists.push_back(entry.mSubList);
        }
    }
    return subLists;
}

} // namespace zebaudiofilterhost
