#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <stdexcept>

namespace zebcore::config
{

/// How bad an error is; 0 is a fault of the program.
using ErrorLevel = int;

/// What ThrowError raises. what() is the message in UTF-8.
class ZEB_EXPORT Error : public std::runtime_error
{
public:
    Error(ErrorLevel level, UTF16String message, unsigned int code, int subCode, bool flag);
    Error(const Error& other);
    Error& operator=(const Error& other);
    ~Error() override;

    ErrorLevel GetLevel() const { return mLevel; }
    /// In the user's language.
    const UTF16String& GetMessageText() const { return mMessage; }
    unsigned int GetCode() const { return mCode; }
    int GetSubCode() const { return mSubCode; }
    bool GetFlag() const { return mFlag; }

private:
    ErrorLevel mLevel;
    UTF16String mMessage;
    unsigned int mCode;
    int mSubCode;
    bool mFlag;
};

} // namespace zebcore::config
