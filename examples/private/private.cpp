// An application that ships its effects inside its own folder and never scans them.
//   zeb_private [NAME]     lists its effects, or sends a second of sound through the one of that name
#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "module/Module.h"
#include "utility/EffectUtils.h"
#include "utility/PrivatePluginUtils.h"

#include <algorithm>
#include <iostream>
#include <string_view>

using namespace zebaudiofilterhost;

namespace
{

constexpr int kBlock = 480;
constexpr float kSampleRate = 48000.0F;

// The catalogue was made when the application was built. It holds placeholders for the folders of the plug-ins, which
// are known only here: wherever the user has put the application. No plug-in is opened, nor looked for.
void LoadCatalogue()
{
    const Dir plugIns(Dir::AppDir(), u"Plug-Ins");
    utility::SetPrivatePluginConfigFromFile(File(Dir::AppDir(), utility::kPrivatePluginConfigResourceName).FullPath(),
                                            Dir(plugIns, u"VST3").FullPath(), Dir(plugIns, u"VST").FullPath());

    // Behind it come the plug-ins that the user has installed, if a scan has found any.
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    File settings(Dir::PrefDir(), manager.GetSettingsFileName());
    manager.LoadConfiguration(settings);
}

// Prints a name as text: it may come padded with zero units.
std::string Printable(const UTF16String& name)
{
    const UTF8String text = zebcore::utility::UTF16to8(name.substr(0, name.find(u'\0')));
    return {text.begin(), text.end()};
}

void PrintCatalogue()
{
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    for (auto effect = catalogue.InfoBegin(); effect != catalogue.InfoEnd(); ++effect)
        std::cout << Printable((*effect)->GetName()) << ": " << Printable((*effect)->GetLocator().GetPath()) << '\n';
}

// Only now is the plug-in loaded, and no other.
boost::intrusive_ptr<AudioFilter> Create(std::string_view name)
{
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    const auto effect = std::find_if(catalogue.InfoBegin(), catalogue.InfoEnd(),
                                     [name](const auto& each) { return Printable(each->GetName()) == name; });
    return effect == catalogue.InfoEnd() ? nullptr : utility::CreateAudioFilter((*effect)->GetUniqueID());
}

// The loudest sample of a second of a square wave behind the effect, which works in place.
float Process(AudioFilter& filter)
{
    filter.SetSampleRate(kSampleRate);
    filter.SetBlockSize(kBlock);
    filter.Resume();
    std::vector<float> left(kBlock);
    std::vector<float> right(kBlock);
    float* channels[] = {left.data(), right.data()};
    float peak = 0.0F;
    for (int frame = 0; frame < static_cast<int>(kSampleRate); frame += kBlock)
    {
        std::fill_n(left.begin(), kBlock / 2, 0.5F);
        std::fill_n(left.begin() + kBlock / 2, kBlock / 2, -0.5F);
        right = left;
        ChannelFlags silent;
        filter.ProcessWithMapping(channels, channels, kBlock, ChannelFlags(), silent);
        peak = std::max(peak, *std::max_element(left.begin(), left.end()));
    }
    filter.Suspend();
    return peak;
}

int Run(int argc, char** argv)
{
    if (argc < 2)
    {
        PrintCatalogue();
        return 0;
    }
    const auto filter = Create(argv[1]);
    if (!filter)
    {
        std::cerr << argv[1] << ": there is no such effect, or it can't be loaded.\n";
        return 1;
    }
    std::cout << argv[1] << ": peak " << Process(*filter) << '\n';
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    Initialize();
    LoadCatalogue();
    const int result = Run(argc, argv);
    Terminate();
    return result;
}
