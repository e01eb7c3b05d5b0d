#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

namespace zebhost
{

// Lines that are added to a file one by one, until what they say stands in files that are written as a whole. A line
// outlives the end of the process, in any way, as soon as it is added. Between two calls no file is open, so that no
// plug-in gets hold of it. Throws zebcore's file_exception, or filesystem_error.
class SettingsJournal
{
public:
    explicit SettingsJournal(std::filesystem::path file) : mFile(std::move(file)) {}

    bool Exists() const;
    // What was cut short, when a process was killed or the disk was full, is left out.
    std::vector<std::string> Lines() const;
    std::uintmax_t Size() const;
    // The line has its line end. If that fails, the file is as it was before.
    void Add(const std::string& line) const;
    // Takes back what was added behind this size.
    void CutTo(std::uintmax_t size) const;
    void Remove() const;

private:
    std::filesystem::path mFile;
};

} // namespace zebhost
