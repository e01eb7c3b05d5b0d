#include "foundation/zebcore/Error.h"

#include "foundation/zebcore/StringConversion.h"

#include <utility>

namespace zebcore::config
{

Error::Error(ErrorLevel level, UTF16String message, unsigned int code, int subCode, bool flag)
    : std::runtime_error(utility::NarrowFromUTF16(message))
    , mLevel(level)
    , mMessage(std::move(message))
    , mCode(code)
    , mSubCode(subCode)
    , mFlag(flag)
{
}

Error::Error(const Error& other) = default;
Error& Error::operator=(const Error& other) = default;
Error::~Error() = default;

} // namespace zebcore::config
