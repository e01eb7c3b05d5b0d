#pragma once

#include "examples/effects/support/Implements.h"
#include "examples/effects/view/BalanceController.h"
#include "examples/effects/view/X11Window.h"

#include <memory>

namespace effects::balance
{

// A slider for the balance, a meter, and a square in the corner that switches between two sizes. The host's run loop
// wakes it: for X events, and by a timer that follows values that change elsewhere.
class BalanceView : public Implements<IPlugView, Linux::IEventHandler, Linux::ITimerHandler>
{
public:
    explicit BalanceView(BalanceController* controller);
    ~BalanceView() override;

    tresult PLUGIN_API isPlatformTypeSupported(FIDString type) override;
    tresult PLUGIN_API attached(void* parent, FIDString type) override;
    tresult PLUGIN_API removed() override;
    tresult PLUGIN_API onWheel(float) override { return kResultFalse; }
    tresult PLUGIN_API onKeyDown(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API onKeyUp(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API getSize(ViewRect* size) override;
    tresult PLUGIN_API onSize(ViewRect* newSize) override;
    tresult PLUGIN_API onFocus(TBool) override { return kResultOk; }
    tresult PLUGIN_API setFrame(IPlugFrame* frame) override;
    tresult PLUGIN_API canResize() override { return kResultFalse; } // not by the user's dragging
    tresult PLUGIN_API checkSizeConstraint(ViewRect* rect) override { return getSize(rect); }

    void PLUGIN_API onFDIsSet(Linux::FileDescriptor) override;
    void PLUGIN_API onTimer() override;

private:
    void Draw();
    void OnMouse(MouseAction action, int x, int y);
    bool IsOnSizeButton(int x, int y) const;
    void SwitchSize();
    void StopDragging();

    IPtr<BalanceController> mController;
    IPlugFrame* mFrame = nullptr; // the host's, not counted: it takes it back by setFrame(nullptr)
    IPtr<Linux::IRunLoop> mRunLoop;
    std::unique_ptr<X11Window> mWindow; // null while not attached
    ViewRect mSize;
    double mDrawnBalance = -1.0;
    double mDrawnLevel = -1.0;
    bool mDragging = false;
};

} // namespace effects::balance
