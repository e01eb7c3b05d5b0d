// The chunk of a VST 3 preset. The plug-in is one of our own that keeps whatever it is given.
#include "fuzz/support/Target.h"
#include "tests/vst3/FakePlugin.h"

#include <optional>
#include <string>
#include <string_view>

namespace
{

using namespace zebfuzz;
using zebaudiofilterhost::PresetData;
using zebaudiofilterhost::PropList;

// What of a chunk reaches the plug-in: a state that is there as a whole.
struct States
{
    std::optional<std::string_view> component;
    std::optional<std::string_view> controller;
};

std::string_view Take(std::string_view& rest, std::size_t count)
{
    const std::string_view taken = rest.substr(0, count);
    rest.remove_prefix(taken.size());
    return taken;
}

std::uint64_t LittleEndian(std::string_view bytes)
{
    std::uint64_t number = 0;
    for (std::size_t index = bytes.size(); index-- > 0;)
        number = number << 8U | static_cast<unsigned char>(bytes[index]);
    return number;
}

std::optional<std::string_view> TakeState(std::string_view& rest, std::uint64_t size)
{
    const std::uint64_t count = size & 0xffffffffU;
    if (count > 0x7fffffffU)
        return std::nullopt;
    const std::string_view state = Take(rest, count);
    return state.size() == count ? std::optional(state) : std::nullopt;
}

States Split(std::string_view chunk)
{
    const std::uint64_t componentSize = LittleEndian(Take(chunk, 8));
    const std::uint64_t controllerSize = LittleEndian(Take(chunk, 8));
    States states;
    states.component = TakeState(chunk, componentSize);
    if (controllerSize != 0)
        states.controller = TakeState(chunk, controllerSize);
    return states;
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
    const States states = bytes.empty() ? States() : Split(chunk);
    Expect(plugin.state == states.component.value_or("old"), "the component gets its bytes whole, or nothing");
    Expect(plugin.controllerState == states.controller.value_or("former"),
           "the controller gets its bytes whole, or nothing");

    sFilter->SaveSettings(preset);
    std::vector<unsigned char> saved;
    preset.GetChunkData(saved);
    const States again = Split({reinterpret_cast<const char*>(saved.data()), saved.size()});
    Expect(again.component.value_or("") == plugin.state && again.controller.value_or("") == plugin.controllerState,
           "what is loaded can be saved");
}

const Target kTarget("vst3_chunk", Run);

} // namespace
