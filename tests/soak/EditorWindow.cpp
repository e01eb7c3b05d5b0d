#include "EditorWindow.h"

#include "Throws.h"

#include <X11/Xlib.h>

#include <algorithm>
#include <cstdint>
#include <utility>

namespace soak
{

using zebaudiofilterhost::AudioFilterEditor;

namespace
{

constexpr unsigned int kTickMs = 20;

unsigned int Side(int side)
{
    constexpr int kLargest = 16384;
    return static_cast<unsigned int>(std::clamp(side, 64, kLargest));
}

// A plug-in's window may be gone when it is spoken to; the default handler would end the process.
int IgnoreError(Display*, XErrorEvent*)
{
    return 0;
}

Display* OpenDisplay()
{
    XSetErrorHandler(IgnoreError);
    Display* display = XOpenDisplay(nullptr);
    if (display == nullptr)
    {
        throw Fault("there is no X display: run under xvfb-run");
    }
    return display;
}

} // namespace

class EditorWindow::Native
{
public:
    explicit Native(const zebcore::geom::RectT<int>& size)
        : mDisplay(OpenDisplay())
        , mWindow(XCreateSimpleWindow(mDisplay, DefaultRootWindow(mDisplay), 0, 0, Side(size.right),
                                      Side(size.bottom), 0, 0, 0))
    {
        XSelectInput(mDisplay, mWindow, StructureNotifyMask | SubstructureNotifyMask);
        XMapRaised(mDisplay, mWindow);
        // The plug-in has a connection of its own, on which the window must be known.
        XSync(mDisplay, False);
    }

    ~Native()
    {
        XDestroyWindow(mDisplay, mWindow);
        XCloseDisplay(mDisplay);
    }

    Native(const Native&) = delete;
    Native& operator=(const Native&) = delete;

    void* Handle() const { return reinterpret_cast<void*>(static_cast<std::uintptr_t>(mWindow)); }

    void Resize(const zebcore::geom::RectT<int>& size)
    {
        XResizeWindow(mDisplay, mWindow, Side(size.right), Side(size.bottom));
        XSync(mDisplay, False);
    }

    void Update()
    {
        while (XPending(mDisplay) > 0)
        {
            XEvent event{};
            XNextEvent(mDisplay, &event);
            if (event.type == CreateNotify && event.xcreatewindow.parent == mWindow)
            {
                XMapWindow(mDisplay, event.xcreatewindow.window);
            }
        }
    }

private:
    Display* mDisplay;
    Window mWindow;
};

EditorWindow::EditorWindow(const boost::intrusive_ptr<AudioFilterEditor>& editor)
    : mEditor(editor)
    , mWindow(std::make_unique<Native>(editor->GetEditorRect()))
    , mSizeConnection(editor->GetContentSizeChangedSignal().connect([this] { Fit(); }))
{
    mEditor->Open(mWindow->Handle());
    Fit();
    mTimer = zebcore::threads::AddTimerWatch(kTickMs, [this] { Tick(); });
}

EditorWindow::~EditorWindow()
{
    try
    {
        Close();
    }
    catch (...)
    {
    }
    mWindow.reset(); // after the plug-in's, which is inside it
}

void EditorWindow::Close()
{
    if (mTimer == zebcore::threads::kNoWatch)
    {
        return;
    }
    zebcore::threads::RemoveTimerWatch(std::exchange(mTimer, zebcore::threads::kNoWatch));
    mSizeConnection.disconnect();
    mEditor->Close();
}

void EditorWindow::Fit()
{
    mWindow->Resize(mEditor->GetEditorRect());
}

void EditorWindow::Tick()
{
    mWindow->Update();
    mEditor->Idle();
}

} // namespace soak
