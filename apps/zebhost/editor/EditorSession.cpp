#include "editor/EditorSession.h"

#include "cli/Failure.h"
#include "editor/EditorWindow.h"
#include "filter/Interrupt.h"

#include <foundation/zebcore/MainThreadLoop.h>

#include <exception>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::AudioFilterEditor;

namespace
{

constexpr unsigned int kTickMs = 20;
constexpr int kUsualWidth = 480;
constexpr int kUsualHeight = 320;

int SideOr(int side, int usual)
{
    return side > 0 ? side : usual;
}

boost::intrusive_ptr<AudioFilterEditor> CreateEditor(AudioFilter& filter, const std::string& title)
{
    const boost::intrusive_ptr<AudioFilterEditor> editor =
        filter.HasCustomEditor() ? filter.CreateCustomEditor() : nullptr;
    if (editor == nullptr || !editor->CanEmbedView())
    {
        throw Failure(ExitCode::JobFailed,
                      title + " has no editor that can be shown here: 'zebhost params' lists what can be set");
    }
    return editor;
}

// The view of an editor while it is in a window.
class OpenView
{
public:
    OpenView(AudioFilterEditor& editor, void* parent) : mEditor(editor) { mEditor.Open(parent); }

    ~OpenView()
    {
        try
        {
            mEditor.Close();
        }
        catch (...)
        {
            // What it leaves in the window goes with it.
        }
    }

    OpenView(const OpenView&) = delete;
    OpenView& operator=(const OpenView&) = delete;

private:
    AudioFilterEditor& mEditor;
};

// An editor while it is open in a window. The filter keeps the editor, so whatever is thrown on the way, nothing here
// may stay connected with it.
class OpenEditor
{
public:
    OpenEditor(AudioFilter& filter, const std::string& title)
        : mEditor(CreateEditor(filter, title))
        , mWindow(title, SideOr(mEditor->GetEditorRect().right, kUsualWidth),
                  SideOr(mEditor->GetEditorRect().bottom, kUsualHeight))
        , mSizeConnection(mEditor->GetContentSizeChangedSignal().connect([this] { FitWindow(); }))
        , mView(*mEditor, mWindow.Parent())
    {
        FitWindow();
        mTimer = zebcore::threads::AddTimerWatch(kTickMs, [this] { Tick(); });
    }

    ~OpenEditor()
    {
        zebcore::threads::RemoveTimerWatch(mTimer);
        mSizeConnection.disconnect();
    }

    OpenEditor(const OpenEditor&) = delete;
    OpenEditor& operator=(const OpenEditor&) = delete;

    bool IsDone() const { return mWindow.IsClosed() || interrupt::IsRequested(); }
    Picture TakePicture() const { return mWindow.TakePicture(); }
    const std::string& Trouble() const { return mTrouble; }

private:
    // The plug-in may ask for a new size from inside Open.
    void FitWindow()
    {
        const zebcore::geom::RectT<int> size = mEditor->GetEditorRect();
        mWindow.Resize(SideOr(size.right, kUsualWidth), SideOr(size.bottom, kUsualHeight));
    }

    void Tick()
    {
        mWindow.Update();
        try
        {
            mEditor->Idle();
        }
        catch (const std::exception& error)
        {
            NoteTrouble(error.what());
        }
        catch (...)
        {
            NoteTrouble("something that tells nothing");
        }
    }

    // What the user has set must not be lost for it, so the editor stays open.
    void NoteTrouble(const std::string& trouble)
    {
        if (mTrouble.empty())
        {
            mTrouble = trouble;
        }
    }

    boost::intrusive_ptr<AudioFilterEditor> mEditor;
    EditorWindow mWindow;
    boost::signals2::scoped_connection mSizeConnection;
    OpenView mView;
    zebcore::threads::WatchID mTimer = zebcore::threads::kNoWatch;
    std::string mTrouble;
};

} // namespace

EditorOutcome RunEditor(AudioFilter& filter, const std::string& title, unsigned int milliseconds, bool wantPicture)
{
    constexpr unsigned int kSliceMs = 3600000;
    interrupt::Watch();
    const OpenEditor editor(filter, title);
    const auto isDone = [&editor]
    {
        return editor.IsDone();
    };
    if (milliseconds > 0)
    {
        zebcore::threads::RunMainThreadUntil(isDone, milliseconds);
    }
    else
    {
        while (!zebcore::threads::RunMainThreadUntil(isDone, kSliceMs))
        {
        }
    }
    return {wantPicture ? editor.TakePicture() : Picture(), editor.Trouble()};
}

} // namespace zebhost
