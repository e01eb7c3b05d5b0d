#pragma once

#include "host/PluginLocator.h"
#include "host/PluginModuleInfo.h"
#include "host/src/TextTable.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <cstddef>
#include <string_view>
#include <vector>

namespace zebaudiofilterhost
{

// The records of the catalogue: one for each locator, in order of arrival. Entering, replacing and finding one takes
// the same time in a catalogue of any size.
class PluginModuleRecords
{
public:
    using Pointer = boost::intrusive_ptr<PluginModuleInfo>;
    using Vector = std::vector<Pointer>;

    // Takes the place of the record of the same locator, and stands last.
    void Add(Pointer record);
    // Null if there is none.
    Pointer Find(const PluginLocator& locator) const;
    // False if there is none.
    bool Remove(const PluginLocator& locator);
    void Clear();

    // Every change invalidates it.
    const Vector& InOrder() const;
    // Sorted by locator.
    std::vector<PluginLocator> Locators() const;

private:
    struct Place
    {
        Pointer record;
        std::size_t arrival = 0;
        TechnologyType type = kTechnologyNone;
    };

    using Places = TextTable<Place>;

    // Whether an entry of mPlaces is that of a locator.
    class IsOf
    {
    public:
        explicit IsOf(const PluginLocator& locator) : mLocator(locator) {}
        bool operator()(std::u16string_view path, const Place& place) const;

    private:
        const PluginLocator& mLocator;
    };

    void LeaveGap(std::size_t arrival);
    void CloseGaps() const;

    Places mPlaces; // by path
    // A record that goes leaves a null pointer, and all gaps are closed at once when somebody wants to see the order.
    mutable Vector mInOrder;
    mutable std::vector<std::size_t> mArrivals; // of mInOrder's records, ascending
    mutable std::size_t mGaps = 0;
    std::size_t mNextArrival = 0;
};

} // namespace zebaudiofilterhost
