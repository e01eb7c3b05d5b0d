#include "foundation/zebcore/FileExceptions.h"

#include "foundation/zebcore/StringConversion.h"

#include <algorithm>
#include <string>
#include <system_error>

namespace zebcore::filesupport
{

namespace
{

// The sentence goes to logs and terminals, and ends at a zero unit.
std::string WithoutControls(std::string text)
{
    std::replace_if(
        text.begin(), text.end(), [](char unit) { return (unit >= 0 && unit < ' ') || unit == '\x7F'; }, '?');
    return text;
}

std::string Sentence(std::string_view action, const UTF16String& path, std::string_view reason)
{
    std::string sentence(action);
    sentence.append(" '").append(WithoutControls(utility::NarrowFromUTF16(path))).append("': ").append(reason);
    return sentence;
}

} // namespace

file_exception::file_exception(std::string_view action, const UTF16String& path, int error)
    : std::runtime_error(Sentence(action, path, std::generic_category().message(error))), mPath(path), mError(error)
{
}

file_exception::file_exception(std::string_view action, const UTF16String& path, std::string_view reason)
    : std::runtime_error(Sentence(action, path, reason)), mPath(path)
{
}

file_exception::~file_exception() = default;
file_delete_exception::~file_delete_exception() = default;

} // namespace zebcore::filesupport
