#include "audiofilter/AudioFilterEditor.h"
#include "tests/audiofilter/RecordingFilter.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost
{
namespace
{

// Overrides no more than it must.
class SmallestEditor : public AudioFilterEditor
{
public:
    zebcore::geom::RectT<int> GetEditorRect() const override { return {0, 0, 10, 20}; }
    void Open(void*) override {}
    void Close() override {}
    void Idle() override {}
    bool CanEmbedView() const override { return true; }
};

TEST(AudioFilterEditor, DefaultsTakeNoFocus)
{
    boost::intrusive_ptr<AudioFilterEditor> editor(new SmallestEditor);
    editor->SetBrightness(0.5F, true);
    EXPECT_FALSE(editor->GainFocus(true));
    EXPECT_FALSE(editor->SetCurrentFocus());
}

TEST(AudioFilterEditor, SignalsReachTheApplication)
{
    boost::intrusive_ptr<AudioFilterEditor> editor(new SmallestEditor);
    int sizes = 0;
    bool forward = false;
    editor->GetContentSizeChangedSignal().connect([&sizes] { ++sizes; });
    editor->GetAdvanceFocusSignal().connect([&forward](bool direction) { forward = direction; });
    editor->GetContentSizeChangedSignal()();
    editor->GetAdvanceFocusSignal()(true);
    EXPECT_EQ(sizes, 1);
    EXPECT_TRUE(forward);
}

TEST(AudioFilterEditor, TheFilterKeepsWhatTheApplicationNotes)
{
    const auto filter = testing::MakeFilter({}, {});
    filter->SetEditorVisible(true);
    filter->SetEditorRect({1, 2, 3, 4});
    EXPECT_TRUE(filter->GetEditorVisible());
    EXPECT_TRUE(filter->GetEditorRect() == (zebcore::geom::RectT<int>{1, 2, 3, 4}));
}

} // namespace
} // namespace zebaudiofilterhost
