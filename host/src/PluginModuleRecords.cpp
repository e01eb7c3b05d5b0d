#include "host/src/PluginModuleRecords.h"

#include "foundation/zebcore/CompareFileNames.h"

#include <algorithm>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

bool IsSame(std::u16string_view left, std::u16string_view right)
{
    return std::ranges::equal(left, right); // == compares unit by unit
}

} // namespace

bool PluginModuleRecords::IsOf::operator()(std::u16string_view path, const Place& place) const
{
    PrefetchCounted(place.record.get());
    if (place.type != mLocator.mType)
    {
        return false;
    }
    return IsSame(path, mLocator.mPath) ||
           zebcore::filesupport::CompareFileNames(UTF16String(path), mLocator.mPath) == 0;
}

void PluginModuleRecords::Add(Pointer record)
{
    const std::size_t arrival = mNextArrival++;
    const PluginLocator& locator = record->GetLocator();
    const std::size_t hash = hash_value(locator);
    const Place place{record, arrival, locator.mType};
    const std::size_t known = mPlaces.Find(hash, IsOf(locator));
    if (known != Places::kNone && IsSame(mPlaces.TextAt(known), locator.mPath))
    {
        LeaveGap(mPlaces.ValueAt(known).arrival);
        mPlaces.ValueAt(known) = place;
    }
    else
    {
        Remove(locator); // It may be there, spelt in another way
        mPlaces.Add(hash, locator.mPath, place);
    }
    mInOrder.push_back(std::move(record));
    mArrivals.push_back(arrival);
}

PluginModuleRecords::Pointer PluginModuleRecords::Find(const PluginLocator& locator) const
{
    const std::size_t found = mPlaces.Find(hash_value(locator), IsOf(locator));
    return found == Places::kNone ? Pointer() : mPlaces.ValueAt(found).record;
}

bool PluginModuleRecords::Remove(const PluginLocator& locator)
{
    const std::size_t found = mPlaces.Find(hash_value(locator), IsOf(locator));
    if (found == Places::kNone)
    {
        return false;
    }
    LeaveGap(mPlaces.ValueAt(found).arrival);
    mPlaces.Remove(found);
    return true;
}

void PluginModuleRecords::Clear()
{
    *this = PluginModuleRecords();
}

const PluginModuleRecords::Vector& PluginModuleRecords::InOrder() const
{
    CloseGaps();
    return mInOrder;
}

std::vector<PluginLocator> PluginModuleRecords::Locators() const
{
    std::vector<PluginLocator> locators;
    locators.reserve(mPlaces.Size());
    mPlaces.ForEach([&locators](std::u16string_view path, const Place& place)
                    { locators.emplace_back(place.type, UTF16String(path)); });
    std::sort(locators.begin(), locators.end());
    return locators;
}

void PluginModuleRecords::LeaveGap(std::size_t arrival)
{
    const auto place = std::lower_bound(mArrivals.begin(), mArrivals.end(), arrival);
    mInOrder[static_cast<std::size_t>(place - mArrivals.begin())] = nullptr;
    ++mGaps;
    if (mGaps > mPlaces.Size()) // Nobody looks, and the gaps must not pile up
    {
        CloseGaps();
    }
}

void PluginModuleRecords::CloseGaps() const
{
    if (mGaps == 0)
    {
        return;
    }
    std::size_t kept = 0;
    for (std::size_t index = 0; index < mInOrder.size(); ++index)
    {
        if (mInOrder[index] != nullptr)
        {
            mInOrder[kept].swap(mInOrder[index]);
            mArrivals[kept] = mArrivals[index];
            ++kept;
        }
    }
    mInOrder.resize(kept);
    mArrivals.resize(kept);
    mGaps = 0;
}

} // namespace zebaudiofilterhost
