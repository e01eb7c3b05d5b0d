// ZebBench: effects that do next to nothing and differ in the number of their parameters.
#include "benchmarks/plugins/BenchEffect.h"
#include "examples/effects/support/PluginFactory.h"

namespace effects
{

namespace
{

const FUID k4ID(0x5A656242, 0x656E6368, 0x00000000, 0x00000004);
const FUID k512ID(0x5A656242, 0x656E6368, 0x00000000, 0x00000512);
const FUID k4096ID(0x5A656242, 0x656E6368, 0x00000000, 0x00004096);

template <int Parameters>
FUnknown* MakeBench()
{
    return (new bench::BenchEffect(Parameters))->AsUnknown();
}

} // namespace

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kUnicode,
            .classes = {
                {k4ID, kVstAudioEffectClass, u"Bench 4", "Fx|Tools", MakeBench<4>},
                {k512ID, kVstAudioEffectClass, u"Bench 512", "Fx|Tools", MakeBench<512>},
                {k4096ID, kVstAudioEffectClass, u"Bench 4096", "Fx|Tools", MakeBench<4096>},
            }};
}

} // namespace effects

extern "C" SMTG_EXPORT_SYMBOL zebaudiofilterhost::benchmarks::BenchSide* ZebBenchLatest()
{
    return effects::bench::BenchEffect::Latest();
}
