#pragma once

#include <X11/Xlib.h>
#include <X11/Xutil.h>

namespace zebtest
{

/// The one window inside `parent`; 0 if there is none, or more than one.
inline Window FindChildWindow(Display* display, Window parent)
{
    Window root = 0;
    Window grandparent = 0;
    Window* children = nullptr;
    unsigned int count = 0;
    XQueryTree(display, parent, &root, &grandparent, &children, &count);
    const Window first = count == 1 ? children[0] : 0;
    XFree(children);
    return first;
}

/// A window has no pixels before it is on the screen, where a plug-in puts it by a connection of its own: 0 until
/// then.
inline unsigned long WindowPixelAt(Display* display, Window window, int x, int y)
{
    XWindowAttributes attributes{};
    if (XGetWindowAttributes(display, window, &attributes) == 0 || attributes.map_state != IsViewable)
        return 0;
    XImage* image = XGetImage(display, window, x, y, 1, 1, AllPlanes, ZPixmap);
    const unsigned long pixel = image != nullptr ? XGetPixel(image, 0, 0) & 0xffffff : 0;
    if (image != nullptr)
        XDestroyImage(image);
    return pixel;
}

/// ButtonPress, MotionNotify or ButtonRelease of the first button.
inline void SendMouseTo(Display* display, Window window, int type, int x, int y)
{
    XEvent event{};
    event.type = type;
    event.xbutton.window = window;
    event.xbutton.x = x;
    event.xbutton.y = y;
    if (type == MotionNotify)
        event.xmotion.state = Button1Mask;
    else
        event.xbutton.button = Button1;
    XSendEvent(display, window, False, NoEventMask, &event);
    XSync(display, False);
}

} // namespace zebtest
