#include "output/TextTable.h"

#include "output/Strings.h"

#include <algorithm>
#include <utility>

namespace zebhost
{

namespace
{

// Code points, which is what most terminals give one place each.
std::size_t Places(const std::string& text)
{
    return static_cast<std::size_t>(std::count_if(
        text.begin(), text.end(), [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0) != 0x80; }));
}

std::string Line(const std::vector<std::string>& cells, const std::vector<std::size_t>& widths)
{
    std::string line;
    for (std::size_t column = 0; column < cells.size(); ++column)
    {
        line += cells[column];
        if (column + 1 < cells.size())
        {
            line.append(widths[column] - Places(cells[column]) + 2, ' ');
        }
    }
    line.erase(line.find_last_not_of(' ') + 1);
    return line;
}

} // namespace

TextTable::TextTable(std::vector<std::string> headings) : mHeadings(std::move(headings))
{
}

void TextTable::AddRow(std::vector<std::string> cells)
{
    cells.resize(mHeadings.size());
    std::transform(cells.begin(), cells.end(), cells.begin(), InOneLine);
    mRows.push_back(std::move(cells));
}

std::string TextTable::Text(bool colour) const
{
    std::vector<std::size_t> widths;
    for (std::size_t column = 0; column < mHeadings.size(); ++column)
    {
        std::size_t width = Places(mHeadings[column]);
        for (const std::vector<std::string>& row : mRows)
        {
            width = std::max(width, Places(row[column]));
        }
        widths.push_back(width);
    }
    std::string text = (colour ? "\x1b[1m" : "") + Line(mHeadings, widths) + (colour ? "\x1b[0m" : "") + "\n";
    for (const std::vector<std::string>& row : mRows)
    {
        text += Line(row, widths) + "\n";
    }
    return text;
}

} // namespace zebhost
