// Finds the effects of this machine and sends a second of noise through one of them.
//   zeb_minimal [NAME]     the first effect that is found, or the one of that name; VST3_PATH and VST_PATH
//                          may name other folders
#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"
#include "module/Module.h"
#include "utility/EffectUtils.h"

#include <algorithm>
#include <cmath>
#include <iostream>
#include <random>
#include <string_view>

using namespace zebaudiofilterhost;

namespace
{

constexpr int kBlock = 512;
constexpr float kSampleRate = 48000.0F;

// Loads every plug-in that the catalogue doesn't know yet. An application would save what was found, and go on with
// the others if a plug-in throws in its step.
void Scan()
{
    std::vector<PluginLocator> gone;
    PluginModuleInfoManager::GetInstance().ResetToDefaultFolders();
    const auto found = PluginModuleInfoManager::GetInstance().CollectPotentialPlugins(true, gone);
    const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner(found, false));
    scanner->BeginScan();
    while (scanner->ContinueScan())
        zebcore::threads::PumpMainThread();
    scanner->EndScan();
}

// Prints a name as text: it may come padded with zero units.
std::string Printable(const UTF16String& name)
{
    const UTF8String text = zebcore::utility::UTF16to8(name.substr(0, name.find(u'\0')));
    return {text.begin(), text.end()};
}

boost::intrusive_ptr<AudioFilter> Find(std::string_view wanted)
{
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    for (auto descriptor = catalogue.InfoBegin(); descriptor != catalogue.InfoEnd(); ++descriptor)
        if (wanted.empty() || Printable((*descriptor)->GetName()) == wanted)
            return utility::CreateAudioFilter((*descriptor)->GetUniqueID());
    return nullptr;
}

// Stereo in, stereo out, ready to process.
void Prepare(AudioFilter& filter)
{
    const auto stereo = AudioFilterBusDescription::CreateStereo(u"Main", AudioFilterBusDescription::kBusType_Main);
    filter.RequestIOConfiguration({stereo.GetLayout()}, {stereo.GetLayout()});
    filter.SetMainTargetBus(stereo);
    filter.SetDefaultChannelMap(AudioFilter::kDirection_Input);
    filter.SetDefaultChannelMap(AudioFilter::kDirection_Output);
    filter.SetUseChannelMap(true);
    filter.SetSampleRate(kSampleRate);
    filter.SetBlockSize(kBlock);
    filter.Resume();
}

// How loud a second of noise gets behind the filter. In an application this runs on the audio thread.
float ProcessNoise(AudioFilter& filter)
{
    std::minstd_rand random;
    std::uniform_real_distribution<float> noise(-0.5F, 0.5F);
    std::vector<float> left(kBlock);
    std::vector<float> right(kBlock);
    float* channels[] = {left.data(), right.data()}; // each is processed in place
    float peak = 0.0F;
    for (int frame = 0; frame < static_cast<int>(kSampleRate); frame += kBlock)
    {
        ChannelFlags silent;
        std::generate(left.begin(), left.end(), [&] { return noise(random); });
        right = left;
        filter.ProcessWithMapping(channels, channels, kBlock, ChannelFlags(), silent);
        for (const float* channel : channels)
            for (int index = 0; index < kBlock; ++index)
                peak = std::max(peak, std::abs(channel[index]));
    }
    return peak;
}

} // namespace

int main(int argc, char** argv)
{
    Initialize();
    Scan();
    const auto filter = Find(argc > 1 ? argv[1] : "");
    if (!filter)
    {
        std::cerr << "No such effect.\n";
        return 1;
    }
    Prepare(*filter);
    std::cout << Printable(filter->GetDisplayName()) << ": latency " << filter->GetInitialDelay() << ", parameters "
              << filter->GetParameterCount() << ", peak " << ProcessNoise(*filter) << '\n';
    filter->Suspend();
    Terminate();
}
