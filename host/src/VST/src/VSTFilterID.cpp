#include "host/src/VST/src/VSTFilterID.h"

#include "foundation/zebcore/StringStreams.h"
#include "host/TechnologyType.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/FilterIDPrefix.h"

namespace zebaudiofilterhost::vst
{

UTF16String EncodeFilterID(unsigned int uniqueID, const UTF16String& path)
{
    zebcore::utility::oUTF16StringStream stream;
    stream << static_cast<int>(kTechnologyVST) << ":" << uniqueID << " ";
    return stream.str() + File(path).GetTitle();
}

void DecodeFilterID(const UTF16String& filterID, unsigned int& uniqueID)
{
    zebcore::utility::iUTF16StringStream stream(WithoutTechnologyPrefix(filterID));
    unsigned int number = 0; // streams write 0 on failure
    if (stream >> number)
        uniqueID = number;
}

Guid GetVSTFactoryGuid()
{
    static const Guid sGuid(0xe84e3bdd, 0xb4e2, 0x416c, 0x8b, 0x6d, 0x5c, 0x0d, 0xd7, 0x6d, 0x19, 0x7f);
    return sGuid;
}

} // namespace zebaudiofilterhost::vst
