#include "foundation/zebcore/FileExceptions.h"

#include "foundation/zebcore/StringConversion.h"

#include <string>
#include <system_error>

namespace zebcore::filesupport
{

namespace
{

std::string Sentence(std::string_view action, const UTF16String& path, std::string_view reason)
{
    std::string sentence(action);
    sentence.append(" '").append(utility::NarrowFromUTF16(path)).append("': ").append(reason);
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
