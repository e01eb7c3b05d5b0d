#pragma once

#include "foundation/zebcore/File.h"
#include "foundation/zebcore/StringTypes.h"
#include "fuzz/support/Target.h"

#include <string>
#include <string_view>

namespace zebfuzz
{

// A file in the temporary folder, for readers that take a path. Removed with the object.
class ScratchFile
{
public:
    ScratchFile();
    ~ScratchFile();
    ScratchFile(const ScratchFile&) = delete;
    ScratchFile& operator=(const ScratchFile&) = delete;

    // The file with this content and no other.
    zebcore::filesupport::File Holding(Bytes bytes) const;
    zebcore::filesupport::File Holding(std::u8string_view text) const;

private:
    std::string mPath;
    int mDescriptor;
};

// The same bytes as text.
zebcore::UTF8String TextOf(Bytes bytes);

} // namespace zebfuzz
