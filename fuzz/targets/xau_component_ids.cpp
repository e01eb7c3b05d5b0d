// The text of an Audio Unit's description.
#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/ByteSource.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/src/XAU/src/XAUComponentID.h"

#include <tuple>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

using Codes = std::tuple<OSType, OSType, OSType>;

Codes Decoded(const UTF16String& text)
{
    const AudioComponentDescription read = xau::DecodeComponentID(text);
    Expect(read.componentFlags == 0 && read.componentFlagsMask == 0, "an ID says nothing but the three codes");
    return {read.componentType, read.componentSubType, read.componentManufacturer};
}

UTF16String Encoded(const Codes& codes)
{
    const auto& [type, subType, manufacturer] = codes;
    return xau::EncodeComponentID({type, subType, manufacturer, 0, 0});
}

void Run(Bytes bytes)
{
    const UTF16String text = zebcore::utility::UTF8to16(TextOf(bytes));
    const Codes fromText = Decoded(text);
    Expect(Decoded(Encoded(fromText)) == fromText, "the description of any text has a text of its own");
    Expect(text.find(u':') != UTF16String::npos || text.empty() || Decoded(u"4:" + text) == fromText,
           "an ID means the same with its technology in front");

    ByteSource source(bytes);
    const Codes codes{source.Take<OSType>(), source.Take<OSType>(), source.Take<OSType>()}; // in this order
    Expect(Decoded(Encoded(codes)) == codes, "any description can be told");
}

const Target kTarget("xau_component_ids", Run);

} // namespace
