// ZebCompressor: a side-chain input and a meter. Its controller needs nothing that Controller doesn't do.
#include "examples/effects/compressor/CompressorProcessor.h"
#include "examples/effects/support/PluginFactory.h"

namespace effects
{

namespace compressor
{

const FUID kProcessorID(0x5A656243, 0x6F6D7072, 0x30000000, 0x00000001);
const FUID kControllerID(0x5A656243, 0x6F6D7072, 0x30000000, 0x00000002);

ParameterSet MakeParameters()
{
    return {
        {.id = kThreshold, .title = u"Threshold", .units = u"dB", .minimum = -60.0, .maximum = 0.0, .initial = -20.0},
        {.id = kRatio, .title = u"Ratio", .units = u": 1", .minimum = 1.0, .maximum = 20.0, .initial = 4.0},
        {.id = kAttack, .title = u"Attack", .units = u"ms", .minimum = 0.1, .maximum = 100.0, .initial = 5.0},
        {.id = kRelease, .title = u"Release", .units = u"ms", .minimum = 5.0, .maximum = 1000.0, .initial = 120.0},
        {.id = kMakeUp, .title = u"Make-up", .units = u"dB", .minimum = 0.0, .maximum = 24.0, .initial = 0.0},
        {.id = kReduction,
         .title = u"Reduction",
         .units = u"dB",
         .minimum = 0.0,
         .maximum = 60.0,
         .initial = 0.0,
         .flags = ParameterInfo::kIsReadOnly},
    };
}

class CompressorController : public Controller
{
public:
    CompressorController() : Controller(MakeParameters()) {}
};

} // namespace compressor

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kSubCategories,
            .classes = {
                {compressor::kProcessorID, kVstAudioEffectClass, u"Zeb Compressor", "Fx|Dynamics",
                 Make<compressor::CompressorProcessor>},
                {compressor::kControllerID, kVstComponentControllerClass, u"Zeb Compressor Controller", "",
                 Make<compressor::CompressorController>},
            }};
}

} // namespace effects
