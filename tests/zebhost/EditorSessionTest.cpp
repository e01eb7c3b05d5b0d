// Editors that throw while they are opened, in a window that this file draws nowhere.
#include "editor/EditorSession.h"
#include "editor/EditorWindow.h"

#include <audiofilter/AudioFilterEditor.h>

#include <gtest/gtest.h>

#include <functional>
#include <stdexcept>

namespace zebhost
{

namespace
{

int sWindows = 0;
int sResizes = 0;

} // namespace

class EditorWindow::Native
{
};

EditorWindow::EditorWindow(const std::string& /*title*/, int /*width*/, int /*height*/)
{
    ++sWindows;
}

EditorWindow::~EditorWindow()
{
    --sWindows;
}

void* EditorWindow::Parent() const
{
    return &sWindows;
}

void EditorWindow::Resize(int /*width*/, int /*height*/)
{
    ++sResizes;
}

void EditorWindow::Update()
{
}

bool EditorWindow::IsClosed() const
{
    return true;
}

Picture EditorWindow::TakePicture() const
{
    return {};
}

namespace
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::AudioFilterEditor;

class Editor final : public AudioFilterEditor
{
public:
    zebcore::geom::RectT<int> GetEditorRect() const override
    {
        if (mIsOpen && mAtRect)
            mAtRect();
        return {0, 0, 100, 50};
    }
    void Open(void*) override
    {
        GetContentSizeChangedSignal()();
        if (mAtOpen)
            mAtOpen();
        mIsOpen = true;
    }
    void Close() override
    {
        EXPECT_EQ(sWindows, 1) << "the window has gone ahead of its content";
        mIsOpen = false;
        ++mCloses;
        if (mAtClose)
            mAtClose();
    }
    void Idle() override {}
    bool CanEmbedView() const override { return true; }

    std::function<void()> mAtOpen;
    std::function<void()> mAtRect; // while it is open
    std::function<void()> mAtClose;
    bool mIsOpen = false;
    int mCloses = 0;
};

// Keeps its editor, as the filters of plug-ins do.
class FilterWithEditor final : public AudioFilter
{
public:
    FilterWithEditor() : AudioFilter(u"editor", u"Editor") {}
    bool HasCustomEditor() const override { return true; }
    boost::intrusive_ptr<AudioFilterEditor> CreateCustomEditor() override { return mEditor; }

    boost::intrusive_ptr<Editor> mEditor = new Editor;
};

void Throw()
{
    throw std::runtime_error("view");
}

class EditorSessionTest : public testing::Test
{
protected:
    void Run() { RunEditor(*mFilter, "title", 1, false); }

    // The filter lives on, and its editor with it.
    void ExpectNobodyListens() const
    {
        EXPECT_EQ(sWindows, 0);
        sResizes = 0;
        mFilter->mEditor->GetContentSizeChangedSignal()();
        EXPECT_EQ(mFilter->mEditor->GetContentSizeChangedSignal().num_slots(), 0U);
        EXPECT_EQ(sResizes, 0);
    }

    boost::intrusive_ptr<FilterWithEditor> mFilter = new FilterWithEditor;
};

TEST_F(EditorSessionTest, ClosesWhatItHasOpened)
{
    sResizes = 0;
    Run();
    EXPECT_EQ(sResizes, 2) << "at the signal from within Open, and behind it";
    EXPECT_EQ(mFilter->mEditor->mCloses, 1);
    ExpectNobodyListens();
}

TEST_F(EditorSessionTest, AnEditorThatThrowsWhenItOpensIsLeftAlone)
{
    mFilter->mEditor->mAtOpen = Throw;
    EXPECT_THROW(Run(), std::runtime_error);
    EXPECT_EQ(mFilter->mEditor->mCloses, 0);
    ExpectNobodyListens();
}

TEST_F(EditorSessionTest, AnEditorThatThrowsWhenItIsOpenIsClosed)
{
    mFilter->mEditor->mAtRect = Throw;
    mFilter->mEditor->mAtClose = Throw; // and goes on like that
    EXPECT_THROW(Run(), std::runtime_error);
    EXPECT_EQ(mFilter->mEditor->mCloses, 1);
    ExpectNobodyListens();
}

} // namespace

} // namespace zebhost
