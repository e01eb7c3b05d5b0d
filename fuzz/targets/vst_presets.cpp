// Presets of VST 2 effects, with and without chunks. The effect is one of our own that keeps whatever it is given.
#include "audiofilter/PresetData.h"
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/vst/support/FakeEffect.h"
#include "utility/ThreadUtils.h"

#include <cstring>
#include <list>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;
using vst::VSTAudioFilter;

using Chunk = std::vector<unsigned char>;

// An effect with two parameters, two programs and a state.
class Effect
{
public:
    explicit Effect(bool usesChunks)
    {
        InitializeMainThreadID();
        mFake.recording = false;
        mFake.effect.numParams = 2;
        mFake.effect.numPrograms = 2;
        mFake.effect.flags |= usesChunks ? vst::effFlagsProgramChunks : 0;
        Reset();
        mFake.On(vst::effSetChunk,
                 [this](int, long long size, void* bytes, float)
                 {
                     const auto* const first = static_cast<unsigned char*>(bytes);
                     mState.assign(first, first + size);
                     return 1LL;
                 });
        mFake.On(vst::effGetChunk,
                 [this](int, long long, void* bytes, float)
                 {
                     unsigned char* const first = mState.data();
                     std::memcpy(bytes, &first, sizeof(first));
                     return static_cast<long long>(mState.size());
                 });
        mFake.On(vst::effGetProgramNameIndexed,
                 [](int index, long long, void* name, float)
                 {
                     std::memcpy(name, index == 0 ? "Init" : "Hall", sizeof("Init"));
                     return 1LL;
                 });
        mFake.host = VSTAudioFilter::StaticAudioMasterCallback;
        mFilter = new VSTAudioFilter(u"2:1234 Fake", u"/opt/vst/Fake.so", mFake.Get(), true, true);
    }

    // As it was before anything was loaded.
    void Reset()
    {
        mState = {1, 2, 3};
        mFake.parameters = {0.25F, 0.5F};
    }

    VSTAudioFilter& Filter() { return *mFilter; }
    const Chunk& State() const { return mState; }
    const std::vector<float>& Parameters() const { return mFake.parameters; }

private:
    Chunk mState;
    fakeeffect::FakeEffect mFake; // dies after the filter
    boost::intrusive_ptr<VSTAudioFilter> mFilter;
};

void CheckChunk(const PresetData& preset)
{
    static Effect sEffect(true);
    sEffect.Reset();
    const Chunk before = sEffect.State();
    const bool loaded = sEffect.Filter().LoadSettings(preset);
    const bool isChunk = preset.GetPresetType() == PresetData::kPresetType_Chunk;
    Chunk chunk;
    if (loaded && isChunk && preset.GetChunkData(chunk))
        Expect(sEffect.State() == chunk, "the effect gets its bytes");
    else
        Expect(sEffect.State() == before, "a preset without bytes leaves the state");
}

void CheckValues(const PresetData& preset)
{
    static Effect sEffect(false);
    sEffect.Reset();
    const std::vector<float> before = sEffect.Parameters();
    std::list<float> values;
    preset.GetParamList(values);
    const bool fits = values.size() == before.size() && preset.GetPresetType() == PresetData::kPresetType_Params;
    const bool loaded = sEffect.Filter().LoadSettings(preset);
    Expect(fits || sEffect.Parameters() == before, "a preset of another kind or length sets nothing");
    Expect(fits || !loaded || preset.GetPresetType() == PresetData::kPresetType_Factory,
           "a preset of another kind or length is refused");
    if (!loaded)
        return;

    PropList savedList;
    PresetData saved(savedList);
    sEffect.Filter().SaveSettings(saved);
    Expect(sEffect.Filter().LoadSettings(saved), "settings that were saved can be loaded");
    PropList again;
    PresetData savedAgain(again);
    sEffect.Filter().SaveSettings(savedAgain);
    Expect(ListText(savedList) == ListText(again), "settings come back bit for bit");
}

void Run(Bytes bytes)
{
    PropList list;
    if (!zebcore::proplist::utils::ReadPropList(TextOf(bytes), list))
        return;
    const PresetData preset(list);
    CheckChunk(preset);
    CheckValues(preset);
}

const Target kTarget("vst_presets", Run);

} // namespace
