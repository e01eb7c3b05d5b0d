#pragma once

#include "foundation/zebcore/Error.h"
#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <utility>

namespace zebcore::config
{

/// Text for one of the places "%1" to "%4" of a message. An empty one leaves its place as it stands.
class ReplacementValue
{
public:
    ReplacementValue() = default;
    explicit ReplacementValue(UTF16String text) : mText(std::move(text)) {}

    const UTF16String& GetText() const { return mText; }

private:
    UTF16String mText;
};

/// Raises an Error. message: a localisable text, see Localizer; not null. [main]
[[noreturn]] ZEB_EXPORT void ThrowError(ErrorLevel level, const char* message, unsigned int code, int subCode,
                                        bool flag, const ReplacementValue& first, const ReplacementValue& second,
                                        const ReplacementValue& third, const ReplacementValue& fourth);

} // namespace zebcore::config
