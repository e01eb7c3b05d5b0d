// The order in which a plug-in is called, and what it gets when it calls back: from everywhere and at any time.
#include "tests/plugins/vst2/FixtureID.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

#include <algorithm>
#include <map>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

using Lines = std::vector<std::string>;

class ConstantTempo : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }
    bool GetTempo(utility::Tempo& tempo) const override
    {
        tempo.mTempo = 60.0;
        tempo.mNumerator = 3;
        tempo.mDenominator = 8;
        return true;
    }
};

TEST_F(HostedVST2, APluginIsOpenedDescribedSwitchedAndClosedInThisOrder)
{
    FilterPtr filter = Make("NoParameters");
    ASSERT_NE(filter, nullptr);
    filter->SetSampleRate(96000.0F);
    filter->SetBlockSize(128);
    RunBlocks(*filter, 1, 64);
    const FixtureRecorder recorder = Recorder();
    filter.reset();
    const Lines expected{"VSTPluginMain 1",
                         "effOpen",
                         "effSetSampleRate 44100",
                         "effSetBlockSize 2048",
                         "effGetEffectName",
                         "effSetSampleRate 96000",
                         "effSetBlockSize 128",
                         "effSetSampleRate 48000",
                         "effSetBlockSize 64",
                         "effMainsChanged 1",
                         "effStartProcess",
                         "processReplacing 64 2 2 null= 0",
                         "effStopProcess",
                         "effMainsChanged 0",
                         "effClose"};
    EXPECT_EQ(recorder.Calls(), expected);
}

// By when it asks: from the entry call without an instance and with one that is not known yet; opening, when the
// instance exists; closing, when it is gone already.
TEST_F(HostedVST2, AtAnyTimeThePluginGetsTheAnswersOfThatTime)
{
    const std::map<std::string, std::string> usual{
        {"audioMasterVersion", "2400"},
        {"audioMasterGetVendorString", "1 Corvane Systems"},
        {"audioMasterGetProductString", "1 Opal"},
        {"audioMasterGetVendorVersion", "4"},
        {"audioMasterVendorSpecific 0x2e903f43", "0x11005678"},
        {"audioMasterVendorSpecific 0x70400000", "0x0"},
        {"audioMasterCanDo", "0"},
        {"audioMasterCanDo shellCategory", "1"},
        {"audioMasterCanDo sendVstTimeInfo", "1"},
        {"audioMasterCanDo sizeWindow", "0"},
        {"audioMasterCanDo sendVstEvents", "0"},
        {"audioMasterGetLanguage", "1"},
        {"audioMasterGetTime", "0"},
        {"audioMasterAutomate 0 0 0.5", "0"},
        {"audioMasterBeginEdit 0", "0"},
        {"audioMasterSizeWindow 300 200", "0"},
        {"audioMasterIOChanged", "0"},
        {"audioMasterUpdateDisplay", "0"},
    };
    struct Row
    {
        const char* fixture;
        const char* when;
        const char* pin; // what audioMasterPinConnected answers: 1 as long as there are no buses
    };
    for (const Row& row : {Row{"CallsInEntry", "entry", "0"}, Row{"CallsInEntry", "made", "0"},
                           Row{"CallsInOpen", "open", "1"}, Row{"CallsInClose", "close", "0"},
                           Row{"CallsWithoutEffect", "open", "0"}, Row{"CallsWithoutEffect", "close", "0"}})
    {
        FilterPtr filter = Make(row.fixture);
        ASSERT_NE(filter, nullptr) << row.fixture;
        filter.reset();
        const auto answered = [&](const std::string& command, const std::string& answer)
        {
            const std::string line = std::string(row.when) + '.' + command + " -> " + answer;
            const Lines calls = Recorder().Calls();
            EXPECT_EQ(std::count(calls.begin(), calls.end(), line), 1)
                << row.fixture << ": " << line << "\n"
                << testing::PrintToString(Recorder().CallsTo(std::string(row.when) + '.' + command + ' '));
        };
        for (const auto& [command, answer] : usual)
            answered(command, answer);
        for (const char* pin : {"0 0", "0 1", "0 2"})
            answered(std::string("audioMasterPinConnected ") + pin, row.pin);
        answered("audioMasterCurrentId", std::to_string(static_cast<std::int32_t>(VST2FixtureID(row.fixture))));
    }
}

TEST_F(HostedVST2, AutomationReachesTheFilterAlsoFromAThread)
{
    const FilterPtr filter = Make("Normal");
    Lines heard;
    filter->ConnectAutomatedParameterChange(
        [&](int index, float value) { heard.push_back(std::to_string(index) + ' ' + std::to_string(value)); });
    EXPECT_EQ(Recorder().Do("audioMasterAutomate 1 0 0.25"), "0");
    EXPECT_EQ(Recorder().Do("noEffect audioMasterAutomate 1 0 0.75"), "0");
    EXPECT_EQ(heard, Lines{"1 0.250000"});
    EXPECT_EQ(Recorder().Do("thread audioMasterVersion"), "2400");
    EXPECT_EQ(Recorder().Do("thread audioMasterPinConnected 1 1"), "0");
    EXPECT_EQ(Recorder().Do("thread audioMasterPinConnected 2 1"), "1");
    EXPECT_EQ(Recorder().Do("audioMasterPinConnected 0 2"), "1");
}

