#include "benchmarks/process/BenchBundle.h"

#include <dlfcn.h>

#include <filesystem>
#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

BenchBundle& BenchBundle::GetInstance()
{
    static BenchBundle sBundle;
    return sBundle;
}

std::string BenchBundle::GetPath()
{
    // From <bundle>/Contents/<arch>-linux/<binary>
    return std::filesystem::path(ZEB_BENCH_BINARY).parent_path().parent_path().parent_path().string();
}

std::string BenchBundle::GetFolder()
{
    return std::filesystem::path(GetPath()).parent_path().string();
}

BenchBundle::BenchBundle() : mHandle(dlopen(ZEB_BENCH_BINARY, RTLD_NOW | RTLD_LOCAL))
{
    if (mHandle == nullptr)
        throw std::runtime_error(dlerror());
}

void* BenchBundle::FindSymbol(const char* name) const
{
    void* const symbol = dlsym(mHandle, name);
    if (symbol == nullptr)
        throw std::runtime_error(std::string(ZEB_BENCH_BINARY) + " exports no " + name);
    return symbol;
}

BenchSide& BenchBundle::GetLatestSide() const
{
    BenchSide* const side = Find<LatestBenchSide>(kLatestBenchSide)();
    if (side == nullptr)
        throw std::runtime_error("no effect was made");
    return *side;
}

} // namespace zebaudiofilterhost::benchmarks
