// The chunk of a VST 3 preset. The plug-in is one of our own that keeps whatever it is given.
#include "fuzz/support/Target.h"
#include "tests/vst3/FakePlugin.h"

#include <cstring>
#include <string_view>

namespace
{

using namespace zebfuzz;
using zebaudiofilterhost::PresetData;
using zebaudiofilterhost::PropList;

constexpr std::size_t kHeaderLength = 16;

struct States
{
    std::string_view component;
    std::string_view controller;
    bool fit = false;
};

std::uint64_t LittleEndian(std::string_view bytes)
{
    std::uint64_t number = 0;
    for (std::size_t index = 8; index-- > 0;)
        number = number << 8U | static_cast<unsigned char>(bytes[index]);
    return number;
}

States Split(std::string_view chunk)
{
    if (chunk.size() < kHeaderLength)
        return {};
    const std::uint64_t componentSize = LittleEndian(chunk);
    const std::uint64_t controllerSize = LittleEndian(chunk.substr(8));
    chunk.remove_prefix(kHeaderLength);
    if (componentSize > chunk.size() || controllerSize > chunk.size() - componentSize)
        return {};
    return {chunk.substr(0, componentSize), chunk.substr(componentSize, controllerSize), true};
}

fakeplugin::FakePlugin& Plugin()
{
    static fakeplugin::FakePlugin sPlugin;
    sPlugin.recording = false;
    return sPlugin;
}

void Run(Bytes bytes)
{
    fakeplugin::FakePlugin& plugin = Plugin();
    static const auto sFilter = plugin.MakeFilter();
    plugin.state = "old";
    plugin.controllerState = "former";
    PropList list;
    PresetData preset(list);
    preset.SetChunkData(bytes.data(), bytes.size());
    preset.SetVersion(1.0F);
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    Expect(sFilter->LoadSettings(preset), "a chunk is taken, whatever is in it");

    const std::string chunk(bytes.begin(), bytes.end());
    const States states = Split(chunk);
    if (!states.fit)
        return Expect(plugin.state == "old" && plugin.controllerState == "former",
                      "a chunk that is shorter than it says reaches no plug-in");
    Expect(plugin.state == states.component, "the component gets its bytes");
    Expect(plugin.controllerState == (states.controller.empty() ? "former" : states.controller),
           "the controller gets its bytes, if there are any");

    sFilter->SaveSettings(preset);
    std::vector<unsigned char> saved;
    preset.GetChunkData(saved);
    const States again = Split({reinterpret_cast<const char*>(saved.data()), saved.size()});
    Expect(again.fit && again.component == plugin.state && again.controller == plugin.controllerState,
           "what is loaded can be saved");
}

const Target kTarget("vst3_chunk", Run);

} // namespace