TEST_F(HostedVST2, AThreadOfThePluginsOwnMayCallAsLongAsItIsOn)
{
    const FilterPtr filter = Make("CallsFromThread");
    Recorder().SetRecording(false);
    RunBlocks(*filter, 200, 64);
    Recorder().SetRecording(true);
    RunBlocks(*filter, 1, 64);
    EXPECT_EQ(Recorder().Count("thread.calls"), 1U);
}

TEST_F(HostedVST2, TheTimeIsToldWhileThePluginIsOn)
{
    const FilterPtr filter = Make("AsksForTime");
    EXPECT_EQ(Recorder().Do("audioMasterGetTime"), "0");
    filter->SetSampleRate(48000.0F);
    filter->Resume();
    EXPECT_EQ(Recorder().Do("audioMasterGetTime"),
              "flags=0x2f03 samples=0 rate=48000 ppq=0 bar=0 tempo=120 numerator=4 denominator=4 smpte=1 nanos=1");
    ConstantTempo host;
    filter->SetAudioFilterHost(&host);
    filter->SetCurrentOffset(24000);
    EXPECT_EQ(Recorder().Do("audioMasterGetTime"), "flags=0x2f02 samples=24000 rate=48000 ppq=1.5 bar=1.5 tempo=60 "
                                                   "numerator=3 denominator=8 smpte=1 nanos=1");
    filter->Suspend();
    EXPECT_EQ(Recorder().Do("audioMasterGetTime"), "0");
    Recorder().Clear();
    RunBlocks(*filter, 3, 64);
    const Lines asked = Recorder().CallsTo("process.audioMasterGetTime -> flags=");
    ASSERT_EQ(asked.size(), 3U);
    EXPECT_NE(asked[0].find("flags=0x2f03 "), std::string::npos) << asked[0];
    EXPECT_NE(asked[1].find("flags=0x2f02 "), std::string::npos) << asked[1];
    filter->SetAudioFilterHost(nullptr);
}

TEST_F(HostedVST2, AnOpenEditorAnswersBeforeTheFilter)
{
    const FilterPtr filter = Make("SizesInOpen");
    Lines edits;
    filter->ConnectEditingStateChange([&](int index, bool begin)
                                      { edits.push_back((begin ? "begin " : "end ") + std::to_string(index)); });
    const auto editor = filter->CreateCustomEditor();
    EXPECT_EQ(editor, filter->CreateCustomEditor());
    int sizes = 0;
    Lines focus;
    editor->GetContentSizeChangedSignal().connect([&] { ++sizes; });
    editor->GetAdvanceFocusSignal().connect([&](bool forward)
                                            { focus.emplace_back(forward ? "forward" : "backward"); });
    EXPECT_EQ(editor->GetEditorRect().right, 400);
    Recorder().Do("audioMasterBeginEdit 0");
    EXPECT_TRUE(edits.empty());

    Recorder().Clear();
    editor->Open(this);
    editor->Idle();
    EXPECT_EQ(Recorder().Calls(), (Lines{"effEditOpen 1", "open.audioMasterSizeWindow -> 1", "effEditIdle"}));
    EXPECT_EQ(sizes, 1);
    EXPECT_EQ(editor->GetEditorRect().right, 640);
    EXPECT_EQ(editor->GetEditorRect().bottom, 320);
    EXPECT_EQ(Recorder().Do("audioMasterCanDo SIZEWINDOW"), "1");
    EXPECT_EQ(Recorder().Do("audioMasterCanDo shellCategory"), "1");
    EXPECT_EQ(Recorder().Do("audioMasterBeginEdit 2"), "1");
    EXPECT_EQ(Recorder().Do("audioMasterEndEdit 2"), "1");
    EXPECT_EQ(edits, (Lines{"begin 2", "end 2"}));
    EXPECT_EQ(Recorder().Do("audioMasterVendorSpecific 0x70400003"), "0x1");
    EXPECT_EQ(Recorder().Do("audioMasterVendorSpecific 0x70400004"), "0x1");
    EXPECT_EQ(focus, (Lines{"forward", "backward"}));
    EXPECT_EQ(Recorder().Do("audioMasterVendorSpecific 0x70400000 1"), "0x1 -1");

    Recorder().Clear();
    editor->SetBrightness(0.5F, true);
    EXPECT_TRUE(editor->GainFocus(true));
    EXPECT_TRUE(editor->GainFocus(false));
    EXPECT_TRUE(editor->SetCurrentFocus());
    editor->Close();
    EXPECT_EQ(Recorder().Calls(),
              (Lines{"effVendorSpecific 0x80000009 1 0.5", "effVendorSpecific 0x8000000a 0 0",
                     "effVendorSpecific 0x8000000b 0 0", "effVendorSpecific 0x8000000c 0 0", "effEditClose"}));
    EXPECT_EQ(Recorder().Do("audioMasterCanDo sizeWindow"), "0");
    EXPECT_EQ(Recorder().Do("audioMasterVendorSpecific 0x70400000 1"), "0x11005678 0");
}

TEST_F(HostedVST2, OddRectanglesAreWhatTheyAre)
{
    EXPECT_EQ(Make("NullRect")->CreateCustomEditor()->GetEditorRect().right, 0);
    const auto rect = Make("OddRect")->CreateCustomEditor()->GetEditorRect();
    EXPECT_EQ(rect.right, -200);
    EXPECT_EQ(rect.bottom, -50);
}

} // namespace
