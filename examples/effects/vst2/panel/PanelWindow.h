#pragma once

#include "examples/effects/view/X11Window.h"

namespace effects::vst2
{

class Panel;

struct PanelSize
{
    int width = 360; // pixels
    int height = 140;
};

// A slider, and a square in the corner that switches between two sizes. Events are served when the host is idle, as
// VST 2 editors have no other way.
class PanelWindow
{
public:
    // `parent` is an X11 window's ID, `size` is kept up to date.
    PanelWindow(Panel& panel, PanelSize& size, void* parent);
    ~PanelWindow(); // ends a gesture that it cuts short
    PanelWindow(const PanelWindow&) = delete;
    PanelWindow& operator=(const PanelWindow&) = delete;

    bool IsOpen() const { return mWindow.IsOpen(); }
    void Idle();

private:
    void Draw();
    void OnMouse(balance::MouseAction action, int x, int y);
    void SwitchSize();
    void StopDragging();

    Panel& mPanel;
    PanelSize& mSize;
    balance::X11Window mWindow;
    float mDrawn = -1.0F;
    bool mDragging = false;
};

} // namespace effects::vst2
