// ZebView: a stereo balance with an editor on X11.
#include "examples/effects/support/PluginFactory.h"
#include "examples/effects/view/BalanceController.h"
#include "examples/effects/view/BalanceProcessor.h"

namespace effects
{

namespace balance
{

const FUID kProcessorID(0x5A656256, 0x69657700, 0x50000000, 0x00000001);
const FUID kControllerID(0x5A656256, 0x69657700, 0x50000000, 0x00000002);

ParameterSet MakeParameters()
{
    return {
        {.id = kBalance, .title = u"Balance", .units = u"%", .minimum = -100.0, .maximum = 100.0, .initial = 0.0},
        {.id = kLevel,
         .title = u"Level",
         .units = u"",
         .minimum = 0.0,
         .maximum = 1.0,
         .initial = 0.0,
         .flags = ParameterInfo::kIsReadOnly,
         .decimals = 3},
    };
}

} // namespace balance

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kUnicode,
            .classes = {
                {balance::kProcessorID, kVstAudioEffectClass, u"Zeb Balance", "Fx|Spatial",
                 Make<balance::BalanceProcessor>},
                {balance::kControllerID, kVstComponentControllerClass, u"Zeb Balance Controller", "",
                 Make<balance::BalanceController>},
            }};
}

} // namespace effects
