#include "catalogue/SettingsJournal.h"

#include "catalogue/SettingsFolder.h"

#include <foundation/zebcore/FileExceptions.h>

#include <algorithm>
#include <cerrno>
#include <fstream>
#include <string_view>

#include <fcntl.h>
#include <unistd.h>

namespace zebhost
{

namespace
{

// Returns a system error number, 0 if all is well.
int WriteWhole(int file, std::string_view text)
{
    while (!text.empty())
    {
        const ssize_t written = write(file, text.data(), text.size());
        if (written < 0 && errno != EINTR)
        {
            return errno;
        }
        text.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(written, 0)));
    }
    return 0;
}

} // namespace

bool SettingsJournal::Exists() const
{
    std::error_code error;
    return std::filesystem::exists(mFile, error);
}

std::vector<std::string> SettingsJournal::Lines() const
{
    std::vector<std::string> lines;
    std::ifstream stream(mFile, std::ios::binary);
    for (std::string line; std::getline(stream, line) && !stream.eof();)
    {
        lines.push_back(std::move(line));
    }
    return lines;
}

std::uintmax_t SettingsJournal::Size() const
{
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(mFile, error);
    return error ? 0 : size;
}

void SettingsJournal::Add(const std::string& line) const
{
    constexpr int kPermissions = 0666;
    const std::uintmax_t before = Size();
    const int file = open(mFile.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, kPermissions);
    int error = file < 0 ? errno : WriteWhole(file, line);
    if (file >= 0)
    {
        // The file system may tell only now that there is no room.
        const bool isClosed = close(file) == 0;
        error = error == 0 && !isClosed ? errno : error;
    }
    if (error != 0)
    {
        CutTo(before);
        throw zebcore::filesupport::file_exception("cannot write", ToFile(mFile).FullPath(), error);
    }
}

void SettingsJournal::CutTo(std::uintmax_t size) const
{
    if (Size() > size)
    {
        std::filesystem::resize_file(mFile, size);
    }
}

void SettingsJournal::Remove() const
{
    std::filesystem::remove(mFile);
}

} // namespace zebhost
