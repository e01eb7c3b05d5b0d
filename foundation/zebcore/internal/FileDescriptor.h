#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <sys/types.h>

#include <string_view>

namespace zebcore::filesupport
{

// An open file, closed at the end. Operations throw file_exception, made of the action and the path.
class FileDescriptor
{
public:
    FileDescriptor(const UTF16String& path, int flags, mode_t mode, std::string_view action);
    // An empty file to write to: a new one, or an old one that is emptied.
    static FileDescriptor Create(const UTF16String& path);
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    ~FileDescriptor();

    int Get() const { return mDescriptor; }

    // Writes all of it, however many steps the system takes.
    void Write(std::u8string_view data);

    // Does not return before the content is on the disk.
    void Flush();

    // Closes early, to hear of what the system could not write after all.
    void Close();

    [[noreturn]] void ThrowLastError() const;

private:
    UTF16String mPath;
    std::string_view mAction;
    int mDescriptor = -1;
};

} // namespace zebcore::filesupport
