// The editor of a VST 3 filter, on a view that is none.

#include "host/src/VST3/src/PlatformView.h"
#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace fakeplugin;
using testing::ElementsAre;
using zebcore::geom::RectT;

namespace
{

std::string BestType()
{
    return zebaudiofilterhost::vst3::GetPlatformViewTypes().front();
}

class FilterEditor : public testing::Test
{
protected:
    FilterEditor()
    {
        plugin.hasView = true;
        plugin.viewTypes = {"Other", BestType()};
    }

    void Make()
    {
        filter = plugin.MakeFilter();
        editor = filter->CreateCustomEditor();
        plugin.ClearCalls();
    }

    FakePlugin plugin;
    boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> filter;
    boost::intrusive_ptr<zebaudiofilterhost::AudioFilterEditor> editor;
};

} // namespace

TEST_F(FilterEditor, IsTheSameEachTimeAndLivesOnWithTheApplication)
{
    Make();
    EXPECT_TRUE(filter->HasCustomEditor());
    EXPECT_EQ(filter->CreateCustomEditor(), editor);
    filter.reset();
    EXPECT_THAT(plugin.CallsTo("view"), ElementsAre());
    editor.reset();
    EXPECT_THAT(plugin.CallsTo("view"), ElementsAre("view.setFrame null", "view destroyed"));
    EXPECT_EQ(plugin.livingObjects, 0);
}

TEST_F(FilterEditor, OpensAndClosesAgainAndAgain)
{
    Make();
    EXPECT_TRUE(editor->CanEmbedView());
    editor->Close();
    EXPECT_TRUE(plugin.Calls().empty());
    editor->Open(nullptr);
    editor->Idle();
    editor->Close();
    editor->Close();
    editor->Open(nullptr);
    EXPECT_THAT(plugin.Calls(), ElementsAre("view.attached " + BestType(), "view.removed", "view.removed",
                                            "view.attached " + BestType()));
}

TEST_F(FilterEditor, FailedAttachLeavesItClosed)
{
    plugin.attachedResult = kResultFalse;
    Make();
    editor->Open(nullptr);
    editor->Close();
    EXPECT_THAT(plugin.Calls(), ElementsAre("view.attached " + BestType()));
}

TEST_F(FilterEditor, ViewOfForeignTypesIsNotAttached)
{
    plugin.viewTypes = {"HWND", "UIView"};
    Make();
    EXPECT_FALSE(filter->HasCustomEditor());
    EXPECT_FALSE(editor->CanEmbedView());
    editor->Open(nullptr);
    editor->Close();
    EXPECT_TRUE(plugin.Calls().empty());
}

TEST_F(FilterEditor, RectIsWhatTheViewSays)
{
    Make();
    plugin.viewSize = ViewRect(10, 20, 410, 320);
    EXPECT_TRUE(editor->GetEditorRect() == (RectT<int>{10, 20, 400, 300}));
    int signals = 0;
    editor->GetContentSizeChangedSignal().connect([&] { ++signals; });
    ViewRect rect(0, 0, 700, 500);
    EXPECT_EQ(plugin.frame->resizeView(nullptr, &rect), kResultOk);
    EXPECT_EQ(signals, 1);
    EXPECT_TRUE(editor->GetEditorRect() == (RectT<int>{10, 20, 400, 300}));
    EXPECT_TRUE(plugin.CallsTo("view.onSize").empty());

    ViewRect flat(5, 5, 5, 100);
    ViewRect low(5, 5, 100, 5);
    EXPECT_EQ(plugin.frame->resizeView(nullptr, &flat), kResultFalse);
    EXPECT_EQ(plugin.frame->resizeView(nullptr, &low), kResultFalse);
    EXPECT_EQ(plugin.frame->resizeView(nullptr, nullptr), kResultFalse);
    EXPECT_EQ(signals, 1);
    plugin.viewSize = ViewRect(-2147483647, 0, 2147483647, 1);
    editor->GetEditorRect(); // no overflow, whatever it is
}

TEST_F(FilterEditor, VendorInterfaceGetsBrightnessAndFocus)
{
    Make();
    editor->SetBrightness(0.5F, true);
    EXPECT_FALSE(editor->GainFocus(true));
    EXPECT_FALSE(editor->SetCurrentFocus());
    EXPECT_TRUE(plugin.Calls().empty());

    plugin.hasVendorEffect = true;
    Make();
    editor->SetBrightness(0.5F, true);
    EXPECT_TRUE(editor->GainFocus(true));
    EXPECT_FALSE(editor->GainFocus(false));
    EXPECT_TRUE(editor->SetCurrentFocus());
    EXPECT_THAT(plugin.Calls(), testing::IsSupersetOf({"vendor.SetBrightness 0.5", "vendor.SetBrightnessFlag 1"}));
}

TEST_F(FilterEditor, PluginHandsTheFocusBack)
{
    Make();
    std::vector<bool> directions;
    editor->GetAdvanceFocusSignal().connect([&](bool forward) { directions.push_back(forward); });
    filter->GainFocus(1);
    filter->GainFocus(0);
    filter->GainFocus(2);
    EXPECT_THAT(directions, ElementsAre(true, false, false));
}

TEST_F(FilterEditor, FrameAnswersItsInterfaces)
{
    Make();
    void* object = nullptr;
    EXPECT_EQ(plugin.frame->queryInterface(IPlugFrame::iid, &object), kResultOk);
    EXPECT_EQ(object, plugin.frame);
    EXPECT_EQ(plugin.frame->queryInterface(FUnknown::iid, &object), kResultOk);
    EXPECT_EQ(object, plugin.frame);
    EXPECT_EQ(plugin.frame->queryInterface(IPlugView::iid, &object), kNoInterface);
    EXPECT_EQ(object, nullptr);
    EXPECT_EQ(plugin.frame->addRef(), 1U);
    EXPECT_EQ(plugin.frame->release(), 1U);
}
