// A filter of the consumer's own, made and run through the installed library alone.

#include "audiofilter/AudioFilter.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterRegistrar.h"
#include "module/Module.h"
#include "utility/EffectUtils.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace zab = zebaudiofilterhost;

namespace
{

const zab::Guid kHalvingGuid(0x1f2e3d4cU, 0x5b6a, 0x4798, 0x80, 0x91, 0xa2, 0xb3, 0xc4, 0xd5, 0xe6, 0xf7);
const zab::UTF16String kHalvingID = u"1:halving";

class Halving final : public zab::AudioFilter
{
public:
    explicit Halving(const zab::UTF16String& id) : AudioFilter(id, u"Halving")
    {
        AddInputBus(zab::AudioFilterBusDescription::CreateMono(u"In", zab::AudioFilterBusDescription::kBusType_Main));
        AddOutputBus(
            zab::AudioFilterBusDescription::CreateMono(u"Out", zab::AudioFilterBusDescription::kBusType_Main));
    }

    void Process(float** in, float** out, int frames, zab::ChannelFlags /*inFlags*/,
                 zab::ChannelFlags& outFlags) override
    {
        std::transform(in[0], in[0] + frames, out[0], [](float sample) { return sample / 2; });
        outFlags = zab::ChannelFlags();
    }
};

boost::intrusive_ptr<zab::AudioFilterDescriptor> DescribeHalving()
{
    return new zab::AudioFilterDescriptor(u"Halving", 1, zab::AudioFilterCategory(1), kHalvingID, kHalvingGuid,
                                          false);
}

boost::intrusive_ptr<zab::AudioFilter> MakeHalving(const zab::UTF16String& id)
{
    return new Halving(id);
}

const zab::AudioFilterRegistrar registrar(DescribeHalving, MakeHalving);

bool FilterHalves()
{
    const boost::intrusive_ptr<zab::AudioFilter> filter = zab::utility::CreateAudioFilter(kHalvingID);
    if (!filter)
    {
        return false;
    }
    filter->SetSampleRate(48000.0F);
    filter->SetBlockSize(4);
    filter->Resume();

    std::array<float, 4> in = {1.0F, -1.0F, 0.5F, 0.0F};
    std::array<float, 4> out = {};
    float* inputs[] = {in.data()};
    float* outputs[] = {out.data()};
    zab::ChannelFlags outFlags;
    filter->ProcessWithMapping(inputs, outputs, 4, zab::ChannelFlags(), outFlags);
    filter->Suspend();
    return out == std::array<float, 4>{0.5F, -0.5F, 0.25F, 0.0F};
}

} // namespace

int main()
{
    zab::Initialize();
    const bool halves = FilterHalves();
    zab::Terminate();
    std::puts(halves ? "the installed library works" : "the installed library does not do its work");
    return halves ? 0 : 1;
}
