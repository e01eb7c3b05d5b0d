// ZebGain: one effect of two classes, the processor and its controller.
#include "examples/effects/gain/GainController.h"
#include "examples/effects/gain/GainProcessor.h"
#include "examples/effects/support/PluginFactory.h"

namespace effects
{

namespace gain
{

const FUID kProcessorID(0x5A656247, 0x61696E00, 0x10000000, 0x00000001);
const FUID kControllerID(0x5A656247, 0x61696E00, 0x10000000, 0x00000002);

ParameterSet MakeParameters()
{
    return {
        // 0 dB lies at 0.75 exactly, so that the default gain is 1 to the last bit.
        {.id = kGain,
         .title = u"Gain",
         .units = u"dB",
         .minimum = -72.0,
         .maximum = 24.0,
         .initial = 0.0,
         .minimumText = u"-inf"},
        {.id = kBypass,
         .title = u"Bypass",
         .units = u"",
         .minimum = 0.0,
         .maximum = 1.0,
         .initial = 0.0,
         .stepCount = 1,
         .flags = ParameterInfo::kCanAutomate | ParameterInfo::kIsBypass,
         .choices = {u"Off", u"On"}},
        {.id = kChannels,
         .title = u"Channels",
         .units = u"",
         .minimum = 0.0,
         .maximum = 64.0,
         .initial = 0.0,
         .stepCount = 64,
         .flags = ParameterInfo::kIsReadOnly},
    };
}

} // namespace gain

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kUnicode,
            .classes = {
                {gain::kProcessorID, kVstAudioEffectClass, u"Zeb Gain", "Fx|Tools", Make<gain::GainProcessor>},
                {gain::kControllerID, kVstComponentControllerClass, u"Zeb Gain Controller", "",
                 Make<gain::GainController>},
            }};
}

} // namespace effects
