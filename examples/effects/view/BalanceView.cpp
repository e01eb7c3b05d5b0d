#include "examples/effects/view/BalanceView.h"

#include <algorithm>
#include <cstdint>

namespace effects::balance
{

namespace
{

const ViewRect kSmall(0, 0, 320, 120);
const ViewRect kLarge(0, 0, 480, 180);

constexpr int kMargin = 16;
constexpr int kKnobWidth = 12;
constexpr int kButtonSize = 20;
constexpr Linux::TimerInterval kRefreshMilliseconds = 40;

} // namespace

BalanceView::BalanceView(BalanceController* controller) : mController(controller), mSize(kSmall)
{
}

BalanceView::~BalanceView()
{
    BalanceView::removed();
}

tresult PLUGIN_API BalanceView::isPlatformTypeSupported(FIDString type)
{
    return FIDStringsEqual(type, kPlatformTypeX11EmbedWindowID) ? kResultOk : kResultFalse;
}

tresult PLUGIN_API BalanceView::attached(void* parent, FIDString type)
{
    mRunLoop = FUnknownPtr<Linux::IRunLoop>(mFrame);
    if (isPlatformTypeSupported(type) != kResultOk || mRunLoop == nullptr)
        return kResultFalse; // without a run loop it would never see an event
    mWindow =
        std::make_unique<X11Window>(reinterpret_cast<std::uintptr_t>(parent), mSize.getWidth(), mSize.getHeight(),
                                    X11Window::Callbacks{[this] { Draw(); },
                                                         [this](MouseAction action, int x, int y)
                                                         {
                                                             OnMouse(action, x, y);
                                                         }});
    if (!mWindow->IsOpen())
    {
        mWindow.reset();
        return kResultFalse;
    }
    mRunLoop->registerEventHandler(this, mWindow->Descriptor());
    mRunLoop->registerTimer(this, kRefreshMilliseconds);
    return kResultOk;
}

tresult PLUGIN_API BalanceView::removed()
{
    if (mWindow == nullptr)
        return kResultFalse;
    StopDragging();
    mRunLoop->unregisterTimer(this);
    mRunLoop->unregisterEventHandler(this);
    mRunLoop = nullptr;
    mWindow.reset();
    return kResultOk;
}

tresult PLUGIN_API BalanceView::getSize(ViewRect* size)
{
    *size = mSize;
    return kResultOk;
}

tresult PLUGIN_API BalanceView::onSize(ViewRect* newSize)
{
    mSize = *newSize;
    if (mWindow != nullptr)
    {
        mWindow->Resize(mSize.getWidth(), mSize.getHeight());
        Draw();
    }
    return kResultOk;
}

tresult PLUGIN_API BalanceView::setFrame(IPlugFrame* frame)
{
    mFrame = frame;
    return kResultOk;
}

void PLUGIN_API BalanceView::onFDIsSet(Linux::FileDescriptor)
{
    if (mWindow != nullptr)
        mWindow->HandleEvents();
}

void PLUGIN_API BalanceView::onTimer()
{
    if (mWindow == nullptr)
        return;
    mWindow->HandleEvents(); // Xlib may have read some while it waited for an answer
    if (mController->getParamNormalized(kBalance) != mDrawnBalance ||
        mController->getParamNormalized(kLevel) != mDrawnLevel)
        Draw();
}

void BalanceView::Draw()
{
    const int width = mSize.getWidth();
    const int height = mSize.getHeight();
    const int length = width - 2 * kMargin;
    mDrawnBalance = mController->getParamNormalized(kBalance);
    mDrawnLevel = mController->getParamNormalized(kLevel);

    mWindow->Fill(Colour::kBackground, 0, 0, width, height);
    mWindow->Fill(Colour::kTrack, kMargin, height / 3, length, 4);
    const int knob = kMargin + static_cast<int>(mDrawnBalance * length) - kKnobWidth / 2;
    mWindow->Fill(Colour::kKnob, knob, height / 3 - 12, kKnobWidth, 28);
    mWindow->Fill(Colour::kTrack, kMargin, height * 2 / 3, length / 2, 10);
    mWindow->Fill(Colour::kMeter, kMargin, height * 2 / 3, static_cast<int>(mDrawnLevel * length / 2), 10);
    mWindow->Fill(Colour::kButton, width - kButtonSize, height - kButtonSize, kButtonSize, kButtonSize);
    mWindow->Flush();
}

bool BalanceView::IsOnSizeButton(int x, int y) const
{
    return x >= mSize.getWidth() - kButtonSize && y >= mSize.getHeight() - kButtonSize;
}

void BalanceView::OnMouse(MouseAction action, int x, int y)
{
    if (action == MouseAction::kPress && IsOnSizeButton(x, y))
    {
        SwitchSize();
        return;
    }
    if (action == MouseAction::kPress)
    {
        mDragging = true;
        mController->BeginEdit(kBalance);
    }
    if (mDragging)
    {
        const double value = static_cast<double>(x - kMargin) / (mSize.getWidth() - 2 * kMargin);
        mController->PerformEdit(kBalance, std::clamp(value, 0.0, 1.0));
        Draw();
    }
    if (action == MouseAction::kRelease)
        StopDragging();
}

void BalanceView::StopDragging()
{
    if (mDragging)
        mController->EndEdit(kBalance);
    mDragging = false;
}

// The host resizes its window, and tells the new size by onSize, or leaves that to the view.
void BalanceView::SwitchSize()
{
    ViewRect wanted = mSize.getWidth() == kSmall.getWidth() ? kLarge : kSmall;
    if (mFrame == nullptr || mFrame->resizeView(this, &wanted) != kResultOk)
        return;
    if (mSize.getWidth() != wanted.getWidth() || mSize.getHeight() != wanted.getHeight())
        onSize(&wanted);
}

} // namespace effects::balance
