#include "output/Strings.h"

#include <algorithm>

namespace zebhost
{

namespace
{

constexpr std::string_view kBlanks = " \t\r\n\v\f";

char Lower(char letter)
{
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

} // namespace

std::string_view Trimmed(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == std::string_view::npos)
    {
        return {};
    }
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string Lowered(std::string_view text)
{
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), Lower);
    return result;
}

bool EqualIgnoringCase(std::string_view a, std::string_view b)
{
    return Lowered(a) == Lowered(b);
}

bool ContainsIgnoringCase(std::string_view text, std::string_view part)
{
    return Lowered(text).find(Lowered(part)) != std::string::npos;
}

bool StartsWithIgnoringCase(std::string_view text, std::string_view start)
{
    return EqualIgnoringCase(text.substr(0, start.size()), start);
}

std::vector<std::string> Split(std::string_view text, char separator)
{
    std::vector<std::string> pieces;
    while (true)
    {
        const std::size_t end = text.find(separator);
        pieces.emplace_back(text.substr(0, end));
        if (end == std::string_view::npos)
        {
            return pieces;
        }
        text.remove_prefix(end + 1);
    }
}

std::string InOneLine(std::string text)
{
    constexpr unsigned char kDelete = 0x7F;
    std::replace_if(
        text.begin(), text.end(),
        [](char letter)
        {
            const auto byte = static_cast<unsigned char>(letter);
            return byte < ' ' || byte == kDelete;
        },
        ' ');
    return text;
}

std::string Joined(const std::vector<std::string>& pieces, std::string_view separator)
{
    std::string result;
    for (std::size_t index = 0; index < pieces.size(); ++index)
    {
        result.append(index == 0 ? std::string_view() : separator).append(pieces[index]);
    }
    return result;
}

std::string Counted(std::size_t count, std::string_view noun)
{
    return std::to_string(count) + " " + std::string(noun) + (count == 1 ? "" : "s");
}

} // namespace zebhost
