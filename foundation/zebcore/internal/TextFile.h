#pragma once

#include "foundation/zebcore/IPlatformByteStream.h"
#include "foundation/zebcore/StringTypes.h"

namespace zebcore::filesupport
{

// A file that is read as one text. One of more than two gigabytes is refused, whatever length it gives itself.
// Operations throw file_exception.
class TextFile
{
public:
    explicit TextFile(const UTF16String& path);

    // 0 for what has no length.
    unsigned long long Length() const { return mLength; }

    // The next bytes, fewer than `count` at the end only.
    unsigned int ReadBlock(unsigned char* buffer, unsigned int count);

private:
    void Check(unsigned long long size) const;

    UTF16String mPath;
    IPlatformByteStream mStream;
    unsigned long long mLength;
    unsigned long long mDone = 0;
};

} // namespace zebcore::filesupport
