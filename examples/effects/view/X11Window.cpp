#include "examples/effects/view/X11Window.h"

#include <array>

#include <X11/Xlib.h>

namespace effects::balance
{

namespace
{

// Tells an embedding parent that the window wants to be seen.
void AnnounceEmbedding(Display* display, Window window)
{
    const Atom info = XInternAtom(display, "_XEMBED_INFO", False);
    constexpr long kVersion = 0;
    constexpr long kMapped = 1;
    const std::array<long, 2> values{kVersion, kMapped};
    XChangeProperty(display, window, info, info, 32, PropModeReplace,
                    reinterpret_cast<const unsigned char*>(values.data()), values.size());
}

} // namespace

X11Window::X11Window(unsigned long parent, int width, int height, Callbacks callbacks)
    : mDisplay(XOpenDisplay(nullptr)), mCallbacks(std::move(callbacks))
{
    if (mDisplay == nullptr)
        return;
    mWindow = XCreateSimpleWindow(mDisplay, parent, 0, 0, static_cast<unsigned>(width), static_cast<unsigned>(height),
                                  0, 0, static_cast<unsigned long>(Colour::kBackground));
    XSelectInput(mDisplay, mWindow, ExposureMask | ButtonPressMask | ButtonReleaseMask | Button1MotionMask);
    AnnounceEmbedding(mDisplay, mWindow);
    mGraphics = XCreateGC(mDisplay, mWindow, 0, nullptr);
    XMapWindow(mDisplay, mWindow);
    XFlush(mDisplay);
}

X11Window::~X11Window()
{
    if (mDisplay == nullptr)
        return;
    XFreeGC(mDisplay, static_cast<GC>(mGraphics));
    XDestroyWindow(mDisplay, mWindow);
    XCloseDisplay(mDisplay);
}

int X11Window::Descriptor() const
{
    return ConnectionNumber(mDisplay);
}

void X11Window::HandleEvents()
{
    while (XPending(mDisplay) > 0)
    {
        XEvent event{};
        XNextEvent(mDisplay, &event);
        if (event.type == Expose && event.xexpose.count == 0)
            mCallbacks.draw();
        else if (event.type == ButtonPress && event.xbutton.button == Button1)
            mCallbacks.mouse(MouseAction::kPress, event.xbutton.x, event.xbutton.y);
        else if (event.type == MotionNotify)
            mCallbacks.mouse(MouseAction::kMove, event.xmotion.x, event.xmotion.y);
        else if (event.type == ButtonRelease && event.xbutton.button == Button1)
            mCallbacks.mouse(MouseAction::kRelease, event.xbutton.x, event.xbutton.y);
    }
}

void X11Window::Resize(int width, int height)
{
    XResizeWindow(mDisplay, mWindow, static_cast<unsigned>(width), static_cast<unsigned>(height));
    XFlush(mDisplay);
}

void X11Window::Fill(Colour colour, int x, int y, int width, int height)
{
    auto* const graphics = static_cast<GC>(mGraphics);
    XSetForeground(mDisplay, graphics, static_cast<unsigned long>(colour));
    XFillRectangle(mDisplay, mWindow, graphics, x, y, static_cast<unsigned>(width), static_cast<unsigned>(height));
}

void X11Window::Flush()
{
    XFlush(mDisplay);
}

} // namespace effects::balance
