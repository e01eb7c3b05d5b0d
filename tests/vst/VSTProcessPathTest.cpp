// What a plug-in may ask its host in the middle of a block: the answers may not allocate, free, lock or call the
// system.

#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <thread>
#include <vector>

namespace zebaudiofilterhost::vst
{
namespace
{

constexpr int kFrames = 16;

class Host final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat& /*format*/, int& /*first*/, int& /*second*/) const override
    {
        return false;
    }
    bool GetTempo(utility::Tempo& tempo) const override
    {
        tempo.mTempo = 120.0;
        tempo.mNumerator = 4;
        tempo.mDenominator = 4;
        mAsked = mAsked + 1;
        return true;
    }
    bool GetTransportState(bool& /*playing*/, bool& /*recording*/, bool& /*looping*/) const override { return false; }

    mutable std::atomic<int> mAsked = 0;
};

// Inside the test: asks its host about all that is answered on the process thread, and has pins beyond its buses.
class Inquirer
{
public:
    static constexpr int kPins = 40;

    Inquirer()
    {
        mEffect.magic = kEffectMagic;
        mEffect.dispatcher = [](AEffect*, std::int32_t, std::int32_t, long long, void*, float)
        {
            return 0LL;
        };
        mEffect.processReplacing = Process;
        mEffect.numInputs = 2;
        mEffect.numOutputs = 2;
        mEffect.flags = effFlagsCanReplacing | effFlagsHasEditor;
        mEffect.object = this;
    }

    AEffect mEffect = {};
    long long mConnected = 0; // pins, by all questions
    long long mCanSend = 0;
    long long mSizesWindow = 0; // while there is a view
    int mCalls = 0;
    float mNoise = 0.0F; // on pins without a channel

private:
    static void Process(AEffect* effect, float** inputs, float** outputs, std::int32_t frames)
    {
        static_cast<Inquirer*>(effect->object)->Ask();
        for (int pin = 0; pin < kPins; ++pin)
        {
            for (int frame = 0; pin >= 2 && frame < frames; ++frame)
                static_cast<Inquirer*>(effect->object)->mNoise += inputs[pin][frame];
            std::fill_n(outputs[pin], frames, 1.0F);
        }
    }

    void Ask()
    {
        char send[] = "sendVstTimeInfo";
        char window[] = "sizeWindow";
        char text[64] = {};
        ++mCalls;
        for (const int pin : {0, 1, 2, kPins})
            mConnected += Call(audioMasterPinConnected, pin) == 0 ? 1 : 0;
        mCanSend += Call(audioMasterCanDo, 0, send);
        mSizesWindow += Call(audioMasterCanDo, 0, window);
        Call(audioMasterGetVendorString, 0, text);
        Call(audioMasterGetProductString, 0, text);
        Call(audioMasterVendorSpecific, 0x70400000, text);
        for (const auto opcode : {audioMasterVersion, audioMasterCurrentId, audioMasterGetTime,
                                  audioMasterGetVendorVersion, audioMasterGetLanguage, audioMasterSetIcon})
            Call(opcode);
    }

    long long Call(AudioMasterOpcodes opcode, int index = 0, void* ptr = nullptr)
    {
        return VSTAudioFilter::StaticAudioMasterCallback(&mEffect, opcode, index, 0, ptr, 0.0F);
    }
};

TEST(VST2ProcessPathOfAnInquirer, AnswersInAllBlocksWithAndWithoutAView)
{
    constexpr int kBlocks = 500;
    constexpr int kLongBlock = 5000; // which is given in three
    InitializeMainThreadID();
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    Inquirer plugin;
    Host host;
    boost::intrusive_ptr<VSTAudioFilter> filter(
        new VSTAudioFilter(u"2:1 Inquirer", u"/Inquirer.so", &plugin.mEffect, true, true));
    const auto editor = filter->CreateCustomEditor();
    filter->SetAudioFilterHost(&host);
    filter->SetBlockSize(kFrames);
    filter->Resume();
    plugin.mEffect.numInputs = plugin.mEffect.numOutputs = Inquirer::kPins; // behind everybody's back
    std::vector<float> buffer(kLongBlock);
    std::array<float*, 2> channels = {buffer.data(), buffer.data()};
    std::atomic<bool> done = false;
    const auto process = [&](int frames)
    {
        ChannelFlags silent;
        const realtimeguard::Section section;
        filter->Process(channels.data(), channels.data(), frames, ChannelFlags(), silent);
    };
    editor->Open(nullptr);
    process(kFrames);
    EXPECT_EQ(plugin.mSizesWindow, 1);
    editor->Close();
    std::thread thread(
        [&]
        {
            for (int block = 0; block < kBlocks; ++block)
                process(block % 2 == 0 ? kFrames : kLongBlock);
            done = true;
        });
    while (!done)
    {
        editor->Open(nullptr);
        editor->Close();
    }
    thread.join();
    constexpr int kCalls = 1 + kBlocks / 2 + kBlocks / 2 * 3;
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
    EXPECT_EQ(plugin.mCalls, kCalls);
    EXPECT_EQ(plugin.mConnected, 2 * kCalls);
    EXPECT_EQ(plugin.mCanSend, kCalls);
    EXPECT_EQ(host.mAsked, kCalls);
    EXPECT_EQ(plugin.mNoise, 0.0F);
    EXPECT_EQ(buffer.back(), 1.0F);
    filter->Suspend();
    filter->SetAudioFilterHost(nullptr);
}

} // namespace
} // namespace zebaudiofilterhost::vst
