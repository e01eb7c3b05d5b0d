#pragma once

#include "foundation/zebcore/Export.h"
#include "host/AudioFilterDescriptor.h"
#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <map>
#include <memory>
#include <vector>

namespace zebaudiofilterhost
{

template <typename Value>
class TextTable;

/// The list of all filters that the application can offer, whether or not their plug-ins are loaded. IDs compare as
/// plain code units. All operations: [main]
class ZEB_EXPORT AudioFilterDescriptorManager
{
public:
    using DescriptorPtr = boost::intrusive_ptr<AudioFilterDescriptor>;
    using DescriptorVector = std::vector<DescriptorPtr>;
    using DescriptorMap = std::map<UTF16String, DescriptorPtr>;
    using Iterator = DescriptorVector::const_iterator;

    /// Lives until process exit.
    static AudioFilterDescriptorManager& GetInstance();

    AudioFilterDescriptorManager(const AudioFilterDescriptorManager&) = delete;
    AudioFilterDescriptorManager& operator=(const AudioFilterDescriptorManager&) = delete;

    /// Appends it; an object that is there already moves to the end. A new object with a known ID stands in the list
    /// too, but look-up goes on returning the old one until that is removed. Null is ignored.
    void AddAudioFilterDescriptor(DescriptorPtr descriptor);
    /// Null if there is none. A legacy ID stands for its current ID, even if a descriptor bears the legacy ID itself.
    DescriptorPtr GetComponentDescriptorForID(const UTF16String& id) const;
    /// The first mapping of a legacy ID stays. Mappings are not chained.
    void AddLegacyToCurrentIDMapping(const UTF16String& legacy, const UTF16String& current);

    /// All descriptors in order of arrival. Every change of the catalogue invalidates the iterators.
    Iterator InfoBegin() const;
    Iterator InfoEnd() const;
    DescriptorVector GetInternalInfos() const;
    DescriptorVector GetExternalInfos() const;

    void ClearExternalInfos();
    /// Removes the descriptors of one plug-in binary. Two descriptors with one ID collapse to the first in look-up.
    void ClearInfosForLocator(const PluginLocator& locator);
    /// The same for many binaries in one pass.
    void ClearInfosForLocators(const std::vector<PluginLocator>& locators);

    /// With `merge` the list's descriptors are added, and a known ID keeps its present descriptor. Without, they
    /// replace all external ones, also when the list holds none. Reports no error.
    void ReadExternalComponentDescriptors(const PropList& list, bool merge);
    void WriteExternalComponentDescriptors(PropList& list) const;

    /// Of two descriptors with one ID the first stays.
    DescriptorMap BuildComponentDescriptorMap(const DescriptorVector& descriptors) const;

private:
    using DescriptorIndex = TextTable<DescriptorPtr>; // by ID

    AudioFilterDescriptorManager();
    ~AudioFilterDescriptorManager();

    DescriptorVector mDescriptors;
    std::unique_ptr<DescriptorIndex> mDescriptorIndex; // never null
    std::map<UTF16String, UTF16String> mLegacyToCurrentID;
};

} // namespace zebaudiofilterhost
