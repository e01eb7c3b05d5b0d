#pragma once

#include <string>
#include <string_view>

namespace zebhost
{

// A file name that holds any text, and gives it back: what a file system or a shell could stumble over stands as a
// percent sign and two hexadecimal digits.
std::string EncodeFileName(std::string_view text);
std::string DecodeFileName(std::string_view name);

} // namespace zebhost
