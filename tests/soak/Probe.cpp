#include "Probe.h"

#include "MainLoop.h"
#include "Turn.h"

namespace soak
{

std::uint64_t ProbeSound(const Subject& subject, ProcessThread& thread)
{
    constexpr std::size_t kBlocks = 48;
    constexpr std::uint32_t kNoiseStart = 20250101;
    constexpr unsigned int kSettleMs = 10;
    const std::unique_ptr<Specimen> specimen = CreateSpecimen(subject);
    zebaudiofilterhost::AudioFilter& filter = *specimen->Filter();
    // Some do not start where their parameters stand.
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        filter.SetParameter(index, filter.GetParameter(index));
    }
    Setup setup;
    setup.bus = zebaudiofilterhost::AudioFilterBusDescription::CreateStereo(
        u"Main", zebaudiofilterhost::AudioFilterBusDescription::kBusType_Main);
    specimen->Configure(setup);
    Settle(kSettleMs);
    const std::uint64_t hash = specimen->Process(std::vector<int>(kBlocks, setup.blockSize), kNoiseStart, thread);
    specimen->Close();
    return hash;
}

} // namespace soak
