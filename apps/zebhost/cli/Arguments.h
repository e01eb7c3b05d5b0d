#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace zebhost
{

// What the user typed, by the names of the command table: options without their dashes, operands as they stand there.
class Arguments
{
public:
    // `command` is empty when only --help or --version was asked for.
    std::string command;

    void Add(std::string_view name, std::vector<std::string> values);

    bool Has(std::string_view name) const;
    // Empty if not given.
    std::string Text(std::string_view name) const;
    std::string Text(std::string_view name, const std::string& fallback) const;
    std::vector<std::string> All(std::string_view name) const;
    // Both end the command with a usage failure when the text is no such number, or outside the bounds.
    double Number(std::string_view name, double fallback, double lowest, double highest) const;
    int Count(std::string_view name, int fallback, int lowest, int highest) const;

private:
    std::map<std::string, std::vector<std::string>, std::less<>> mValues;
};

} // namespace zebhost
