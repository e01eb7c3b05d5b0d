// The chunk of an Audio Unit's preset: the class info of a unit of our own.
#include "audiofilter/PresetData.h"
#include "foundation/zebcore/PropList.h"
#include "fuzz/support/UnitList.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;
using xau::FakeUnit;

constexpr unsigned int kMilliseconds = 50; // in which listeners are told

const FakeUnit::Key kClassInfo = xau::Global(kAudioUnitProperty_ClassInfo);

struct Host
{
    xau::TestClock clock;
    FakeUnit unit;
    boost::intrusive_ptr<xau::XAUAudioFilter> filter = unit.MakeFilter();
};

void CheckLoading(Host& host, const PresetData& preset, bool isList)
{
    host.unit.mCalls.clear();
    Expect(host.filter->LoadChunkData(preset) == isList, "a chunk is taken if it is a property list");
    Expect(host.unit.CountCalls("set 0 0 0") == (isList ? 1U : 0U), "a chunk that is none reaches no unit");
    host.unit.Forget(kClassInfo); // released by now
    host.clock.Pass(kMilliseconds);
}

void CheckSaving(Host& host, const CFOwner& list)
{
    host.unit.Answer(kClassInfo, list.get());
    PropList content;
    PresetData preset(content);
    Expect(host.filter->SaveChunkData(preset), "a class info that was loaded can be saved");
    std::vector<unsigned char> saved;
    preset.GetChunkData(saved);
    const CFOwner back = ParseUnitList(saved);
    Expect(back != nullptr, "a class info that was saved can be read");
    Expect(AreSameLists(back.get(), list.get()), "and reads as the same");
}

void Run(Bytes bytes)
{
    static Host sHost;
    PropList content;
    PresetData preset(content);
    preset.SetChunkData(bytes.data(), bytes.size());
    preset.SetVersion(sHost.filter->GetCurrentPresetVersion());
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    const CFOwner list = ParseUnitList(bytes);
    CheckLoading(sHost, preset, list != nullptr);
    if (list)
        CheckSaving(sHost, list);
}

const Target kTarget("xau_presets", Run);

} // namespace
