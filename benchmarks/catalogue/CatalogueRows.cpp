// P4: what a catalogue of so many plug-ins costs: loading it, saving it, looking all of them up, entering them. One
// unit of work is the whole catalogue.
#include "benchmarks/catalogue/CatalogueContent.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"

#include <benchmark/benchmark.h>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

using benchmark::State;

std::filesystem::path SettingsOf(int plugins)
{
    return WorkFolder() / ("catalogue-" + std::to_string(plugins) + ".xml");
}

File FileAt(const std::filesystem::path& path)
{
    return File(zebcore::utility::UTF16FromNarrow(path.string()));
}

// The catalogue as an application has it after its start: read from the file.
bool LoadFromFile(State& state, int plugins)
{
    File file = FileAt(SettingsOf(plugins));
    if (!file.Exists())
    {
        FillCatalogue(plugins);
        PluginModuleInfoManager::GetInstance().SaveConfiguration(file, true);
    }
    EmptyCatalogue();
    PluginModuleInfoManager::GetInstance().LoadConfiguration(file);
    if (!CatalogueHolds(plugins))
    {
        state.SkipWithError("the catalogue did not come back as it was saved");
        return false;
    }
    return true;
}

void Load(State& state, int plugins)
{
    if (!LoadFromFile(state, plugins))
        return;
    for ([[maybe_unused]] auto round : state)
    {
        File file = FileAt(SettingsOf(plugins));
        PluginModuleInfoManager::GetInstance().LoadConfiguration(file);
    }
    if (!CatalogueHolds(plugins))
        state.SkipWithError("a load lost plug-ins");
}

void Save(State& state, int plugins)
{
    if (!LoadFromFile(state, plugins))
        return;
    const std::filesystem::path saved = WorkFolder() / "saved.xml";
    for ([[maybe_unused]] auto round : state)
    {
        File file = FileAt(saved);
        PluginModuleInfoManager::GetInstance().SaveConfiguration(file, true);
    }
    if (std::filesystem::file_size(saved) != std::filesystem::file_size(SettingsOf(plugins)))
        state.SkipWithError("a save lost plug-ins");
}

void FindIDs(State& state, int plugins, const std::vector<int>& numbers)
{
    if (!LoadFromFile(state, plugins))
        return;
    std::vector<UTF16String> ids;
    for (const int index : numbers)
        ids.push_back(FilterIDOf(index));
    const AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    for ([[maybe_unused]] auto round : state)
    {
        for (const UTF16String& id : ids)
            benchmark::DoNotOptimize(manager.GetComponentDescriptorForID(id));
    }
    for (const UTF16String& id : ids)
    {
        const auto found = manager.GetComponentDescriptorForID(id);
        if (found == nullptr || found->GetUniqueID() != id)
            state.SkipWithError("an ID was not found");
    }
}

void FindLocators(State& state, int plugins, const std::vector<int>& numbers)
{
    if (!LoadFromFile(state, plugins))
        return;
    std::vector<PluginLocator> locators;
    for (const int index : numbers)
        locators.push_back(LocatorOf(index));
    const PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    for ([[maybe_unused]] auto round : state)
    {
        for (const PluginLocator& locator : locators)
            benchmark::DoNotOptimize(manager.FindPluginInfo(locator));
    }
    for (const PluginLocator& locator : locators)
    {
        const auto found = manager.FindPluginInfo(locator);
        if (found == nullptr || found->GetLocator() != locator)
            state.SkipWithError("a locator was not found");
    }
}

// One after the other, as a list or a project asks for them.
void FindByID(State& state, int plugins)
{
    FindIDs(state, plugins, Ordered(plugins));
}

void FindByLocator(State& state, int plugins)
{
    FindLocators(state, plugins, Ordered(plugins));
}

// All over the catalogue, so that a large one is seen to leave the processor's cache.
void FindByIDAnywhere(State& state, int plugins)
{
    FindIDs(state, plugins, Shuffled(plugins));
}

void FindByLocatorAnywhere(State& state, int plugins)
{
    FindLocators(state, plugins, Shuffled(plugins));
}

