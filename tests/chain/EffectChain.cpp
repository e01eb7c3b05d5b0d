#include "tests/chain/EffectChain.h"

#include "audiofilter/AudioFilterProxy.h"
#include "audiofilter/PresetData.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "utility/EffectUtils.h"

#include <algorithm>
#include <stdexcept>

namespace chain
{

using namespace zebaudiofilterhost;

namespace
{

using Buses = std::vector<AudioFilterBusDescription>;
using Block = std::vector<float*>;

UTF8String Numbered(const UTF8String& key, std::size_t index)
{
    const std::string number = std::to_string(index);
    return key + UTF8String(number.begin(), number.end());
}

File ToFile(const std::filesystem::path& path)
{
    return File(zebcore::filesupport::FromNativePath(path.string()));
}

void WriteBuses(PropList& list, const Buses& buses)
{
    for (std::size_t index = 0; index < buses.size(); ++index)
    {
        PropList& section = list.GetOrCreateSubList(Numbered(u8"bus", index));
        section.SetValue(u8"name", buses[index].GetName());
        section.SetValue(u8"type", static_cast<int>(buses[index].GetType()));
        std::list<float> labels;
        for (const AudioChannelDescription& channel : buses[index].GetLayout())
        {
            labels.push_back(static_cast<float>(channel.GetLabel()));
        }
        section.SetValue(u8"labels", labels);
    }
}

Buses ReadBuses(const PropList& list)
{
    Buses buses;
    while (const PropList* const section = list.GetSubList(Numbered(u8"bus", buses.size())))
    {
        UTF16String name;
        int type = 0;
        std::list<float> labels;
        section->GetValue(u8"name", name);
        section->GetValue(u8"type", type);
        section->GetValue(u8"labels", labels);
        ChannelLayout layout;
        for (const float label : labels)
        {
            layout.emplace_back(static_cast<AudioChannelLabel>(label));
        }
        buses.emplace_back(name, layout, static_cast<AudioFilterBusDescription::Type>(type));
    }
    return buses;
}

std::vector<ChannelLayout> LayoutsOf(const Buses& buses)
{
    std::vector<ChannelLayout> layouts;
    std::transform(buses.begin(), buses.end(), std::back_inserter(layouts),
                   [](const AudioFilterBusDescription& bus) { return bus.GetLayout(); });
    return layouts;
}

void WriteFilter(PropList& list, const AudioFilter& filter)
{
    list.SetValue(u8"id", filter.GetID());
    list.SetValue(u8"name", filter.GetDisplayName());
    list.SetValue(u8"parameters", static_cast<unsigned int>(filter.GetParameterCount()));
    list.SetValue(u8"chunk", filter.DoPresetsUseChunkData());
    list.SetValue(u8"preset", filter.GetPresetNameAndDirtyState().first);
    list.SetValue(u8"dirty", filter.GetPresetNameAndDirtyState().second);
    WriteBuses(list.GetOrCreateSubList(u8"inputs"), filter.GetInputBuses());
    WriteBuses(list.GetOrCreateSubList(u8"outputs"), filter.GetOutputBuses());
    filter.SaveChannelMapSettings(&list.GetOrCreateSubList(u8"maps"));
    PresetData settings(list.GetOrCreateSubList(u8"settings"));
    filter.SaveSettings(settings);
}

FilterPtr MakeProxy(const PropList& list, const UTF16String& id, const Buses& inputs, const Buses& outputs)
{
    UTF16String name;
    unsigned int parameters = 0;
    bool usesChunk = false;
    list.GetValue(u8"name", name);
    list.GetValue(u8"parameters", parameters);
    list.GetValue(u8"chunk", usesChunk);
    FilterPtr proxy(new AudioFilterProxy(id, name, parameters, usesChunk));
    proxy->AddInputBuses(inputs);
    proxy->AddOutputBuses(outputs);
    return proxy;
}

FilterPtr ReadFilter(PropList& list)
{
    UTF16String id;
    std::pair<UTF16String, bool> preset;
    list.GetValue(u8"id", id);
    list.GetValue(u8"preset", preset.first);
    list.GetValue(u8"dirty", preset.second);
    const Buses inputs = ReadBuses(list.GetOrCreateSubList(u8"inputs"));
    const Buses outputs = ReadBuses(list.GetOrCreateSubList(u8"outputs"));
    FilterPtr filter = utility::CreateAudioFilter(id);
    if (filter)
    {
        filter->RequestIOConfiguration(LayoutsOf(inputs), LayoutsOf(outputs));
    }
    else
    {
        filter = MakeProxy(list, id, inputs, outputs);
    }
    FitIn(*filter);
    filter->LoadSettings(PresetData(list.GetOrCreateSubList(u8"settings")));
    filter->LoadChannelMapSettings(&list.GetOrCreateSubList(u8"maps"));
    filter->SetPresetNameAndDirtyState(preset);
    return filter;
}

FilterPtr Find(const UTF16String& name)
{
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    const auto found =
        std::find_if(catalogue.InfoBegin(), catalogue.InfoEnd(),
                     [&name](const auto& each) { return (*each).GetName().substr(0, name.size()) == name; });
    FilterPtr filter;
    if (found != catalogue.InfoEnd())
    {
        filter = utility::CreateAudioFilter((*found)->GetUniqueID());
    }
    if (!filter)
    {
        throw std::runtime_error("no filter " + zebcore::utility::NarrowFromUTF16(name));
    }
    return filter;
}

// What passes a filter by waits for the latency of the last time that it ran, so one that has loaded settings runs
// twice.
void Resume(AudioFilter& filter)
{
    filter.Resume();
    filter.Suspend();
    filter.Resume();
}

Block At(Channels& channels, std::size_t first)
{
    Block block;
    std::transform(channels.begin(), channels.end(), std::back_inserter(block),
                   [first](std::vector<float>& channel) { return channel.data() + first; });
    return block;
}

ChannelFlags SilentChannels(const Block& block)
{
    ChannelFlags flags;
    for (unsigned int channel = 0; channel < block.size(); ++channel)
    {
        if (std::all_of(block[channel], block[channel] + kFrames, [](float sample) { return sample == 0.0F; }))
        {
            flags.Set(ChannelBit(channel));
        }
    }
    return flags;
}

// What a filter leaves in the buffer of a silent channel is nobody's business.
void Silence(const Block& block, ChannelFlags flags)
{
    for (unsigned int channel = 0; channel < block.size(); ++channel)
    {
        if (flags.IsSet(ChannelBit(channel)))
        {
            std::fill_n(block[channel], kFrames, 0.0F);
        }
    }
}

// Of the application's channels.
unsigned long long BitsOf(ChannelFlags flags)
{
    unsigned long long bits = 0;
    for (unsigned int channel = 0; channel < kChannels; ++channel)
    {
        bits |= flags.IsSet(ChannelBit(channel)) ? ChannelBit(channel) : 0;
    }
    return bits;
}

} // namespace

EffectChain::EffectChain(const std::vector<std::u16string>& names)
{
    std::transform(names.begin(), names.end(), std::back_inserter(mFilters),
                   [](const std::u16string& name) { return Find(name); });
}

EffectChain EffectChain::Load(const std::filesystem::path& file)
{
    PropList list;
    zebcore::proplist::utils::LoadPropList(ToFile(file).FullPath(), list, false);
    EffectChain chain;
    while (PropList* const section = list.GetSubList(Numbered(u8"filter", chain.Count())))
    {
        chain.mFilters.push_back(ReadFilter(*section));
    }
    return chain;
}

void EffectChain::Save(const std::filesystem::path& file) const
{
    PropList list;
    for (std::size_t index = 0; index < Count(); ++index)
    {
        WriteFilter(list.GetOrCreateSubList(Numbered(u8"filter", index)), *mFilters[index]);
    }
    File target = ToFile(file);
    zebcore::proplist::utils::SavePropList(target, list);
}

void EffectChain::WakeProxies()
{
    for (FilterPtr& filter : mFilters)
    {
        const auto* const proxy = dynamic_cast<const AudioFilterProxy*>(filter.get());
        const FilterPtr awake = proxy != nullptr ? proxy->CreateAudioFilterFromZombieState() : nullptr;
        if (awake)
        {
            awake->SetMainTargetBus(filter->GetMainTargetBus()); // the proxy does not pass it on
            filter = awake;
        }
    }
}

Rendered EffectChain::Render(const Channels& input)
{
    Rendered rendered{input, std::vector<std::vector<unsigned long long>>(Count())};
    Channels other = input;
    for (const FilterPtr& filter : mFilters)
    {
        Resume(*filter);
    }
    for (std::size_t first = 0; first < input.front().size(); first += kFrames)
    {
        RenderBlock(rendered, other, first);
    }
    for (const FilterPtr& filter : mFilters)
    {
        filter->Suspend();
    }
    return rendered;
}

// From one buffer into the other and back, filter by filter.
void EffectChain::RenderBlock(Rendered& rendered, Channels& other, std::size_t first)
{
    Block in = At(rendered.sound, first);
    Block out = At(other, first);
    ChannelFlags silent = SilentChannels(in);
    for (std::size_t index = 0; index < Count(); ++index)
    {
        ChannelFlags flags;
        mFilters[index]->ProcessWithMapping(in.data(), out.data(), kFrames, silent, flags);
        silent = flags;
        Silence(out, silent);
        rendered.silent[index].push_back(BitsOf(silent));
        in.swap(out);
    }
    for (std::size_t channel = 0; channel < in.size(); ++channel)
    {
        std::copy_n(in[channel], kFrames, rendered.sound[channel].data() + first);
    }
}

void FitIn(AudioFilter& filter)
{
    filter.SetSampleRate(48000.0F);
    filter.SetBlockSize(kFrames);
    filter.SetMainTargetBus(
        AudioFilterBusDescription::CreateSurround51(u"Track", AudioFilterBusDescription::kBusType_Main));
    filter.SetUseChannelMap(true);
}

} // namespace chain
