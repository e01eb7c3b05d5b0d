#include "host/src/VST3/src/VST3FilterID.h"

#include "foundation/zebcore/StringStreams.h"
#include "host/TechnologyType.h"
#include "host/VST3/VST3Technology.h"
#include "host/src/FilterIDPrefix.h"

#include <cstdint>
#include <iomanip>

namespace zebaudiofilterhost::vst3
{

namespace
{

// 0 for what cannot be read.
std::uint32_t ReadWord(zebcore::utility::iUTF16StringStream& stream)
{
    std::uint32_t word = 0;
    return stream >> word ? word : 0;
}

} // namespace

UTF16String EncodeFilterID(const Steinberg::TUID classID)
{
    const Steinberg::FUID id = Steinberg::FUID::fromTUID(classID);
    zebcore::utility::oUTF16StringStream stream;
    stream << static_cast<int>(kTechnologyVST3) << ":" << std::hex << std::setfill('0');
    // The width holds for the first word only; IDs in settings and presets have that form.
    stream << std::setw(8) << id.getLong1() << " " << id.getLong2() << " " << id.getLong3() << " " << id.getLong4();
    return stream.str();
}

void DecodeFilterID(const UTF16String& filterID, Steinberg::TUID classID)
{
    zebcore::utility::iUTF16StringStream stream(WithoutTechnologyPrefix(filterID));
    stream >> std::hex;
    const std::uint32_t word1 = ReadWord(stream);
    const std::uint32_t word2 = ReadWord(stream);
    const std::uint32_t word3 = ReadWord(stream);
    const std::uint32_t word4 = ReadWord(stream);
    Steinberg::FUID id;
    id.from4Int(word1, word2, word3, word4);
    id.toTUID(classID);
}

Guid GetVST3FactoryGuid()
{
    static const Guid sGuid(0xeb0fed8b, 0x7841, 0x4f2b, 0xa6, 0x55, 0xd8, 0xcd, 0xde, 0xa9, 0xf4, 0x65);
    return sGuid;
}

} // namespace zebaudiofilterhost::vst3