std::vector<boost::intrusive_ptr<PluginModuleInfo>> Records(const std::vector<int>& numbers)
{
    std::vector<boost::intrusive_ptr<PluginModuleInfo>> records;
    for (const int index : numbers)
        records.push_back(RecordOf(index));
    return records;
}

// A first scan: each plug-in is new.
void AddNew(State& state, int plugins)
{
    const auto records = Records(Ordered(plugins));
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    for ([[maybe_unused]] auto round : state)
    {
        state.PauseTiming();
        EmptyCatalogue();
        state.ResumeTiming();
        for (const auto& record : records)
            manager.AddPluginModuleInfo(record);
    }
    if (std::distance(manager.PluginInfoBegin(), manager.PluginInfoEnd()) != plugins)
        state.SkipWithError("a record was not entered");
}

// A scan of everything once more: each plug-in replaces its own record.
void AddKnown(State& state, int plugins)
{
    if (!LoadFromFile(state, plugins))
        return;
    const auto records = Records(Ordered(plugins));
    PluginModuleInfoManager& manager = PluginModuleInfoManager::GetInstance();
    for ([[maybe_unused]] auto round : state)
    {
        for (const auto& record : records)
            manager.AddPluginModuleInfo(record);
    }
    if (!std::equal(manager.PluginInfoBegin(), manager.PluginInfoEnd(), records.begin(), records.end()))
        state.SkipWithError("a record was not replaced");
}

void Register(const std::string& operation, void (*function)(State&, int), int plugins)
{
    const std::string row = "P4/" + operation + "/plugins:" + std::to_string(plugins) + "/way:";
    for (const char* const way : {"ours", "again"})
        benchmark::RegisterBenchmark((row + way).c_str(), function, plugins)->Unit(benchmark::kMillisecond);
}

#if defined(ZEB_HAS_PEER)
constexpr int kPeerPlugins = 8000;

void FillPeer(PeerCatalogue& catalogue)
{
    for (int index = 0; index < kPeerPlugins; ++index)
        catalogue.Add(PeerPluginOf(index));
}

std::string PeerFile()
{
    return WorkFolder() / "peer.xml";
}

void PeerLoad(State& state)
{
    if (!std::filesystem::exists(PeerFile()))
    {
        PeerCatalogue made;
        FillPeer(made);
        made.Save(PeerFile());
    }
    PeerCatalogue catalogue;
    for ([[maybe_unused]] auto round : state)
        catalogue.Load(PeerFile());
    const PeerCatalogue::Plugin last = PeerPluginOf(kPeerPlugins - 1);
    if (catalogue.Size() != kPeerPlugins || catalogue.FindName(last.path) != last.name)
        state.SkipWithError("the peer lost plug-ins");
}

void PeerSave(State& state)
{
    PeerCatalogue catalogue;
    FillPeer(catalogue);
    bool saved = true;
    for ([[maybe_unused]] auto round : state)
        saved = catalogue.Save(PeerFile()) && saved;
    if (!saved)
        state.SkipWithError("the peer could not save");
}

void RegisterPeer()
{
    benchmark::RegisterBenchmark("P4/load/plugins:8000/way:peer", PeerLoad)->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("P4/save/plugins:8000/way:peer", PeerSave)->Unit(benchmark::kMillisecond);
}
#else
void RegisterPeer()
{
}
#endif

void RegisterRows()
{
    for (const int plugins : {100, 1000, 8000, 10000})
    {
        Register("load", Load, plugins);
        Register("save", Save, plugins);
        Register("find-id", FindByID, plugins);
        Register("find-locator", FindByLocator, plugins);
        Register("find-id-anywhere", FindByIDAnywhere, plugins);
        Register("find-locator-anywhere", FindByLocatorAnywhere, plugins);
        Register("add", AddNew, plugins);
        Register("add-known", AddKnown, plugins);
    }
    RegisterPeer();
}

} // namespace

} // namespace zebaudiofilterhost::benchmarks

int main(int argc, char** argv)
{
    zebaudiofilterhost::benchmarks::RegisterRows();
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
