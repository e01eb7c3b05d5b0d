// P7: an effect's state to a text in memory and back ("save" and "load"), as the peer writes and reads one; to a
// property list and back ("save-tree" and "load-tree"), as an application keeps it in its document; through a preset
// file
// ("save-file" and "load-file"). P8: the floating-point mode behind a block.
#include "audiofilter/PresetData.h"
#include "benchmarks/catalogue/CatalogueContent.h"
#include "benchmarks/catalogue/PeakMemory.h"
#include "benchmarks/catalogue/StateFilter.h"
#include "benchmarks/catalogue/plugin/StateContent.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#if defined(ZEB_HAS_PEER)
#include "benchmarks/peer/PeerFilter.h"
#endif

#include <benchmark/benchmark.h>

#include <immintrin.h>

#include <algorithm>
#include <array>
#include <string>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

using benchmark::State;
using zebcore::proplist::PropList;
using Bytes = std::vector<unsigned char>;
using FilterPointer = boost::intrusive_ptr<AudioFilter>;

// An effect's state outside of it: as a property list and as its text.
struct Kept
{
    PropList tree;
    UTF8String text;
};

using Operation = void (*)(AudioFilter& filter, Kept& kept);

File PresetFile()
{
    return File(zebcore::utility::UTF16FromNarrow((WorkFolder() / "preset.xml").string()));
}

void SaveTree(AudioFilter& filter, Kept& kept)
{
    PresetData data(kept.tree);
    filter.SaveSettings(data);
}

void LoadTree(AudioFilter& filter, Kept& kept)
{
    filter.LoadSettings(PresetData(kept.tree));
}

void Save(AudioFilter& filter, Kept& kept)
{
    Kept fresh;
    SaveTree(filter, fresh);
    zebcore::proplist::utils::WritePropList(kept.text, fresh.tree);
}

void Load(AudioFilter& filter, Kept& kept)
{
    Kept read;
    zebcore::proplist::utils::ReadPropList(kept.text, read.tree);
    LoadTree(filter, read);
}

void SaveToFile(AudioFilter& filter, Kept&)
{
    Kept fresh;
    SaveTree(filter, fresh);
    File file = PresetFile();
    zebcore::proplist::utils::SavePropList(file, fresh.tree);
}

void LoadFromFile(AudioFilter& filter, Kept&)
{
    Kept read;
    zebcore::proplist::utils::LoadPropList(PresetFile().FullPath(), read.tree, false);
    LoadTree(filter, read);
}

Bytes StateOf(AudioFilter& filter)
{
    Kept kept;
    SaveTree(filter, kept);
    Bytes chunk;
    PresetData(kept.tree).GetChunkData(chunk);
    return chunk;
}

// An effect with another state takes over that of `filter`, of so many bytes, through the operation; the bytes that
// then differ from those that the plug-in has made. They are the end of the chunk, since its controller keeps
// nothing.
double DifferingBytes(AudioFilter& filter, int bytes, Kept& kept, Operation load)
{
    const FilterPointer other = MakeStateFilter(1);
    load(*other, kept);
    const Bytes found = StateOf(*other);
    Bytes expected = StateOf(filter);
    const std::vector<char> content = effects::state::Content(static_cast<std::size_t>(bytes));
    std::copy(content.begin(), content.end(), expected.end() - bytes);
    const std::size_t common = std::min(expected.size(), found.size());
    double differing = static_cast<double>(std::max(expected.size(), found.size()) - common);
    for (std::size_t index = 0; index < common; ++index)
        differing += expected[index] == found[index] ? 0 : 1;
    return differing;
}

