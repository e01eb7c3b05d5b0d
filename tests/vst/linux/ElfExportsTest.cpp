#include "host/src/VST/src/linux/ElfExports.h"

#include <gtest/gtest.h>

#include <elf.h>

#include <cstddef>
#include <cstring>
#include <fstream>
#include <iterator>
#include <random>
#include <sstream>
#include <string>

namespace zebaudiofilterhost::vst
{

namespace
{

std::string ReadFile(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

struct Library
{
    const char* mStyle;
    std::string mBytes;
};

// The same source with each of the two tables that the dynamic loader knows.
class ElfExportsTest : public testing::Test
{
protected:
    const std::vector<Library> mLibraries = {{"gnu", ReadFile(ZEB_ELF_GNU)}, {"sysv", ReadFile(ZEB_ELF_SYSV)}};
};

bool Has(const std::string& bytes, std::string_view name)
{
    std::istringstream file(bytes);
    return ElfExports(file).HasFunction(name);
}

ElfKind KindOf(const std::string& bytes)
{
    std::istringstream file(bytes);
    return ElfExports(file).GetKind();
}

template <class T>
std::string Patched(std::string bytes, std::size_t offset, T value)
{
    std::memcpy(bytes.data() + offset, &value, sizeof(value));
    return bytes;
}

TEST_F(ElfExportsTest, FunctionsOfItsOwnThatOthersMayCall)
{
    for (const Library& library : mLibraries)
    {
        SCOPED_TRACE(library.mStyle);
        ASSERT_EQ(KindOf(library.mBytes), ElfKind::kLibrary);
        for (const char* name : {"Shown", "Weak", "Protected", "A0", "A1", "H0", "H1"})
            EXPECT_TRUE(Has(library.mBytes, name)) << name;
        // abs is the C library's.
        for (const char* name : {"Hidden", "sData", "abs", "Show", "Shown2", "hown", "", "A2"})
            EXPECT_FALSE(Has(library.mBytes, name)) << name;
    }
}

TEST_F(ElfExportsTest, SectionHeadersAreNotNeeded)
{
    for (const Library& library : mLibraries)
    {
        std::string bytes = Patched(library.mBytes, offsetof(Elf64_Ehdr, e_shoff), Elf64_Off{0});
        bytes = Patched(bytes, offsetof(Elf64_Ehdr, e_shnum), Elf64_Half{0});
        EXPECT_TRUE(Has(bytes, "Shown"));
        EXPECT_TRUE(Has(Patched(library.mBytes, offsetof(Elf64_Ehdr, e_shoff), ~Elf64_Off{0}), "Shown"));
    }
}

TEST_F(ElfExportsTest, OnlyLibrariesOfThisMachine)
{
    const std::string& bytes = mLibraries.front().mBytes;
    struct Case
    {
        std::string mBytes;
        ElfKind mKind;
    };
    const Case cases[] = {
        {"", ElfKind::kNoLibrary},
        {"\x7f"
         "ELF",
         ElfKind::kNoLibrary},
        {"#!/bin/sh\n" + std::string(200, 'x'), ElfKind::kNoLibrary},
        {bytes.substr(0, sizeof(Elf64_Ehdr) - 1), ElfKind::kNoLibrary},
        {Patched(bytes, 0, '\0'), ElfKind::kNoLibrary},
        {Patched(bytes, EI_CLASS, char{ELFCLASS32}), ElfKind::kOtherMachine},
        {Patched(bytes, EI_DATA, char{ELFDATA2MSB}), ElfKind::kOtherMachine},
        {Patched(bytes, offsetof(Elf64_Ehdr, e_machine), Elf64_Half{EM_S390}), ElfKind::kOtherMachine},
        {Patched(bytes, offsetof(Elf64_Ehdr, e_type), Elf64_Half{ET_REL}), ElfKind::kNoLibrary},
        {Patched(bytes, offsetof(Elf64_Ehdr, e_type), Elf64_Half{ET_CORE}), ElfKind::kNoLibrary},
    };
    for (const Case& test : cases)
    {
        const auto place = &test - std::begin(cases);
        EXPECT_EQ(KindOf(test.mBytes), test.mKind) << place;
        EXPECT_FALSE(Has(test.mBytes, "Shown")) << place;
    }
}

// Where the symbols are found lies behind the headers, so a part of the file never has more functions than the whole.
TEST_F(ElfExportsTest, AFileMayEndAnywhere)
{
    for (const Library& library : mLibraries)
    {
        bool had = false;
        for (std::size_t size = 0; size <= library.mBytes.size(); size += size < 0x1000 ? 1 : 97)
        {
            const std::string part = library.mBytes.substr(0, size);
            const bool has = Has(part, "Shown");
            EXPECT_TRUE(has || !had) << "lost again at " << size;
            EXPECT_FALSE(Has(part, "Hidden"));
            had = has;
        }
        EXPECT_TRUE(had);
    }
}

TEST_F(ElfExportsTest, OffsetsAndCountsMayLie)
{
    constexpr std::uint64_t kLies[] = {0, 1, 0x7f, 0x1000, 0xffffffff, 0x7fffffffffffffff, ~std::uint64_t{0}};
    std::minstd_rand random(4711);
    for (const Library& library : mLibraries)
    {
        constexpr int kRounds = 4000;
        int found = 0;
        for (int round = 0; round < kRounds; ++round)
        {
            std::string bytes = library.mBytes;
            for (int lie = 0; lie < 1 + round % 4; ++lie)
            {
                const std::uint64_t value = round % 2 == 0 ? kLies[random() % std::size(kLies)] : random();
                const std::size_t width = std::size_t{1} << random() % 4;
                std::memcpy(bytes.data() + random() % (bytes.size() - sizeof(value)), &value, width);
            }
            found += Has(bytes, "Shown") ? 1 : 0;
            EXPECT_FALSE(Has(bytes, "Hidden")) << round;
        }
        EXPECT_GT(found, 0) << "most lies are told where nobody looks";
        EXPECT_LT(found, kRounds) << "no lie was told where it matters";
    }
}

// A library of nothing but a hash table whose only chain leads from symbol 1 to symbol 1.
std::string EndlessLibrary(std::uint32_t symbol)
{
    struct Image
    {
        Elf64_Ehdr mHeader = {};
        Elf64_Phdr mSegments[2] = {};
        Elf64_Dyn mDynamic[5] = {};
        std::uint32_t mHash[5] = {}; // buckets, symbols, bucket 0, chain 0, chain 1
        Elf64_Sym mSymbols[2] = {};
    };
    Image image;
    std::memcpy(image.mHeader.e_ident, ELFMAG, SELFMAG);
    image.mHeader.e_ident[EI_CLASS] = ELFCLASS64;
    image.mHeader.e_ident[EI_DATA] = ELFDATA2LSB;
    image.mHeader.e_type = ET_DYN;
    image.mHeader.e_machine = EM_X86_64;
    image.mHeader.e_phoff = offsetof(Image, mSegments);
    image.mHeader.e_phentsize = sizeof(Elf64_Phdr);
    image.mHeader.e_phnum = 2;
    image.mSegments[0].p_type = PT_LOAD;
    image.mSegments[0].p_filesz = sizeof(Image);
    image.mSegments[1].p_type = PT_DYNAMIC;
    image.mSegments[1].p_offset = offsetof(Image, mDynamic);
    image.mSegments[1].p_filesz = sizeof(image.mDynamic);
    image.mDynamic[0] = {DT_SYMTAB, {offsetof(Image, mSymbols)}};
    image.mDynamic[1] = {DT_STRTAB, {offsetof(Image, mSymbols)}};
    image.mDynamic[2] = {DT_STRSZ, {sizeof(image.mSymbols)}};
    image.mDynamic[3] = {DT_HASH, {offsetof(Image, mHash)}};
    image.mHash[0] = 1;
    image.mHash[1] = 0xffffffff;
    image.mHash[2] = symbol;
    image.mHash[4] = 1;
    return {reinterpret_cast<const char*>(&image), sizeof(image)};
}

TEST_F(ElfExportsTest, AChainMayBiteItsTail)
{
    for (const std::uint32_t symbol : {0U, 1U, 2U, 0xffffffffU})
        EXPECT_FALSE(Has(EndlessLibrary(symbol), "Shown"));
}

// A library of nothing but one chain without an end, in which `name` has this place.
std::string LibraryOfOneChain(std::string_view name, std::size_t place)
{
    constexpr std::size_t kWords = 70000;
    struct Head
    {
        Elf64_Ehdr mHeader = {};
        Elf64_Phdr mSegments[2] = {};
        Elf64_Dyn mDynamic[5] = {};
        char mNames[16] = {};
        std::uint32_t mHash[6] = {1, 1, 0, 0, 1, 0}; // buckets, first symbol, filter of no words, bucket 0; unused
    };
    // The last word of the head is the first one of the chain.
    constexpr std::size_t kChain = offsetof(Head, mHash) + 5 * sizeof(std::uint32_t);
    constexpr std::size_t kSymbols = kChain + (kWords + 1) * sizeof(std::uint32_t);
    constexpr std::size_t kSize = kSymbols + (kWords + 1) * sizeof(Elf64_Sym);
    Head head;
    std::memcpy(head.mHeader.e_ident, ELFMAG, SELFMAG);
    head.mHeader.e_ident[EI_CLASS] = ELFCLASS64;
    head.mHeader.e_ident[EI_DATA] = ELFDATA2LSB;
    head.mHeader.e_type = ET_DYN;
    head.mHeader.e_machine = EM_X86_64;
    head.mHeader.e_phoff = offsetof(Head, mSegments);
    head.mHeader.e_phentsize = sizeof(Elf64_Phdr);
    head.mHeader.e_phnum = 2;
    head.mSegments[0].p_type = PT_LOAD;
    head.mSegments[0].p_filesz = kSize;
    head.mSegments[1].p_type = PT_DYNAMIC;
    head.mSegments[1].p_offset = offsetof(Head, mDynamic);
    head.mSegments[1].p_filesz = sizeof(head.mDynamic);
    head.mDynamic[0] = {DT_SYMTAB, {kSymbols}};
    head.mDynamic[1] = {DT_STRTAB, {offsetof(Head, mNames)}};
    head.mDynamic[2] = {DT_STRSZ, {sizeof(head.mNames)}};
    head.mDynamic[3] = {DT_GNU_HASH, {offsetof(Head, mHash)}};
    name.copy(head.mNames + 1, sizeof(head.mNames) - 2);
    std::uint32_t hash = 5381;
    for (const char unit : name)
        hash = hash * 33 + static_cast<unsigned char>(unit);
    Elf64_Sym symbol = {};
    symbol.st_name = 1;
    symbol.st_info = ELF64_ST_INFO(STB_GLOBAL, STT_FUNC);
    symbol.st_shndx = 1;
    std::string bytes(kSize, '\0');
    std::memcpy(bytes.data(), &head, sizeof(head));
    bytes = Patched(bytes, kChain + place * sizeof(hash), hash & ~1U);
    return Patched(bytes, kSymbols + (place + 1) * sizeof(symbol), symbol);
}

TEST_F(ElfExportsTest, AChainWithoutAnEndIsLeft)
{
    for (const std::size_t place : {0U, 1U, 65535U})
        EXPECT_TRUE(Has(LibraryOfOneChain("Shown", place), "Shown")) << place;
    for (const std::size_t place : {65536U, 69999U})
        EXPECT_FALSE(Has(LibraryOfOneChain("Shown", place), "Shown")) << place;
}

} // namespace

} // namespace zebaudiofilterhost::vst
