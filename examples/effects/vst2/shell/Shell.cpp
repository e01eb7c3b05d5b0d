// ZebShell2: three effects in one binary. The shell itself processes nothing; it names its members, and the host says
// before the entry call which of them it wants.
#include "examples/effects/vst2/support/Effect.h"
#include "examples/effects/vst2/support/Text.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace effects::vst2
{

namespace
{

constexpr std::int32_t kAmount = 0; // %, of the effect in what comes out

struct StereoFrame
{
    float left;
    float right;
};

struct Member
{
    std::int32_t uniqueID;
    const char* name;
    StereoFrame (*apply)(StereoFrame in);
};

constexpr std::array<Member, 3> kMembers{{{FourCharacters("ZbIn"), "Zeb Invert",
                                           [](StereoFrame in)
                                           {
                                               return StereoFrame{-in.left, -in.right};
                                           }},
                                          {FourCharacters("ZbSw"), "Zeb Swap",
                                           [](StereoFrame in)
                                           {
                                               return StereoFrame{in.right, in.left};
                                           }},
                                          {FourCharacters("ZbMo"), "Zeb Mono",
                                           [](StereoFrame in)
                                           {
                                               const float middle = 0.5F * (in.left + in.right);
                                               return StereoFrame{middle, middle};
                                           }}}};

class MemberEffect : public Effect
{
public:
    MemberEffect(audioMasterCallback host, const Member& member)
        : Effect(host, {.uniqueID = member.uniqueID,
                        .name = member.name,
                        .category = kPlugCategSpacializer,
                        .parameters = {{"Amount", "%", 1.0F}}})
        , mMember(member)
    {
    }

protected:
    void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) override
    {
        const float amount = Get(kAmount);
        for (std::int32_t i = 0; i < frames; ++i)
        {
            const StereoFrame in{inputs[0][i], inputs[1][i]};
            const StereoFrame out = mMember.apply(in);
            outputs[0][i] = in.left + amount * (out.left - in.left);
            outputs[1][i] = in.right + amount * (out.right - in.right);
        }
    }

private:
    const Member& mMember;
};

class ShellEffect : public Effect
{
public:
    explicit ShellEffect(audioMasterCallback host)
        : Effect(host, {.uniqueID = FourCharacters("ZbSh"), .name = "Zeb Shell", .category = kPlugCategShell})
    {
    }

protected:
    void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) override
    {
        for (std::int32_t channel = 0; channel < 2; ++channel)
            std::copy_n(inputs[channel], frames, outputs[channel]);
    }

    long long Answer(const Call& call) override
    {
        if (call.opcode != effShellGetNextPlugin || mNext == kMembers.size())
            return 0;
        const Member& member = kMembers[mNext++];
        CopyText(call.ptr, member.name, kVendorLength);
        return member.uniqueID;
    }

private:
    std::size_t mNext = 0;
};

} // namespace

std::unique_ptr<Effect> MakeEffect(audioMasterCallback host)
{
    const long long wanted = host(nullptr, audioMasterCurrentId, 0, 0, nullptr, 0.0F);
    if (wanted == 0)
        return std::make_unique<ShellEffect>(host);
    const auto* const member = std::find_if(kMembers.begin(), kMembers.end(),
                                            [wanted](const Member& each) { return each.uniqueID == wanted; });
    return member != kMembers.end() ? std::make_unique<MemberEffect>(host, *member) : nullptr;
}

} // namespace effects::vst2
