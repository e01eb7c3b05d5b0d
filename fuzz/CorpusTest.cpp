// Every file of the corpus, and every beginning of it, through its target, without a fuzzer.
#include "fuzz/support/Target.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

namespace zebfuzz
{

namespace
{

namespace fs = std::filesystem;

std::vector<std::uint8_t> Read(const fs::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

std::vector<fs::path> CorpusOf(const Target& target)
{
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::directory_iterator(fs::path(ZEB_FUZZ_CORPUS) / target.Name()))
        files.push_back(entry.path());
    std::sort(files.begin(), files.end());
    return files;
}

class Corpus : public testing::TestWithParam<const Target*>
{
};

TEST_P(Corpus, HoldsNoFinding)
{
    const std::vector<fs::path> files = CorpusOf(*GetParam());
    EXPECT_FALSE(files.empty());
    for (const fs::path& file : files)
        EXPECT_NO_THROW(GetParam()->Run(Read(file))) << file;
}

TEST_P(Corpus, HoldsNoFindingWhenCutShort)
{
    // A copy of its own size, so that a sanitizer sees a read past the end.
    for (const fs::path& file : CorpusOf(*GetParam()))
    {
        const std::vector<std::uint8_t> whole = Read(file);
        for (std::size_t length = 0; length < whole.size(); ++length)
        {
            const std::vector<std::uint8_t> beginning(whole.data(), whole.data() + length);
            ASSERT_NO_THROW(GetParam()->Run(beginning)) << file << " cut to " << length << " bytes";
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Targets, Corpus, testing::ValuesIn(Target::All()),
                         [](const testing::TestParamInfo<const Target*>& tested)
                         { return std::string(tested.param->Name()); });

TEST(CorpusFolders, BelongToATarget)
{
    for (const fs::directory_entry& folder : fs::directory_iterator(ZEB_FUZZ_CORPUS))
        EXPECT_TRUE(std::any_of(Target::All().begin(), Target::All().end(),
                                [&](const Target* target) { return folder.path().filename() == target->Name(); }))
            << folder.path();
}

} // namespace

} // namespace zebfuzz