void RunOurs(State& state, int bytes, Operation operation, Operation load)
{
    const FilterPointer filter = MakeStateFilter(bytes);
    if (StateOf(*filter).size() < static_cast<std::size_t>(bytes))
        return state.SkipWithError("the effect lost its state");
    Kept kept;
    SaveTree(*filter, kept);
    Save(*filter, kept);
    SaveToFile(*filter, kept);
    {
        const PeakMemory peak;
        operation(*filter, kept);
        state.counters["peak"] = static_cast<double>(peak.Bytes()) / bytes;
    }
    state.counters["differing"] = DifferingBytes(*filter, bytes, kept, load);
    for ([[maybe_unused]] auto round : state)
        operation(*filter, kept);
}

#if defined(ZEB_HAS_PEER)
void LoadPeer(PeerFilter& filter, int bytes, State& state)
{
    setenv("ZEB_STATE_BYTES", std::to_string(bytes).c_str(), 1);
    if (!filter.Load(StateBundle()))
        state.SkipWithError(filter.GetError().c_str());
}

void SavePeer(State& state, int bytes)
{
    PeerFilter filter;
    LoadPeer(filter, bytes, state);
    for ([[maybe_unused]] auto round : state)
        benchmark::DoNotOptimize(filter.GetState());
    if (filter.GetState().size() < static_cast<std::size_t>(bytes))
        state.SkipWithError("the peer lost the state");
}

void RestorePeer(State& state, int bytes)
{
    PeerFilter filter;
    LoadPeer(filter, bytes, state);
    const std::vector<char> saved = filter.GetState();
    for ([[maybe_unused]] auto round : state)
        filter.SetState(saved);
    if (filter.GetState() != saved)
        state.SkipWithError("the peer changed the state");
}

void RegisterPeer(int bytes)
{
    const std::string size = "/bytes:" + std::to_string(bytes) + "/way:peer";
    benchmark::RegisterBenchmark(("P7/save" + size).c_str(), SavePeer, bytes);
    benchmark::RegisterBenchmark(("P7/load" + size).c_str(), RestorePeer, bytes);
}
#else
void RegisterPeer(int)
{
}
#endif

void Register(const std::string& row, int bytes, Operation operation, Operation load)
{
    for (const char* const way : {"ours", "again"})
        benchmark::RegisterBenchmark((row + "/bytes:" + std::to_string(bytes) + "/way:" + way).c_str(), RunOurs,
                                     bytes, operation, load);
}

// Counts the blocks after which the caller finds another mode than it had.
void KeepMode(State& state)
{
    constexpr int kFrames = 64;
    const FilterPointer filter = MakeStateFilter(0);
    filter->SetBlockSize(kFrames);
    filter->Resume();
    std::array<float, kFrames> samples{};
    std::array<float*, 2> channels = {samples.data(), samples.data()};
    constexpr unsigned int kStatus = 0x3F; // What computations have met
    const unsigned int before = _mm_getcsr() & ~kStatus;
    double changed = 0;
    for ([[maybe_unused]] auto round : state)
    {
        ChannelFlags silent;
        filter->ProcessWithMapping(channels.data(), channels.data(), kFrames, ChannelFlags(), silent);
        changed += (_mm_getcsr() & ~kStatus) == before ? 0 : 1;
        _mm_setcsr(before);
    }
    state.counters["changed"] = changed;
    filter->Suspend();
}

void RegisterRows()
{
    for (const int bytes : {200, 10000, 10000000})
    {
        Register("P7/save", bytes, Save, Load);
        Register("P7/load", bytes, Load, Load);
        Register("P7/save-tree", bytes, SaveTree, LoadTree);
        Register("P7/load-tree", bytes, LoadTree, LoadTree);
        Register("P7/save-file", bytes, SaveToFile, LoadFromFile);
        Register("P7/load-file", bytes, LoadFromFile, LoadFromFile);
        RegisterPeer(bytes);
    }
    benchmark::RegisterBenchmark("P8/mode/way:ours", KeepMode);
}

} // namespace

} // namespace zebaudiofilterhost::benchmarks

int main(int argc, char** argv)
{
    zebaudiofilterhost::benchmarks::PeakMemory::ReturnLargeBlocks();
    zebaudiofilterhost::benchmarks::RegisterRows();
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
