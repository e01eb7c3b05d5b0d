#include "Operations.h"

#include "MainLoop.h"
#include "Throws.h"
#include "audiofilter/AudioFilterPresets.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/PropListUtils.h"

#include <algorithm>

namespace soak
{

using namespace zebaudiofilterhost;

namespace
{

constexpr unsigned int kEditorMs = 60;

AudioFilterBusDescription BusOf(std::size_t which)
{
    constexpr auto kMain = AudioFilterBusDescription::kBusType_Main;
    switch (which)
    {
    case 0:
        return AudioFilterBusDescription::CreateMono(u"Main", kMain);
    case 1:
        return AudioFilterBusDescription::CreateSurround51(u"Main", kMain);
    default:
        return AudioFilterBusDescription::CreateStereo(u"Main", kMain);
    }
}

} // namespace

const char* NameOf(Operation operation)
{
    constexpr std::array<const char*, kOperations> kNames = {
        "create",     "destroy",    "configure", "process", "parameters",  "save state",
        "load state", "state file", "preset",    "clone",   "open editor", "close editor"};
    return kNames[static_cast<std::size_t>(operation)];
}

Operations::Operations(Dice& dice, ProcessThread& thread, std::filesystem::path folder)
    : mDice(dice), mThread(thread), mFolder(std::move(folder))
{
}

void Operations::Run(Operation operation, Specimen& specimen)
{
    switch (operation)
    {
    case Operation::Configure:
        return Configure(specimen);
    case Operation::Process:
        return Process(specimen);
    case Operation::Parameters:
        return ChangeParameters(*specimen.Filter());
    case Operation::SaveState:
        return SaveState(specimen);
    case Operation::LoadState:
        return LoadState(specimen);
    case Operation::StateFile:
        return PassStateThroughFile(specimen);
    case Operation::Preset:
        return TakePreset(*specimen.Filter());
    case Operation::Clone:
        return Clone(specimen);
    case Operation::OpenEditor:
        specimen.OpenEditor();
        return Settle(kEditorMs);
    case Operation::CloseEditor:
        return specimen.CloseEditor();
    default:
        return;
    }
}

void Operations::Configure(Specimen& specimen)
{
    constexpr std::array<float, 3> kSampleRates = {44100.0F, 48000.0F, 96000.0F};
    constexpr std::array<int, 4> kBlockSizes = {64, 256, 512, 1024};
    constexpr std::size_t kBuses = 6; // four of six are stereo
    Setup setup;
    setup.bus = BusOf(mDice.Below(kBuses));
    setup.sampleRate = mDice.Pick(kSampleRates);
    setup.blockSize = mDice.Pick(kBlockSizes);
    setup.mapped = !mDice.OneIn(4);
    specimen.Configure(setup);
}

// Parameters are posted ahead and reach the filter among the blocks, on the process thread.
void Operations::Process(Specimen& specimen)
{
    AudioFilter& filter = *specimen.Filter();
    const int parameters = filter.GetParameterCount();
    for (int count = mDice.Between(0, 8); count > 0 && parameters > 0; --count)
    {
        const int index = mDice.Between(0, parameters - 1);
        filter.PostSetParameter(index, mDice.Unit());
    }
    std::vector<int> sizes(static_cast<std::size_t>(mDice.Between(1, 24)));
    std::generate(sizes.begin(), sizes.end(), [&] { return mDice.Between(1, specimen.BlockSize()); });
    specimen.Process(sizes, static_cast<std::uint32_t>(mDice.Below(1000000)), mThread);
}

void Operations::ChangeParameters(AudioFilter& filter)
{
    const int parameters = filter.GetParameterCount();
    for (int count = mDice.Between(1, 16); count > 0 && parameters > 0; --count)
    {
        const int index = mDice.Between(0, parameters - 1);
        filter.BeginEditing(index);
        filter.PostSetParameter(index, mDice.Unit());
        filter.EndEditing(index);
        filter.GetParameterString(index);
        filter.GetParameterInfo(index);
    }
    ServeLoop();
}

void Operations::SaveState(const Specimen& specimen)
{
    PresetData state(mStates[specimen.GetSubject().id]);
    specimen.Filter()->SaveSettings(state);
}

void Operations::LoadState(const Specimen& specimen)
{
    const auto saved = mStates.find(specimen.GetSubject().id);
    if (saved == mStates.end())
    {
        return SaveState(specimen);
    }
    if (!specimen.Filter()->LoadSettings(PresetData(saved->second)))
    {
        throw Fault("refuses the state that it has saved");
    }
}

void Operations::PassStateThroughFile(const Specimen& specimen)
{
    PropList saved;
    PresetData state(saved);
    specimen.Filter()->SaveSettings(state);
    const UTF16String path = zebcore::filesupport::FromNativePath((mFolder / "state.xml").string());
    zebcore::filesupport::File file(path);
    zebcore::proplist::utils::SavePropList(file, saved);
    PropList loaded;
    if (!zebcore::proplist::utils::LoadPropList(path, loaded, false) || !(PresetData(loaded) == state) ||
        !specimen.Filter()->LoadSettings(PresetData(loaded)))
    {
        throw Fault("has another state once that has been in a file");
    }
}

void Operations::TakePreset(AudioFilter& filter)
{
    const int presets = std::min(filter.GetNumFactoryPresets(), 4096);
    if (presets > 0)
    {
        const int index = mDice.Between(0, presets - 1);
        filter.GetFactoryPresetName(index);
        filter.SetFactoryPreset(index);
    }
    PropList content;
    PresetList list(content);
    filter.GetFactoryDefaultPresets(list);
}

void Operations::Clone(const Specimen& specimen)
{
    const Specimen::FilterPointer clone = AudioFilter::Clone(specimen.Filter());
    if (clone == nullptr)
    {
        throw Fault("can't be cloned");
    }
    Specimen twin(specimen.GetSubject(), clone);
    Configure(twin);
    Process(twin);
    twin.Close();
}

} // namespace soak
