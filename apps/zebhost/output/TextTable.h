#pragma once

#include <string>
#include <vector>

namespace zebhost
{

// Columns of text for people: as wide as their widest cell, two blanks between, the last column as long as it is.
class TextTable
{
public:
    explicit TextTable(std::vector<std::string> headings);

    void AddRow(std::vector<std::string> cells);
    bool IsEmpty() const { return mRows.empty(); }
    // With `colour` the headings are bold.
    std::string Text(bool colour) const;

private:
    std::vector<std::string> mHeadings;
    std::vector<std::vector<std::string>> mRows;
};

} // namespace zebhost
