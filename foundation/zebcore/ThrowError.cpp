#include "foundation/zebcore/ThrowError.h"

#include "foundation/zebcore/Localizer.h"

#include <string_view>

namespace zebcore::config
{

namespace
{

void Replace(UTF16String& message, std::u16string_view place, const UTF16String& text)
{
    if (text.empty())
        return;
    for (std::size_t at = message.find(place); at != UTF16String::npos; at = message.find(place, at + text.size()))
        message.replace(at, place.size(), text);
}

} // namespace

void ThrowError(ErrorLevel level, const char* message, unsigned int code, int subCode, bool flag,
                const ReplacementValue& first, const ReplacementValue& second, const ReplacementValue& third,
                const ReplacementValue& fourth)
{
    UTF16String text = Localizer::Get().Localize(std::string_view(message));
    Replace(text, u"%1", first.GetText());
    Replace(text, u"%2", second.GetText());
    Replace(text, u"%3", third.GetText());
    Replace(text, u"%4", fourth.GetText());
    throw Error(level, text, code, subCode, flag);
}

} // namespace zebcore::config
