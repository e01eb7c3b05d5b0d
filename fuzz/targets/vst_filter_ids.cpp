// The text of a VST 2 effect's number.
#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/src/VST/src/VSTFilterID.h"

#include <string>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

constexpr unsigned int kUnread = 0xDEADBEEF;

unsigned int Decoded(const UTF16String& text)
{
    unsigned int number = kUnread;
    vst::DecodeFilterID(text, number);
    return number;
}

void Run(Bytes bytes)
{
    const UTF16String text = zebcore::utility::UTF8to16(TextOf(bytes));
    const unsigned int number = Decoded(text);
    Expect(Decoded(vst::EncodeFilterID(number, text)) == number, "the title does not touch the number");
    const UTF16String encoded = vst::EncodeFilterID(number, u"/opt/vst/Title.so");
    Expect(encoded == u"2:" + zebcore::utility::UTF16FromNarrow(std::to_string(number)) + u" Title",
           "an ID has one text");
    Expect(text.find(u':') != UTF16String::npos || text.empty() || Decoded(u"2:" + text) == number,
           "an ID means the same with its technology in front");
}

const Target kTarget("vst_filter_ids", Run);

} // namespace
