#include "editor/EditorWindow.h"

#include "cli/Failure.h"
#include "filter/CrashGuard.h"

#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include <unistd.h>

namespace zebhost
{

namespace
{

constexpr int kLargestSide = 16384; // of a size that a plug-in could mean

int Bounded(int side)
{
    return std::clamp(side, 1, kLargestSide);
}

// A plug-in's window may be gone when it is spoken to, and some set properties that only a window manager knows. The
// default handler would end the process.
int IgnoreError(Display*, XErrorEvent*)
{
    return 0;
}

int EndWithoutServer(Display*)
{
    constexpr std::string_view kMessage = "zebhost: the X server has gone, and the window with it: start it again\n";
    [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, kMessage.data(), kMessage.size());
    CrashGuard::End(static_cast<int>(ExitCode::JobFailed));
}

Display* OpenDisplay()
{
    XSetErrorHandler(IgnoreError);
    XSetIOErrorHandler(EndWithoutServer);
    Display* display = XOpenDisplay(nullptr);
    if (display == nullptr)
    {
        const char* name = std::getenv("DISPLAY");
        throw Failure(ExitCode::JobFailed, std::string("there is no X display to open a window on") +
                                               (name == nullptr ? "" : " (" + std::string(name) + ")") +
                                               ": set DISPLAY, or run under 'xvfb-run'");
    }
    return display;
}

unsigned int Shift(unsigned long mask)
{
    unsigned int shift = 0;
    while (mask != 0 && (mask & 1U) == 0)
    {
        mask >>= 1U;
        ++shift;
    }
    return shift;
}

std::uint8_t Part(unsigned long pixel, unsigned long mask)
{
    const unsigned long most = mask >> Shift(mask);
    return most == 0 ? std::uint8_t{0} : static_cast<std::uint8_t>(((pixel & mask) >> Shift(mask)) * 255 / most);
}

Picture ToPicture(XImage& image)
{
    Picture picture{image.width, image.height, {}};
    for (int y = 0; y < image.height; ++y)
    {
        for (int x = 0; x < image.width; ++x)
        {
            const unsigned long pixel = XGetPixel(&image, x, y);
            picture.pixels.insert(picture.pixels.end(), {Part(pixel, image.red_mask), Part(pixel, image.green_mask),
                                                         Part(pixel, image.blue_mask)});
        }
    }
    return picture;
}

} // namespace

class EditorWindow::Native
{
public:
    Native(const std::string& title, int width, int height)
        : mDisplay(OpenDisplay())
        , mWindow(XCreateSimpleWindow(
              mDisplay, DefaultRootWindow(mDisplay), 0, 0, static_cast<unsigned int>(Bounded(width)),
              static_cast<unsigned int>(Bounded(height)), 0, 0, BlackPixel(mDisplay, DefaultScreen(mDisplay))))
        , mCloseRequest(XInternAtom(mDisplay, "WM_DELETE_WINDOW", False))
    {
        XSelectInput(mDisplay, mWindow, StructureNotifyMask | SubstructureNotifyMask);
        XSetWMProtocols(mDisplay, mWindow, &mCloseRequest, 1);
        SetTitle(title);
        Fix(width, height);
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

    Window Handle() const { return mWindow; }
    bool IsClosed() const { return mClosed; }

    void Resize(int width, int height)
    {
        Fix(width, height);
        XResizeWindow(mDisplay, mWindow, static_cast<unsigned int>(Bounded(width)),
                      static_cast<unsigned int>(Bounded(height)));
        XSync(mDisplay, False);
    }

    void Update()
    {
        while (XPending(mDisplay) > 0)
        {
            XEvent event{};
            XNextEvent(mDisplay, &event);
            Handle(event);
        }
    }

    Picture TakePicture() const
    {
        XSync(mDisplay, False);
        XWindowAttributes window{};
        int left = 0;
        int top = 0;
        Window child = 0;
        if (XGetWindowAttributes(mDisplay, mWindow, &window) == 0 ||
            XTranslateCoordinates(mDisplay, mWindow, window.root, 0, 0, &left, &top, &child) == False)
        {
            return {};
        }
        // The server gives no picture of what lies outside the screen.
        const int width = std::min(window.width, WidthOfScreen(window.screen) - left);
        const int height = std::min(window.height, HeightOfScreen(window.screen) - top);
        if (left < 0 || top < 0 || width < 1 || height < 1)
        {
            return {};
        }
        XImage* image = XGetImage(mDisplay, mWindow, 0, 0, static_cast<unsigned int>(width),
                                  static_cast<unsigned int>(height), AllPlanes, ZPixmap);
        if (image == nullptr)
        {
            return {};
        }
        const Picture picture = ToPicture(*image);
        XDestroyImage(image);
        return picture;
    }

private:
    void SetTitle(const std::string& title)
    {
        XStoreName(mDisplay, mWindow, title.c_str());
        XChangeProperty(mDisplay, mWindow, XInternAtom(mDisplay, "_NET_WM_NAME", False),
                        XInternAtom(mDisplay, "UTF8_STRING", False), 8, PropModeReplace,
                        reinterpret_cast<const unsigned char*>(title.data()), static_cast<int>(title.size()));
    }

    // The plug-in decides the size.
    void Fix(int width, int height)
    {
        XSizeHints hints{};
        hints.flags = PMinSize | PMaxSize;
        hints.min_width = hints.max_width = Bounded(width);
        hints.min_height = hints.max_height = Bounded(height);
        XSetWMNormalHints(mDisplay, mWindow, &hints);
    }

    void Handle(const XEvent& event)
    {
        const bool asked = event.type == ClientMessage && static_cast<Atom>(event.xclient.data.l[0]) == mCloseRequest;
        if (asked || (event.type == DestroyNotify && event.xdestroywindow.window == mWindow))
            mClosed = true;
        // Whatever a plug-in's window says of itself, it is to be seen.
        else if (event.type == CreateNotify && event.xcreatewindow.parent == mWindow)
            XMapWindow(mDisplay, event.xcreatewindow.window);
        else if (event.type == ReparentNotify && event.xreparent.parent == mWindow)
            XMapWindow(mDisplay, event.xreparent.window);
    }

    Display* mDisplay;
    Window mWindow;
    Atom mCloseRequest;
    bool mClosed = false;
};

EditorWindow::EditorWindow(const std::string& title, int width, int height)
    : mNative(std::make_unique<Native>(title, width, height))
{
}

EditorWindow::~EditorWindow() = default;

void* EditorWindow::Parent() const
{
    return reinterpret_cast<void*>(static_cast<std::uintptr_t>(mNative->Handle()));
}

void EditorWindow::Resize(int width, int height)
{
    mNative->Resize(width, height);
}

void EditorWindow::Update()
{
    mNative->Update();
}

bool EditorWindow::IsClosed() const
{
    return mNative->IsClosed();
}

Picture EditorWindow::TakePicture() const
{
    return mNative->TakePicture();
}

} // namespace zebhost
