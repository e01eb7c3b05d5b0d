#include "render/SeparatedLine.h"

#include "output/Strings.h"

namespace zebhost
{

std::vector<std::string> SplitSeparatedLine(const std::string& line)
{
    const char separator = line.find('\t') == std::string::npos ? ',' : '\t';
    std::vector<std::string> fields(1);
    bool quoted = false;
    for (std::size_t at = 0; at < line.size(); ++at)
    {
        const char letter = line[at];
        if (letter == '"' && quoted && at + 1 < line.size() && line[at + 1] == '"')
        {
            fields.back() += letter;
            ++at;
        }
        else if (letter == '"')
        {
            quoted = !quoted;
        }
        else if (letter == separator && !quoted)
        {
            fields.emplace_back();
        }
        else
        {
            fields.back() += letter;
        }
    }
    for (std::string& field : fields)
    {
        field = std::string(Trimmed(field));
    }
    return fields;
}

} // namespace zebhost
