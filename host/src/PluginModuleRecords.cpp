#include "host/src/PluginModuleRecords.h"

#include <algorithm>
#include <utility>

namespace zebaudiofilterhost
{

void PluginModuleRecords::Add(Pointer record)
{
    const std::size_t arrival = mNextArrival++;
    const PluginLocator& locator = record->GetLocator();
    const auto [entry, isNew] = mPlaces.try_emplace(locator, Place{record, arrival});
    if (!isNew)
    {
        LeaveGap(entry->second.arrival);
        // Under its own locator: an equal one may be spelt in another way.
        auto place = mPlaces.extract(entry);
        place.key() = locator;
        place.mapped() = Place{record, arrival};
        mPlaces.insert(std::move(place));
    }
    mInOrder.push_back(std::move(record));
    mArrivals.push_back(arrival);
}

PluginModuleRecords::Pointer PluginModuleRecords::Find(const PluginLocator& locator) const
{
    const auto found = mPlaces.find(locator);
    return found == mPlaces.end() ? Pointer() : found->second.record;
}

bool PluginModuleRecords::Remove(const PluginLocator& locator)
{
    const auto found = mPlaces.find(locator);
    if (found == mPlaces.end())
    {
        return false;
    }
    LeaveGap(found->second.arrival);
    mPlaces.erase(found);
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
    locators.reserve(mPlaces.size());
    for (const auto& [locator, place] : mPlaces)
    {
        locators.push_back(locator);
    }
    std::sort(locators.begin(), locators.end());
    return locators;
}

void PluginModuleRecords::LeaveGap(std::size_t arrival)
{
    const auto place = std::lower_bound(mArrivals.begin(), mArrivals.end(), arrival);
    mInOrder[static_cast<std::size_t>(place - mArrivals.begin())] = nullptr;
    ++mGaps;
    if (mGaps > mPlaces.size()) // Nobody looks, and the gaps must not pile up
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
