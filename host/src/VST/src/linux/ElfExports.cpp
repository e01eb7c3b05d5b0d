#include "host/src/VST/src/linux/ElfExports.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <limits>
#include <string>

namespace zebaudiofilterhost::vst
{

namespace
{

#if defined(__x86_64__)
constexpr Elf64_Half kMachine = EM_X86_64;
#elif defined(__aarch64__)
constexpr Elf64_Half kMachine = EM_AARCH64;
#elif defined(__riscv)
constexpr Elf64_Half kMachine = EM_RISCV;
#else
#error "Say here which machine this process runs on"
#endif

// Far beyond what linkers make, and soon done.
constexpr std::uint64_t kMaxDynamicEntries = 4096;
constexpr std::uint64_t kMaxChainLength = 1U << 16U;

bool IsOfThisMachine(const Elf64_Ehdr& header)
{
    return header.e_ident[EI_CLASS] == ELFCLASS64 && header.e_ident[EI_DATA] == ELFDATA2LSB &&
           header.e_machine == kMachine && header.e_phentsize == sizeof(Elf64_Phdr);
}

std::uint32_t GnuHash(std::string_view name)
{
    std::uint32_t hash = 5381;
    for (const char unit : name)
        hash = hash * 33 + static_cast<unsigned char>(unit);
    return hash;
}

std::uint32_t Hash(std::string_view name)
{
    std::uint32_t hash = 0;
    for (const char unit : name)
    {
        hash = (hash << 4U) + static_cast<unsigned char>(unit);
        const std::uint32_t high = hash & 0xF0000000U;
        hash = (hash ^ (high >> 24U)) & ~high;
    }
    return hash;
}

bool CanBeCalled(const Elf64_Sym& symbol)
{
    const unsigned int binding = ELF64_ST_BIND(symbol.st_info);
    const unsigned int type = ELF64_ST_TYPE(symbol.st_info);
    const unsigned int visibility = ELF64_ST_VISIBILITY(symbol.st_other);
    return symbol.st_shndx != SHN_UNDEF && (binding == STB_GLOBAL || binding == STB_WEAK) &&
           (type == STT_FUNC || type == STT_GNU_IFUNC || type == STT_NOTYPE) &&
           (visibility == STV_DEFAULT || visibility == STV_PROTECTED);
}

} // namespace

ElfExports::ElfExports(std::istream& file) : mFile(file)
{
    ReadHeader();
}

bool ElfExports::HasFunction(std::string_view name)
{
    if (mKind != ElfKind::kLibrary || !mTables.mSymbols || !mTables.mStrings)
        return false;
    return mTables.mGnuHash ? FindByGnuHash(name) : FindByHash(name);
}

bool ElfExports::ReadBytes(std::uint64_t offset, char* bytes, std::size_t size)
{
    if (offset > static_cast<std::uint64_t>(std::numeric_limits<std::streamoff>::max()))
        return false;
    mFile.clear();
    mFile.seekg(static_cast<std::streamoff>(offset));
    mFile.read(bytes, static_cast<std::streamsize>(size));
    return mFile.good();
}

template <class T>
std::optional<T> ElfExports::ReadAt(std::uint64_t offset)
{
    std::array<char, sizeof(T)> bytes{};
    if (!ReadBytes(offset, bytes.data(), bytes.size()))
        return std::nullopt;
    return std::bit_cast<T>(bytes);
}

// Sums of offsets from a file may wrap round: they then lie elsewhere in it, or nowhere, like any other false one.
std::optional<std::uint32_t> ElfExports::ReadWord(std::uint64_t table, std::uint64_t index)
{
    return ReadAt<std::uint32_t>(table + index * sizeof(std::uint32_t));
}

void ElfExports::ReadHeader()
{
    const auto header = ReadAt<Elf64_Ehdr>(0);
    if (!header || std::memcmp(header->e_ident, ELFMAG, SELFMAG) != 0)
        return;
    if (!IsOfThisMachine(*header))
    {
        mKind = ElfKind::kOtherMachine;
    }
    else if (header->e_type == ET_DYN)
    {
        mKind = ElfKind::kLibrary;
        ReadSegments(*header);
    }
}

void ElfExports::ReadSegments(const Elf64_Ehdr& header)
{
    std::optional<Elf64_Phdr> dynamic;
    for (std::uint64_t index = 0; index < header.e_phnum; ++index)
    {
        const auto segment = ReadAt<Elf64_Phdr>(header.e_phoff + index * sizeof(Elf64_Phdr));
        if (!segment)
            break;
        if (segment->p_type == PT_LOAD)
            mLoaded.push_back(*segment);
        else if (segment->p_type == PT_DYNAMIC)
            dynamic = segment;
    }
    if (dynamic)
        ReadDynamic(*dynamic);
}

void ElfExports::ReadDynamic(const Elf64_Phdr& segment)
{
    const std::uint64_t count = std::min(segment.p_filesz / sizeof(Elf64_Dyn), kMaxDynamicEntries);
    for (std::uint64_t index = 0; index < count; ++index)
    {
        const auto entry = ReadAt<Elf64_Dyn>(segment.p_offset + index * sizeof(Elf64_Dyn));
        if (!entry || entry->d_tag == DT_NULL)
            break;
        NoteTable(*entry);
    }
}

void ElfExports::NoteTable(const Elf64_Dyn& entry)
{
    switch (entry.d_tag)
    {
    case DT_SYMTAB:
        mTables.mSymbols = OffsetOf(entry.d_un.d_ptr);
        break;
    case DT_STRTAB:
        mTables.mStrings = OffsetOf(entry.d_un.d_ptr);
        break;
    case DT_STRSZ:
        mTables.mStringsSize = entry.d_un.d_val;
        break;
    case DT_HASH:
        mTables.mHash = OffsetOf(entry.d_un.d_ptr);
        break;
    case DT_GNU_HASH:
        mTables.mGnuHash = OffsetOf(entry.d_un.d_ptr);
        break;
    default:
        break;
    }
}

std::optional<std::uint64_t> ElfExports::OffsetOf(std::uint64_t address) const
{
    for (const Elf64_Phdr& segment : mLoaded)
    {
        if (address >= segment.p_vaddr && address - segment.p_vaddr < segment.p_filesz)
            return segment.p_offset + (address - segment.p_vaddr);
    }
    return std::nullopt;
}

bool ElfExports::FindByGnuHash(std::string_view name)
{
    struct Header
    {
        std::uint32_t mBuckets;
        std::uint32_t mFirstSymbol;
        std::uint32_t mBloomWords;
        std::uint32_t mBloomShift;
    };
    const auto header = ReadAt<Header>(*mTables.mGnuHash);
    if (!header || header->mBuckets == 0)
        return false;
    const std::uint64_t buckets =
        *mTables.mGnuHash + sizeof(Header) + header->mBloomWords * std::uint64_t{sizeof(Elf64_Addr)};
    const std::uint64_t chains = buckets + header->mBuckets * std::uint64_t{sizeof(std::uint32_t)};
    const std::uint32_t hash = GnuHash(name);
    const auto start = ReadWord(buckets, hash % header->mBuckets);
    if (!start || *start < header->mFirstSymbol)
        return false;
    // Each word is a symbol's hash, but for the lowest bit, which ends the chain.
    for (std::uint64_t index = *start; index < *start + kMaxChainLength; ++index)
    {
        const auto word = ReadWord(chains, index - header->mFirstSymbol);
        if (word && (*word | 1U) == (hash | 1U) && IsFunction(index, name))
            return true;
        if (!word || (*word & 1U) != 0)
            return false;
    }
    return false;
}

bool ElfExports::FindByHash(std::string_view name)
{
    struct Header
    {
        std::uint32_t mBuckets;
        std::uint32_t mSymbols;
    };
    const auto header = mTables.mHash ? ReadAt<Header>(*mTables.mHash) : std::nullopt;
    if (!header || header->mBuckets == 0)
        return false;
    const std::uint64_t buckets = *mTables.mHash + sizeof(Header);
    const std::uint64_t chains = buckets + header->mBuckets * std::uint64_t{sizeof(std::uint32_t)};
    auto index = ReadWord(buckets, Hash(name) % header->mBuckets);
    // A chain that bites its tail comes past a mark that is moved at each power of two.
    std::uint32_t mark = STN_UNDEF;
    for (std::uint64_t steps = 1; index && *index != mark && *index != STN_UNDEF && steps <= kMaxChainLength; ++steps)
    {
        if (IsFunction(*index, name))
            return true;
        if (std::has_single_bit(steps))
            mark = *index;
        index = ReadWord(chains, *index);
    }
    return false;
}

bool ElfExports::IsFunction(std::uint64_t index, std::string_view name)
{
    const auto symbol = ReadAt<Elf64_Sym>(*mTables.mSymbols + index * sizeof(Elf64_Sym));
    return symbol && CanBeCalled(*symbol) && IsCalled(symbol->st_name, name);
}

bool ElfExports::IsCalled(std::uint64_t nameOffset, std::string_view name)
{
    const std::size_t size = name.size() + 1;
    if (nameOffset >= mTables.mStringsSize || mTables.mStringsSize - nameOffset < size)
        return false;
    std::string found(size, '\0');
    return ReadBytes(*mTables.mStrings + nameOffset, found.data(), size) &&
           std::string_view(found) == std::string(name) + '\0';
}

} // namespace zebaudiofilterhost::vst
