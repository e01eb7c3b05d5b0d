#include "foundation/zebcore/XmlUtils.h"

#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/internal/XmlText.h"

namespace zebcore::xml::utils
{

void EncodeReservedCharacters(const UTF16String& in, UTF16String& out)
{
    UTF8String text;
    AppendXmlText(text, in);
    out = utility::UTF8to16(text);
}

} // namespace zebcore::xml::utils
