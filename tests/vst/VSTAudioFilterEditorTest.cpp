#include "host/src/VST/src/VSTAudioFilterEditor.h"

#include "foundation/zebcore/DebugDatabase.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/vst/support/FakeEffect.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <utility>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::Call;
using fakeeffect::FakeEffect;
using testing::ElementsAre;
using zebcore::geom::RectT;

class Editor : public testing::Test
{
protected:
    Editor() { fake.effect.flags |= effFlagsHasEditor; }

    void Make()
    {
        filter = new VSTAudioFilter(u"2:1 Fake", u"/fake.so", fake.Get(), true, true);
        fake.host = VSTAudioFilter::StaticAudioMasterCallback;
        editor = filter->CreateCustomEditor();
        fake.ClearCalls();
    }

    long long CanDo(const char* text) { return fake.CallHost(audioMasterCanDo, 0, 0, const_cast<char*>(text)); }

    FakeEffect fake;
    boost::intrusive_ptr<VSTAudioFilter> filter;
    boost::intrusive_ptr<AudioFilterEditor> editor;
    int window = 0; // its address stands for one
};

} // namespace

TEST_F(Editor, IsMadeOnceAndOnlyOfAPluginThatHasOne)
{
    Make();
    EXPECT_TRUE(filter->HasCustomEditor());
    ASSERT_NE(editor, nullptr);
    EXPECT_EQ(filter->CreateCustomEditor(), editor);
    EXPECT_TRUE(editor->CanEmbedView());
    EXPECT_TRUE(fake.Calls().empty()) << "the plug-in is not asked before Open";

    fake.effect.flags = effFlagsCanReplacing;
    EXPECT_FALSE(filter->HasCustomEditor());
    EXPECT_EQ(filter->CreateCustomEditor(), editor) << "it is there";
    filter.reset();
    Make();
    EXPECT_EQ(editor, nullptr);
}

TEST_F(Editor, DebugSettingHidesItButDoesNotForbidIt)
{
    Make();
    auto& settings = zebcore::debug::DebugDatabase::Instance();
    settings.SetEntry(u8"DisableVSTCustomUI", u8"true");
    EXPECT_FALSE(filter->HasCustomEditor());
    EXPECT_NE(filter->CreateCustomEditor(), nullptr);
    settings.SetEntry(u8"DisableVSTCustomUI", u8"false");
    EXPECT_TRUE(filter->HasCustomEditor());
    settings.RemoveEntry(u8"DisableVSTCustomUI");
}

TEST_F(Editor, OpensIdlesAndClosesAgainAndAgain)
{
    Make();
    for (int round = 0; round < 2; ++round)
    {
        fake.ClearCalls();
        editor->Open(&window);
        editor->Idle();
        editor->Close();
        EXPECT_THAT(fake.Names(), ElementsAre("effEditOpen", "effEditIdle", "effEditClose"));
        EXPECT_EQ(fake.CallsTo("effEditOpen").at(0).ptr, &window);
    }
}

TEST_F(Editor, RectIsThePluginsUntilItAsksForASize)
{
    Make();
    EXPECT_TRUE(editor->GetEditorRect() == RectT<int>()) << "no rectangle";
    ERect rect = {20, 10, 320, 410}; // top, left, bottom, right
    fake.On(effEditGetRect,
            [&rect](int, long long, void* ptr, float)
            {
                EXPECT_EQ(*static_cast<ERect**>(ptr), nullptr);
                *static_cast<ERect**>(ptr) = &rect;
                return 1LL;
            });
    EXPECT_TRUE(editor->GetEditorRect() == (RectT<int>{10, 20, 400, 300}));
    rect = {-32768, -32768, 32767, 32767};
    EXPECT_TRUE(editor->GetEditorRect() == (RectT<int>{-32768, -32768, 65535, 65535}));

    struct Case
    {
        int width;
        long long height;
        RectT<int> rect;
    };
    rect = {0, 0, 1, 1};
    editor->Open(&window);
    for (const Case& expected :
         {Case{0, 500, {0, 0, 1, 1}}, Case{700, -1, {0, 0, 1, 1}}, Case{700, 500, {0, 0, 700, 500}}})
    {
        fake.CallHost(audioMasterSizeWindow, expected.width, expected.height);
        EXPECT_TRUE(editor->GetEditorRect() == expected.rect) << expected.width;
    }
    editor->Close();
    EXPECT_TRUE(editor->GetEditorRect() == (RectT<int>{0, 0, 700, 500}));
    fake.Throw(effEditGetRect);
    filter.reset();
    Make();
    EXPECT_TRUE(editor->GetEditorRect() == RectT<int>());
}

