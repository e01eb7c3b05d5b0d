// The text of a VST 3 class ID.
#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <algorithm>
#include <array>
#include <cstring>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

using ClassID = std::array<Steinberg::int8, sizeof(Steinberg::TUID)>;

UTF16String Encoded(const ClassID& id)
{
    Steinberg::TUID classID;
    std::copy(id.begin(), id.end(), classID);
    return vst3::EncodeFilterID(classID);
}

ClassID Decoded(const UTF16String& text)
{
    Steinberg::TUID classID;
    std::memset(classID, 0x5A, sizeof(classID));
    vst3::DecodeFilterID(text, classID);
    return std::to_array(classID);
}

void Run(Bytes bytes)
{
    const UTF16String text = zebcore::utility::UTF8to16(TextOf(bytes));
    const ClassID fromText = Decoded(text);
    Expect(Decoded(Encoded(fromText)) == fromText, "the ID of any text has a text of its own");
    if (text.find(u':') == UTF16String::npos && !text.empty())
        Expect(Decoded(u"3:" + text) == fromText, "an ID means the same with its technology in front");

    ClassID id{};
    std::copy_n(bytes.begin(), std::min(bytes.size(), id.size()), id.begin());
    Expect(Decoded(Encoded(id)) == id, "any class ID can be told");
}

const Target kTarget("vst3_filter_ids", Run);

} // namespace
