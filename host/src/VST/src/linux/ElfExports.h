#pragma once

#include <elf.h>

#include <cstdint>
#include <istream>
#include <optional>
#include <string_view>
#include <vector>

namespace zebaudiofilterhost::vst
{

enum class ElfKind : std::uint8_t
{
    kNoLibrary,
    kOtherMachine, // nothing that this process could load
    kLibrary
};

/// What a shared library exports, read from its file as the dynamic loader would find it: by the dynamic segment
/// alone, since section headers may be stripped. The bytes may be anything: offsets and counts that lie give no
/// export. Reads only what it needs. [main]
class ElfExports
{
public:
    /// The file is read again by HasFunction, so it must live as long.
    explicit ElfExports(std::istream& file);

    ElfKind GetKind() const { return mKind; }
    /// Whether the library itself, and not one that it needs, has a function of this name for others to call.
    bool HasFunction(std::string_view name);

private:
    // Where the tables lie in the file; nothing that is missing is looked at.
    struct Tables
    {
        std::optional<std::uint64_t> mSymbols;
        std::optional<std::uint64_t> mStrings;
        std::optional<std::uint64_t> mHash;
        std::optional<std::uint64_t> mGnuHash;
        std::uint64_t mStringsSize = 0;
    };

    // Nothing behind the end of the file.
    template <class T>
    std::optional<T> ReadAt(std::uint64_t offset);
    bool ReadBytes(std::uint64_t offset, char* bytes, std::size_t size);
    std::optional<std::uint32_t> ReadWord(std::uint64_t table, std::uint64_t index);

    void ReadHeader();
    void ReadSegments(const Elf64_Ehdr& header);
    void ReadDynamic(const Elf64_Phdr& segment);
    void NoteTable(const Elf64_Dyn& entry);
    std::optional<std::uint64_t> OffsetOf(std::uint64_t address) const;

    bool FindByGnuHash(std::string_view name);
    bool FindByHash(std::string_view name);
    bool IsFunction(std::uint64_t index, std::string_view name);
    bool IsCalled(std::uint64_t nameOffset, std::string_view name);

    std::istream& mFile;
    ElfKind mKind = ElfKind::kNoLibrary;
    std::vector<Elf64_Phdr> mLoaded; // the segments that become memory
    Tables mTables;
};

} // namespace zebaudiofilterhost::vst
