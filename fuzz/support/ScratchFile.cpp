#include "fuzz/support/ScratchFile.h"

#include "foundation/zebcore/NativePath.h"

#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <system_error>
#include <unistd.h>

namespace zebfuzz
{

using zebcore::filesupport::File;

ScratchFile::ScratchFile()
    : mPath((std::filesystem::temp_directory_path() / "zeb-fuzz-XXXXXX").string()), mDescriptor(mkstemp(mPath.data()))
{
    if (mDescriptor < 0)
        throw std::runtime_error("cannot make " + mPath);
}

ScratchFile::~ScratchFile()
{
    close(mDescriptor);
    std::error_code ignored;
    std::filesystem::remove(mPath, ignored);
}

File ScratchFile::Holding(Bytes bytes) const
{
    // Written over and cut afterwards: some file systems wait for the disk when an emptied file is filled again.
    const auto size = static_cast<ssize_t>(bytes.size());
    if (pwrite(mDescriptor, bytes.data(), bytes.size(), 0) != size || ftruncate(mDescriptor, size) != 0)
        throw std::runtime_error("cannot write " + mPath);
    return File(zebcore::filesupport::FromNativePath(mPath));
}

File ScratchFile::Holding(std::u8string_view text) const
{
    return Holding(Bytes(reinterpret_cast<const std::uint8_t*>(text.data()), text.size()));
}

zebcore::UTF8String TextOf(Bytes bytes)
{
    return {bytes.begin(), bytes.end()};
}

} // namespace zebfuzz
