#include "foundation/zebcore/FileUtils.h"

#include "foundation/zebcore/internal/FileDescriptor.h"
#include "foundation/zebcore/internal/TextFile.h"

namespace zebcore::utility::FileUtils
{

namespace
{

constexpr std::size_t kBlockSize = std::size_t{1} << 16U;

} // namespace

void SimpleWriteStringToFile(const UTF16String& path, const UTF8String& text)
{
    filesupport::FileDescriptor file = filesupport::FileDescriptor::Create(path);
    file.Write(text);
    file.Close();
}

UTF8String SimpleReadStringFromFile(const UTF16String& path)
{
    filesupport::TextFile file(path);
    UTF8String text;
    std::size_t block = 0;
    std::size_t read = 0;
    do
    {
        const std::size_t done = text.size();
        // One byte more than the length finds the end at once. A length that lies only costs more steps.
        block = file.Length() > done ? static_cast<std::size_t>(file.Length()) - done + 1 : kBlockSize;
        text.resize(done + block);
        read = file.ReadBlock(reinterpret_cast<unsigned char*>(text.data() + done), static_cast<unsigned int>(block));
        text.resize(done + read);
    } while (read == block);
    return text;
}

} // namespace zebcore::utility::FileUtils
