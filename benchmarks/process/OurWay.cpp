#include "benchmarks/process/OurWay.h"

#include "benchmarks/process/BenchBundle.h"
#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"
#include "module/Module.h"
#include "utility/EffectUtils.h"

#include <cstdlib>
#include <stdexcept>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

std::string Printable(const UTF16String& name)
{
    const UTF8String text = zebcore::utility::UTF16to8(name.substr(0, name.find(u'\0')));
    return {text.begin(), text.end()};
}

boost::intrusive_ptr<AudioFilter> CreateFilter(const std::string& effect)
{
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    for (auto descriptor = catalogue.InfoBegin(); descriptor != catalogue.InfoEnd(); ++descriptor)
        if (Printable((*descriptor)->GetName()) == effect)
            if (auto filter = utility::CreateAudioFilter((*descriptor)->GetUniqueID()))
                return filter;
    throw std::runtime_error("no effect called " + effect);
}

void Connect(AudioFilter& filter, OurWay::Map map)
{
    filter.SetUseChannelMap(map != OurWay::Map::kNone);
    filter.SetDefaultChannelMap(AudioFilter::kDirection_Input);
    filter.SetDefaultChannelMap(AudioFilter::kDirection_Output);
    if (map != OurWay::Map::kSwappedOutputs)
        return;
    filter.AssignChannelMapping(AudioFilter::kDirection_Output, 0, 1);
    filter.AssignChannelMapping(AudioFilter::kDirection_Output, 1, 0);
}

} // namespace

OurLibrary::OurLibrary()
{
    setenv("VST3_PATH", BenchBundle::GetFolder().c_str(), 1);
    setenv("VST_PATH", "/nonexistent", 1);
    Initialize();
    std::vector<PluginLocator> gone;
    PluginModuleInfoManager::GetInstance().ResetToDefaultFolders();
    const auto found = PluginModuleInfoManager::GetInstance().CollectPotentialPlugins(true, gone);
    const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner(found, false));
    scanner->BeginScan();
    while (scanner->ContinueScan())
        zebcore::threads::PumpMainThread();
    scanner->EndScan();
}

OurLibrary::~OurLibrary()
{
    Terminate();
}

OurWay::OurWay(const std::string& effect, int frames, Map map)
    : mFilter(CreateFilter(effect)), mSide(&BenchBundle::GetInstance().GetLatestSide())
{
    const auto stereo = AudioFilterBusDescription::CreateStereo(u"Main", AudioFilterBusDescription::kBusType_Main);
    mFilter->RequestIOConfiguration({stereo.GetLayout()}, {stereo.GetLayout()});
    mFilter->SetMainTargetBus(stereo);
    Connect(*mFilter, map);
    mFilter->SetSampleRate(static_cast<float>(kSampleRate));
    mFilter->SetBlockSize(frames);
    mFilter->Resume();
}

OurWay::~OurWay()
{
    mFilter->Suspend();
    mFilter->FlushMessageQueue();
}

void OurWay::Process(float** in, float** out, int frames)
{
    ChannelFlags silent;
    mFilter->ProcessWithMapping(in, out, frames, ChannelFlags(), silent);
}

void OurWay::PostChanges(int count, float value)
{
    for (int index = 0; index < count; ++index)
        mFilter->PostSetParameter(index, value);
}

void OurWay::Tick()
{
    mFilter->OnUITimerTick();
}

} // namespace zebaudiofilterhost::benchmarks
