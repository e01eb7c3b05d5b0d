// VST 2: calls to the host from a thread of the plug-in's own, and filters and handlers that come and go.
#include "foundation/zebcore/NativePath.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTPluginModule.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/realtime/RealtimeProof.h"

namespace realtimeproof
{

namespace
{

using vst::AEffect;
using vst::VSTAudioFilter;

boost::intrusive_ptr<VSTAudioFilter> Load(const std::filesystem::path& binary)
{
    const auto module = vst::GetVSTPlugin(zebcore::filesupport::FromNativePath(binary.string()));
    std::vector<UTF16String> ids;
    if (!module || !module->GetPluginInfo(ids) || ids.empty())
        return nullptr;
    return boost::dynamic_pointer_cast<VSTAudioFilter>(module->CreateAudioFilter(ids.front()));
}

class VST2Subject final : public Subject
{
    // What the plug-in itself has of its filter.
    struct Reach : VSTAudioFilter
    {
        static AEffect* EffectOf(const VSTAudioFilter& filter) { return (filter.*&Reach::GetEffect)(); }
    };

public:
    VST2Subject(const boost::intrusive_ptr<VSTAudioFilter>& filter, std::vector<int> channels)
        : Subject(filter, std::move(channels)), mFilter(*filter), mEffect(Reach::EffectOf(*filter))
    {
    }

    void WorkOnMain(int round) override
    {
        mFilter.AddAudioMasterHandler(this, [](int, int, long long, void*, float) { return 0LL; });
        if (round % 64 == 0)
            Load(zebtest::VST2Fixture("Normal"));
        mFilter.RemoveAudioMasterHandler(this);
    }

    void WorkElsewhere(int round) override
    {
        char question[] = "sendVstTimeInfo";
        Call(vst::audioMasterCanDo, 0, question, 0.0F);
        Call(vst::audioMasterAutomate, 0, nullptr, ValueOf(round));
        Call(vst::audioMasterGetTime, 0, nullptr, 0.0F);
    }

private:
    void Call(int opcode, int index, void* ptr, float opt)
    {
        VSTAudioFilter::StaticAudioMasterCallback(mEffect, opcode, index, 0, ptr, opt);
    }

    VSTAudioFilter& mFilter;
    AEffect* mEffect;
};

std::unique_ptr<Subject> Make(const std::filesystem::path& binary, std::vector<int> channels)
{
    const auto filter = Load(binary);
    return filter ? std::make_unique<VST2Subject>(filter, std::move(channels)) : nullptr;
}

// With latency, and asking for the time in each block.
std::unique_ptr<Subject> MakeFixture(const char* name, std::vector<int> channels)
{
    const zebtest::FixtureRecorder recorder(zebtest::VST2Fixture(name));
    recorder.SetRecording(false); // which allocates
    recorder.Set("timeInProcess", 1);
    recorder.Set("latency", 100);
    zebtest::FixtureRecorder(zebtest::VST2Fixture("Normal")).SetRecording(false);
    return Make(zebtest::VST2Fixture(name), std::move(channels));
}

} // namespace

INSTANTIATE_TEST_SUITE_P(VST2, RealtimeProof,
                         testing::Values(Row{"Echo",
                                             []
                                             {
                                                 return Make(zebtest::VST2Effect("ZebEcho2"), {2});
                                             }}, // programs in chunks
                                         Row{"Accumulates",
                                             []
                                             {
                                                 return MakeFixture("Accumulates", {2, 6});
                                             }},
                                         Row{"CanMono",
                                             []
                                             {
                                                 return MakeFixture("CanMono", {1, 2});
                                             }}),
                         testing::PrintToStringParamName());

} // namespace realtimeproof
