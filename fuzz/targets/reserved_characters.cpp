// The escaped form of a text is how the text stands in a serialised list, and leads back to it.
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/XmlUtils.h"
#include "fuzz/support/ByteSource.h"
#include "fuzz/support/Target.h"

namespace
{

using namespace zebfuzz;
using namespace zebcore;

UTF16String UnitsOf(Bytes bytes)
{
    UTF16String text;
    for (ByteSource source(bytes); !source.IsEmpty();)
        text += source.Take<char16_t>();
    return text;
}

void CheckEscaping(const UTF16String& text)
{
    UTF16String encoded = u"stale";
    xml::utils::EncodeReservedCharacters(text, encoded);
    Expect(encoded.find_first_of(u"<>\"'\t\n\r") == UTF16String::npos, "no reserved character is left");

    proplist::PropList list;
    list.SetValue(u8"key", text);
    UTF8String written;
    proplist::utils::WritePropList(written, list);
    const UTF8String run = utility::UTF16to8(encoded);
    Expect(utility::UTF8to16(run) == encoded, "the escaped form is well-formed Unicode");
    Expect(written.find(u8">" + run + u8"<") != UTF8String::npos, "a value stands escaped as one run");

    proplist::PropList again;
    UTF16String read = u"stale";
    Expect(proplist::utils::ReadPropList(u8"<proplist format='1'><text key='key'>" + run + u8"</text></proplist>",
                                         again),
           "the escaped form can stand in a list");
    Expect(again.GetValue(u8"key", read) && read == text, "the escaped form leads back to the text");
}

void CheckConversion(std::u8string_view text)
{
    utility::UnicodeErrorCode error{};
    const UTF16String wide = utility::UTF8to16(text, &error);
    const UTF8String narrow = utility::UTF16to8(wide);
    Expect(utility::UTF8to16(narrow) == wide, "repaired text converts both ways");
    Expect((error == utility::kUnicodeError_None) == (narrow == text),
           "ill-formed text, and no other, is told and changed");
}

void Run(Bytes bytes)
{
    const UTF8String text(bytes.begin(), bytes.end());
    CheckEscaping(UnitsOf(bytes));
    CheckEscaping(utility::UTF8to16(text));
    CheckConversion(text);
}

const Target kTarget("reserved_characters", Run);

} // namespace
