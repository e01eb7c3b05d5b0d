// Audio Units: changes of parameters from a thread of the unit's own, which the filter hears of on the main thread.
#include "host/src/XAU/src/XAUAudioFilter.h"
#include "host/src/XAU/src/XAUComponentID.h"
#include "tests/realtime/RealtimeProof.h"
#include "tests/support/VariableGuard.h"

namespace realtimeproof
{

namespace
{

using xau::XAUAudioFilter;

class XAUSubject final : public Subject
{
public:
    explicit XAUSubject(const boost::intrusive_ptr<XAUAudioFilter>& filter, std::vector<int> channels)
        : Subject(filter, std::move(channels))
    {
        const auto info = boost::dynamic_pointer_cast<xau::XAUParameterInfo>(filter->GetParameterInfo(0));
        mParameter = {filter->GetComponentInstance(), info->GetParameterID(), info->GetScope(), 0};
    }

    void WorkElsewhere(int round) override { AUParameterSet(nullptr, nullptr, &mParameter, ValueOf(round), 0); }

private:
    AudioUnitParameter mParameter = {};
};

std::unique_ptr<Subject> Make(OSType type, OSType subType, std::vector<int> channels)
{
    static const zebtest::VariableGuard sUnits("AUDIO_COMPONENT_PATH", ZEB_UNITS);
    constexpr OSType kMaker = 0x7A656278;
    const auto filter = XAUAudioFilter::Create(u"4:" + xau::EncodeComponentID({type, subType, kMaker, 0, 0}));
    return filter ? std::make_unique<XAUSubject>(filter, std::move(channels)) : nullptr;
}

} // namespace

INSTANTIATE_TEST_SUITE_P(AudioUnit, RealtimeProof,
                         testing::Values(Row{"Gain",
                                             []
                                             {
                                                 return Make(kAudioUnitType_Effect, 0x7A676169, {2, 1, 6});
                                             }},
                                         Row{"Delay",
                                             []
                                             {
                                                 return Make(kAudioUnitType_Effect, 0x7A64656C, {2, 6});
                                             }},
                                         Row{"Mixer",
                                             []
                                             {
                                                 return Make(kAudioUnitType_Mixer, 0x7A6D6978, {2});
                                             }},
                                         Row{"Tone",
                                             []
                                             {
                                                 return Make(kAudioUnitType_Effect, 0x7A746F6E, {2});
                                             }}),
                         testing::PrintToStringParamName());

} // namespace realtimeproof
