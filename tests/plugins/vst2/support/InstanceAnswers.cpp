// Texts, programs and chunks, arrangements, editor, shell.
#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/vst2/support/Instance.h"

#include <algorithm>
#include <cstring>

namespace vst2fixture
{

namespace
{

// What this host has for names.
constexpr std::size_t kRoom = 256;
constexpr std::size_t kProgramRoom = 73;

} // namespace

long long Instance::AnswerText(const Call& call) const
{
    const Behaviour& behaviour = TheBehaviour();
    switch (call.opcode)
    {
    case effGetEffectName:
        GiveText(call.ptr, mMember != nullptr ? mMember->name : behaviour.name, kRoom);
        return 1;
    case effGetVendorString:
        GiveText(call.ptr, behaviour.vendor, kRoom);
        return 1;
    case effGetProductString:
        GiveText(call.ptr, behaviour.product, kRoom);
        return 1;
    default:
    {
        const std::size_t index =
            call.opcode == effGetProgramName ? mProgram.load() : static_cast<std::size_t>(call.index);
        if (index >= behaviour.programs.size())
            return 0;
        GiveText(call.ptr, behaviour.programs[index], kProgramRoom);
        return 1;
    }
    }
}

long long Instance::AnswerState(const Call& call)
{
    switch (call.opcode)
    {
    case effSetProgram:
        if (call.value >= 0 && static_cast<std::size_t>(call.value) < mPrograms.size())
            mProgram = static_cast<std::size_t>(call.value);
        return 0;
    case effGetProgram:
        return static_cast<long long>(mProgram.load());
    case effGetChunk:
        return GetChunk(static_cast<void**>(call.ptr));
    default:
        return SetChunk(call.ptr, call.value);
    }
}

// The current program's values.
long long Instance::GetChunk(void** chunk)
{
    const std::size_t real = Current().size() * sizeof(float);
    const double size = Get(Knob::kChunkSize);
    mChunk.assign(std::max(real, size > 0.0 && size != kReal ? static_cast<std::size_t>(size) : 0), '\0');
    std::memcpy(mChunk.data(), Current().data(), real);
    if (!IsOn(Knob::kChunkNull))
        *chunk = mChunk.data();
    return size == kReal ? static_cast<long long>(real) : static_cast<long long>(size);
}

long long Instance::SetChunk(const void* chunk, long long size)
{
    const long long answer = GetInt(Knob::kSetChunkAnswer);
    const std::size_t real = Current().size() * sizeof(float);
    if (answer != 0 && size >= 0 && static_cast<std::size_t>(size) >= real)
        std::memcpy(Current().data(), chunk, real);
    return answer;
}

long long Instance::AnswerArrangement(const Call& call)
{
    if (call.opcode == effSetSpeakerArrangement)
    {
        mIsArranged = IsOn(Knob::kAcceptArrangements);
        if (mIsArranged)
        {
            TakeArrangement(reinterpret_cast<const VstSpeakerArrangement*>(call.value), mArrangements[0],
                            mEffect.numInputs);
            TakeArrangement(static_cast<const VstSpeakerArrangement*>(call.ptr), mArrangements[1],
                            mEffect.numOutputs);
        }
        return mIsArranged ? 1 : 0;
    }
    if (!mIsArranged || !IsOn(Knob::kArrangementAnswer))
        return 0;
    for (std::size_t i = 0; i < mArrangements.size(); ++i)
    {
        VstSpeakerArrangement& told = mArrangements[i].head;
        const Knob channels = i == 0 ? Knob::kArrangementChannelsIn : Knob::kArrangementChannelsOut;
        told.numChannels = GetInt(channels, told.numChannels);
        told.type = GetInt(Knob::kArrangementType, told.type);
    }
    const int nulls = GetInt(Knob::kArrangementNull);
    if (nulls != 1)
        *reinterpret_cast<VstSpeakerArrangement**>(call.value) = &mArrangements[0].head;
    if (nulls == 0)
        *static_cast<VstSpeakerArrangement**>(call.ptr) = &mArrangements[1].head;
    return 1;
}

// Reads all records of as many channels as it is told there are.
void Instance::TakeArrangement(const VstSpeakerArrangement* from, Arrangement& to, std::int32_t& pins) const
{
    if (from == nullptr || from->numChannels < 0 || from->numChannels > static_cast<std::int32_t>(kMostSpeakers))
        return;
    const std::size_t speakers = static_cast<std::size_t>(from->numChannels);
    std::memcpy(static_cast<void*>(&to), from,
                offsetof(VstSpeakerArrangement, speakers) + speakers * sizeof(VstSpeakerProperties));
    if (IsOn(Knob::kFollowArrangements))
        pins = from->numChannels;
}

long long Instance::AnswerEditor(const Call& call)
{
    switch (call.opcode)
    {
    case effEditGetRect:
        if (IsOn(Knob::kRectNull))
            return 0;
        mRect = {static_cast<std::int16_t>(GetInt(Knob::kRectTop)),
                 static_cast<std::int16_t>(GetInt(Knob::kRectLeft)),
                 static_cast<std::int16_t>(GetInt(Knob::kRectBottom)),
                 static_cast<std::int16_t>(GetInt(Knob::kRectRight))};
        *static_cast<ERect**>(call.ptr) = &mRect;
        return 1;
    case effEditOpen:
        if (const int width = GetInt(Knob::kSizeInOpen); width != 0)
            fixture::Record("open.audioMasterSizeWindow ->",
                            mHost(&mEffect, audioMasterSizeWindow, width, width / 2, nullptr, 0.0F));
        return GetInt(Knob::kEditOpenAnswer);
    default:
        return 0;
    }
}

long long Instance::AnswerShell(const Call& call)
{
    const Behaviour& behaviour = TheBehaviour();
    const bool isShell = behaviour.isShell && mMember == nullptr;
    if (call.opcode == effGetPlugCategory)
        return GetInt(Knob::kCategory, isShell                                  ? kPlugCategShell
                                       : (mEffect.flags & effFlagsIsSynth) != 0 ? kPlugCategSynth
                                                                                : kPlugCategEffect);
    Happen(behaviour.atNextMember);
    if (!isShell)
        return 0;
    if (behaviour.atNextMember == nullptr && mNextMember >= behaviour.members.size())
        return 0;
    const std::size_t member = mNextMember++;
    GiveText(call.ptr, behaviour.members[member % behaviour.members.size()].name, kRoom);
    return mEffect.uniqueID + static_cast<std::int32_t>(member);
}

} // namespace vst2fixture
