// Runs one case a number of times, for a tool that counts instructions in ZebCountedBlocks alone.
//   zeb_bench_instructions                    lists the cases, "ROW WAY" a line
//   zeb_bench_instructions ROW WAY BLOCKS
#include "benchmarks/process/OurWay.h"
#include "benchmarks/process/Work.h"

#include <cstdlib>
#include <exception>
#include <iostream>

using namespace zebaudiofilterhost::benchmarks;

// By this name the tool knows when to count.
extern "C" [[gnu::noinline]] void ZebCountedBlocks(Work& work, int blocks)
{
    for (int block = 0; block < blocks; ++block)
        work.Run();
}

namespace
{

int Count(const Case& counted, int blocks)
{
    constexpr int kWarmUp = 200; // All paths bound, all lazy things made, the delay line full
    const std::unique_ptr<Work> work = counted.make();
    work->Verify();
    for (int block = 0; block < kWarmUp; ++block)
        work->Run();
    ZebCountedBlocks(*work, blocks);
    return 0;
}

int Run(const std::vector<Case>& cases, int argc, char** argv)
{
    for (const Case& each : cases)
    {
        if (!each.make)
            continue;
        if (argc < 4)
            std::cout << each.row << ' ' << each.way << '\n';
        else if (each.row == argv[1] && each.way == argv[2])
            return Count(each, std::atoi(argv[3]));
    }
    if (argc >= 4)
        std::cerr << "no such case: " << argv[1] << ' ' << argv[2] << '\n';
    return argc >= 4 ? 1 : 0;
}

} // namespace

int main(int argc, char** argv)
{
    const OurLibrary library;
    std::vector<Case> cases;
    AddEffectCases(cases);
    AddMapCases(cases);
    try
    {
        return Run(cases, argc, argv);
    }
    catch (const std::exception& error)
    {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
