#include "host/src/FilterIDLookup.h"

#include "foundation/zebcore/StringStreams.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/TechnologyType.h"

namespace zebaudiofilterhost
{

namespace
{

UTF16String WithTechnology(TechnologyType type, const UTF16String& id)
{
    zebcore::utility::oUTF16StringStream stream;
    stream << static_cast<int>(type);
    return stream.str() + u":" + id;
}

} // namespace

boost::intrusive_ptr<AudioFilterDescriptor> FindDescriptorForFilterID(const UTF16String& id)
{
    const AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    boost::intrusive_ptr<AudioFilterDescriptor> descriptor = manager.GetComponentDescriptorForID(id);
    for (const TechnologyType type : {kTechnologyAudioUnit, kTechnologyVST})
    {
        if (descriptor)
        {
            break;
        }
        descriptor = manager.GetComponentDescriptorForID(WithTechnology(type, id));
    }
    return descriptor;
}

} // namespace zebaudiofilterhost
