// What a block costs: the plug-in itself, the same through an AudioFilter, and through the peer host.
#include "benchmarks/process/OurWay.h"
#include "benchmarks/process/Work.h"

#include <benchmark/benchmark.h>

#include <exception>
#include <map>

namespace
{

using namespace zebaudiofilterhost::benchmarks;

// Made at first use, and then the same in all rounds.
class Works
{
public:
    // Keyed by the name of the first way, so that a control shares it.
    Work& Get(const std::string& name, const Case& made)
    {
        std::unique_ptr<Work>& work = mWorks[name];
        if (!work)
        {
            work = made.make();
            work->Verify();
        }
        return *work;
    }

private:
    std::map<std::string, std::unique_ptr<Work>> mWorks;
};

void Measure(benchmark::State& state, Works& works, const Case& made)
{
    Work* work = nullptr;
    try
    {
        work = &works.Get(made.row + '/' + made.way, made);
    }
    catch (const std::exception& error)
    {
        state.SkipWithError(error.what());
        return;
    }
    for ([[maybe_unused]] auto round : state)
    {
        work->Run();
        benchmark::ClobberMemory();
    }
}

void Register(const std::vector<Case>& cases, Works& works)
{
    const Case* first = nullptr;
    for (const Case& each : cases)
    {
        if (first == nullptr || first->row != each.row)
            first = &each;
        const Case& made = each.make ? each : *first;
        benchmark::RegisterBenchmark((each.row + "/way:" + each.way).c_str(),
                                     [&works, &made](benchmark::State& state) { Measure(state, works, made); });
    }
}

} // namespace

int main(int argc, char** argv)
{
    const OurLibrary library; // Outlives the works
    Works works;
    std::vector<Case> cases;
    AddEffectCases(cases);
    AddMapCases(cases);
    Register(cases, works);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
}
