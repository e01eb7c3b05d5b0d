#include "audio/SoundFile.h"

#include <algorithm>
#include <regex>
#include <string_view>
#include <vector>

namespace zebhost
{

std::string SoundFileError(SNDFILE* file)
{
    const int code = sf_error(file);
    if (code <= SF_ERR_NO_ERROR)
    {
        return code == SF_ERR_NO_ERROR ? "" : "unknown error";
    }
    std::string_view text = sf_strerror(file);
    for (const std::string_view start : {"System error : ", "Error : "})
    {
        text.remove_prefix(text.starts_with(start) ? start.size() : 0);
    }
    while (text.ends_with('.') || text.ends_with(' '))
    {
        text.remove_suffix(1);
    }
    return std::string(text);
}

bool HeadTellsMore(SNDFILE* file)
{
    constexpr unsigned long long kPlaceholder = 0x7FFF0000; // and above: written by programs that cannot go back
    static const std::regex sPattern(R"(: (\d{1,18}) \(should be (\d{1,18})\))");
    std::vector<char> log(16384);
    sf_command(file, SFC_GET_LOG_INFO, log.data(), static_cast<int>(log.size()));
    const std::string text(log.data());
    return std::any_of(std::sregex_iterator(text.begin(), text.end(), sPattern), std::sregex_iterator(),
                       [](const std::smatch& match)
                       {
                           const unsigned long long told = std::stoull(match[1]);
                           return told > std::stoull(match[2]) && told < kPlaceholder;
                       });
}

} // namespace zebhost
