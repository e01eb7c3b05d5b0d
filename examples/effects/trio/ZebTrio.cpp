// ZebTrio: one bundle of three classes, two effects and an instrument, each component and controller in one.
#include "examples/effects/support/PluginFactory.h"
#include "examples/effects/trio/Tilt.h"
#include "examples/effects/trio/Tone.h"
#include "examples/effects/trio/Tremolo.h"

namespace effects
{

namespace trio
{

const FUID kTremoloID(0x5A656254, 0x72696F00, 0x40000000, 0x00000001);
const FUID kTiltID(0x5A656254, 0x72696F00, 0x40000000, 0x00000002);
const FUID kToneID(0x5A656254, 0x72696F00, 0x40000000, 0x00000003);

} // namespace trio

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kUnicode,
            .classes = {
                {trio::kTremoloID, kVstAudioEffectClass, u"Zeb Tremolo", "Fx|Modulation", Make<trio::Tremolo>},
                {trio::kTiltID, kVstAudioEffectClass, u"Zeb Tilt", "Fx|EQ", Make<trio::Tilt>},
                {trio::kToneID, kVstAudioEffectClass, u"Zeb Tone", "Instrument|Synth", Make<trio::Tone>},
            }};
}

} // namespace effects
