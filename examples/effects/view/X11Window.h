#pragma once

#include <functional>

struct _XDisplay; // NOLINT(bugprone-reserved-identifier): Xlib's own name

namespace effects::balance
{

enum class Colour : unsigned long
{
    kBackground = 0x20242c,
    kTrack = 0x4a5160,
    kKnob = 0xf2a93b,
    kMeter = 0x58b368,
    kButton = 0x7a8295
};

enum class MouseAction
{
    kPress,
    kMove,
    kRelease
};

// A child window on an X connection of its own, as plug-ins must have: the host's connection is not theirs to read.
class X11Window
{
public:
    struct Callbacks
    {
        std::function<void()> draw;
        std::function<void(MouseAction, int x, int y)> mouse; // moves only while the button is down
    };

    X11Window(unsigned long parent, int width, int height, Callbacks callbacks);
    ~X11Window();
    X11Window(const X11Window&) = delete;
    X11Window& operator=(const X11Window&) = delete;

    bool IsOpen() const { return mDisplay != nullptr; } // false if there is no X server
    int Descriptor() const;                             // readable when there are events

    void HandleEvents(); // never waits
    void Resize(int width, int height);
    void Fill(Colour colour, int x, int y, int width, int height);
    void Flush();

private:
    _XDisplay* mDisplay;
    unsigned long mWindow = 0;
    void* mGraphics = nullptr;
    Callbacks mCallbacks;
};

} // namespace effects::balance
