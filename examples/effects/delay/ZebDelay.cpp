// ZebDelay: repeats with a latency and a tail.
#include "examples/effects/delay/DelayController.h"
#include "examples/effects/delay/DelayProcessor.h"
#include "examples/effects/support/PluginFactory.h"

namespace effects
{

namespace delay
{

const FUID kProcessorID(0x5A656244, 0x656C6179, 0x20000000, 0x00000001);
const FUID kControllerID(0x5A656244, 0x656C6179, 0x20000000, 0x00000002);

ParameterSet MakeParameters()
{
    return {
        {.id = kTime, .title = u"Time", .units = u"ms", .minimum = 1.0, .maximum = kMaxTime, .initial = 300.0},
        {.id = kFeedback, .title = u"Feedback", .units = u"%", .minimum = 0.0, .maximum = 95.0, .initial = 30.0},
        {.id = kMix, .title = u"Mix", .units = u"%", .minimum = 0.0, .maximum = 100.0, .initial = 35.0},
        {.id = kLookAhead,
         .title = u"Look-ahead",
         .units = u"samples",
         .minimum = 0.0,
         .maximum = kMaxLookAhead,
         .initial = 128.0,
         .stepCount = kMaxLookAhead},
    };
}

} // namespace delay

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kSubCategories,
            .classes = {
                {delay::kProcessorID, kVstAudioEffectClass, u"Zeb Delay", "Fx|Delay", Make<delay::DelayProcessor>},
                {delay::kControllerID, kVstComponentControllerClass, u"Zeb Delay Controller", "",
                 Make<delay::DelayController>},
            }};
}

} // namespace effects
