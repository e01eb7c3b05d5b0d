// The text form of bytes in presets, both ways.
#include "foundation/zebcore/BinaryText.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"

#include <algorithm>

namespace
{

using namespace zebfuzz;
using namespace zebcore::utility;

void Run(Bytes bytes)
{
    zebcore::UTF8String encoded;
    std::vector<unsigned char> decoded;
    Expect(EncodeBinaryDataToUTF8String(bytes.data(), bytes.size(), encoded), "any bytes can be encoded");
    Expect(DecodeBinaryDataFromUTF8String(encoded, decoded), "what was encoded can be decoded");
    Expect(std::equal(decoded.begin(), decoded.end(), bytes.begin(), bytes.end()), "bytes come back");

    const zebcore::UTF8String text = TextOf(bytes);
    const bool accepted = DecodeBinaryDataFromUTF8String(text, decoded);
    Expect(accepted || decoded.empty(), "a text that is refused gives no bytes");
    Expect(!accepted || (EncodeBinaryDataToUTF8String(decoded.data(), decoded.size(), encoded) && encoded == text),
           "bytes have one text");
}

const Target kTarget("binary_text", Run);

} // namespace