TEST_F(Editor, AnswersThePluginOnlyWhileOpen)
{
    struct Case
    {
        const char* what;
        AudioMasterOpcodes opcode;
        int index;
        const char* text;
        long long closed;
        long long open;
    };
    const std::vector<Case> cases = {
        {"size", audioMasterSizeWindow, 10, nullptr, 0, 1},
        {"vendor", audioMasterVendorSpecific, 0x2e903f43, nullptr, 0x11005678, 1},
        {"focus", audioMasterVendorSpecific, 0x70400003, nullptr, 0, 1},
        {"can size", audioMasterCanDo, 0, "sizeWindow", 0, 1},
        {"in any case", audioMasterCanDo, 0, "SIZEwindow", 0, 1},
        {"longer", audioMasterCanDo, 0, "sizeWindows", 0, 0},
        {"no text", audioMasterCanDo, 0, nullptr, 0, 0},
        {"of the host", audioMasterCanDo, 0, "shellCategory", 1, 1},
        {"begin", audioMasterBeginEdit, 0, nullptr, 0, 1},
        {"end", audioMasterEndEdit, 0, nullptr, 0, 1},
        {"version", audioMasterVersion, 0, nullptr, 2400, 2400},
        {"idle", audioMasterIdle, 0, nullptr, 0, 0},
    };
    Make();
    for (const bool open : {false, true, false})
    {
        if (open)
            editor->Open(&window);
        for (const Case& expected : cases)
        {
            EXPECT_EQ(fake.CallHost(expected.opcode, expected.index, 10, const_cast<char*>(expected.text)),
                      open ? expected.open : expected.closed)
                << expected.what << (open ? " open" : " closed");
        }
        if (open)
            editor->Close();
    }
}

TEST_F(Editor, PluginsCallsBecomeSignals)
{
    Make();
    std::vector<std::pair<int, bool>> edits;
    std::vector<bool> focus;
    std::vector<RectT<int>> sizes;
    filter->ConnectEditingStateChange([&edits](int index, bool begins) { edits.emplace_back(index, begins); });
    editor->GetAdvanceFocusSignal().connect([&focus](bool forward) { focus.push_back(forward); });
    editor->GetContentSizeChangedSignal().connect([&] { sizes.push_back(editor->GetEditorRect()); });
    fake.CallHost(audioMasterBeginEdit, 4);
    EXPECT_TRUE(edits.empty()) << "not open";

    // Plug-ins ask for a size while they are being opened.
    fake.On(effEditOpen,
            [this](int, long long, void*, float) { return fake.CallHost(audioMasterSizeWindow, 320, 200); });
    editor->Open(&window);
    EXPECT_THAT(sizes, ElementsAre(RectT<int>{0, 0, 320, 200}));
    fake.CallHost(audioMasterBeginEdit, 4);
    fake.CallHost(audioMasterEndEdit, 4);
    for (const int selector : {0x70400003, 0x70400004, 0x70400005})
        fake.CallHost(audioMasterVendorSpecific, selector);
    editor->Close();
    fake.CallHost(audioMasterEndEdit, 5);
    EXPECT_THAT(edits, ElementsAre(std::pair(4, true), std::pair(4, false)));
    EXPECT_THAT(focus, ElementsAre(true, false));
}

TEST_F(Editor, BrightnessAndFocusTravelToThePlugin)
{
    Make();
    editor->SetBrightness(0.25F, true);
    editor->SetBrightness(0.5F, false);
    EXPECT_FALSE(editor->GainFocus(true));
    EXPECT_FALSE(editor->SetCurrentFocus());
    fake.Return(effVendorSpecific, -1);
    EXPECT_TRUE(editor->GainFocus(false));
    EXPECT_TRUE(editor->SetCurrentFocus());

    struct Expected
    {
        unsigned int index;
        long long value;
        float opt;
    };
    const Expected expected[] = {{0x80000009, 1, 0.25F}, {0x80000009, 0, 0.5F}, {0x8000000a, 0, 0},
                                 {0x8000000c, 0, 0},     {0x8000000b, 0, 0},    {0x8000000c, 0, 0}};
    const std::vector<Call> calls = fake.Calls();
    ASSERT_EQ(calls.size(), std::size(expected));
    for (std::size_t index = 0; index < calls.size(); ++index)
    {
        EXPECT_EQ(calls[index].opcode, effVendorSpecific);
        EXPECT_EQ(static_cast<unsigned int>(calls[index].index), expected[index].index);
        EXPECT_EQ(calls[index].value, expected[index].value);
        EXPECT_EQ(calls[index].opt, expected[index].opt);
    }
}

TEST_F(Editor, ThrowingPluginOpensAndCloses)
{
    for (const AEffectOpcodes opcode : {effEditOpen, effEditClose, effEditIdle, effVendorSpecific})
        fake.Throw(opcode);
    Make();
    editor->Open(&window);
    EXPECT_EQ(CanDo("sizeWindow"), 1);
    EXPECT_THROW(editor->Idle(), std::runtime_error) << "the one call that is not guarded";
    EXPECT_FALSE(editor->GainFocus(true));
    editor->Close();
    EXPECT_EQ(CanDo("sizeWindow"), 0);
}

TEST_F(Editor, WithoutAPluginNothingHappens)
{
    const boost::intrusive_ptr<VSTAudioFilterEditor> none(new VSTAudioFilterEditor(nullptr, nullptr));
    none->Idle();
    none->SetBrightness(1.0F, true);
    EXPECT_TRUE(none->GetEditorRect() == RectT<int>());
    EXPECT_EQ(none->AudioMasterCallback(audioMasterBeginEdit, 0, 0, nullptr, 0), 1);
}

} // namespace zebaudiofilterhost::vst
