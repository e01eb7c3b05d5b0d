// VST 3: edits and restarts from a thread of the plug-in's own.
#include "foundation/zebcore/NativePath.h"
#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3PluginModule.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/realtime/RealtimeProof.h"

namespace realtimeproof
{

namespace
{

using vst3::VST3AudioFilter;

boost::intrusive_ptr<VST3AudioFilter> Load(const std::filesystem::path& bundle)
{
    const auto module = vst3::GetVST3Plugin(zebcore::filesupport::FromNativePath(bundle.string()));
    std::vector<UTF16String> ids;
    return module && module->GetPluginInfo(ids) && !ids.empty() ? module->CreateVST3AudioFilter(ids.front())
                                                                : nullptr;
}

class VST3Subject final : public Subject
{
public:
    // `parameter` is one that the application sees.
    VST3Subject(const boost::intrusive_ptr<VST3AudioFilter>& filter, std::vector<int> channels,
                Steinberg::Vst::ParamID parameter)
        : Subject(filter, std::move(channels)), mFilter(*filter), mParameter(parameter)
    {
    }

    void WorkElsewhere(int round) override
    {
        mFilter.beginEdit(mParameter);
        mFilter.performEdit(mParameter, static_cast<double>(ValueOf(round)));
        mFilter.endEdit(mParameter);
        if (round % 32 == 0)
            mFilter.restartComponent(Steinberg::Vst::kLatencyChanged);
        if (round % 64 == 0)
            mFilter.restartComponent(Steinberg::Vst::kParamTitlesChanged);
    }

private:
    VST3AudioFilter& mFilter;
    Steinberg::Vst::ParamID mParameter;
};

std::unique_ptr<Subject> Make(const boost::intrusive_ptr<VST3AudioFilter>& filter, std::vector<int> channels,
                              Steinberg::Vst::ParamID parameter)
{
    return filter ? std::make_unique<VST3Subject>(filter, std::move(channels), parameter) : nullptr;
}

// Two classes, and buses that follow the application's.
std::unique_ptr<Subject> MakeGain()
{
    constexpr Steinberg::Vst::ParamID kGain = 0;
    return Make(Load(zebtest::EffectBundle("ZebGain")), {2, 1, 6}, kGain);
}

// A side chain, programs, latency, and a parameter that the processor writes at each block.
std::unique_ptr<Subject> MakeFixture()
{
    constexpr Steinberg::Vst::ParamID kAmount = 7;
    const zebtest::FixtureRecorder recorder(zebtest::FixtureBundle("SideChain"));
    recorder.SetRecording(false); // which allocates
    recorder.Set("outputValue", 0.25);
    recorder.Set("latency", 100);
    return Make(Load(zebtest::FixtureBundle("SideChain")), {2}, kAmount);
}

} // namespace

INSTANTIATE_TEST_SUITE_P(VST3, RealtimeProof, testing::Values(Row{"Gain", MakeGain}, Row{"SideChain", MakeFixture}),
                         testing::PrintToStringParamName());

} // namespace realtimeproof
