#include "examples/effects/vst2/panel/PanelWindow.h"

#include "examples/effects/vst2/panel/Panel.h"

#include <algorithm>
#include <cstdint>

namespace effects::vst2
{

namespace
{

using balance::Colour;
using balance::MouseAction;

constexpr PanelSize kSmall{360, 140};
constexpr PanelSize kLarge{540, 210};

constexpr int kMargin = 20;
constexpr int kKnobWidth = 14;
constexpr int kButtonSize = 24;

} // namespace

PanelWindow::PanelWindow(Panel& panel, PanelSize& size, void* parent)
    : mPanel(panel)
    , mSize(size)
    // The window's ID travels as a pointer.
    , mWindow(reinterpret_cast<std::uintptr_t>(parent), size.width, size.height,
              {[this] { Draw(); },
               [this](MouseAction action, int x, int y)
               {
                   OnMouse(action, x, y);
               }})
{
}

PanelWindow::~PanelWindow()
{
    StopDragging();
}

void PanelWindow::Idle()
{
    mWindow.HandleEvents();
    if (mPanel.Value() != mDrawn)
        Draw();
}

// A slider whose track fills from the middle, which is the width that came in.
void PanelWindow::Draw()
{
    const int length = mSize.width - 2 * kMargin;
    const int middle = mSize.width / 2;
    const int line = mSize.height / 2;
    mDrawn = mPanel.Value();
    const int knob = kMargin + static_cast<int>(mDrawn * static_cast<float>(length));

    mWindow.Fill(Colour::kBackground, 0, 0, mSize.width, mSize.height);
    mWindow.Fill(Colour::kTrack, kMargin, line - 3, length, 6);
    mWindow.Fill(Colour::kMeter, std::min(knob, middle), line - 3, std::abs(knob - middle), 6);
    mWindow.Fill(Colour::kTrack, middle - 1, line - 24, 2, 12);
    mWindow.Fill(Colour::kKnob, knob - kKnobWidth / 2, line - 16, kKnobWidth, 32);
    mWindow.Fill(Colour::kButton, mSize.width - kButtonSize, mSize.height - kButtonSize, kButtonSize, kButtonSize);
    mWindow.Flush();
}

void PanelWindow::OnMouse(MouseAction action, int x, int y)
{
    const bool isOnButton = x >= mSize.width - kButtonSize && y >= mSize.height - kButtonSize;
    if (action == MouseAction::kPress && isOnButton)
    {
        SwitchSize();
        return;
    }
    if (action == MouseAction::kPress)
    {
        mDragging = true;
        mPanel.BeginEdit();
    }
    if (mDragging)
    {
        const float value = static_cast<float>(x - kMargin) / static_cast<float>(mSize.width - 2 * kMargin);
        mPanel.PerformEdit(std::clamp(value, 0.0F, 1.0F));
        Draw();
    }
    if (action == MouseAction::kRelease)
        StopDragging();
}

void PanelWindow::StopDragging()
{
    if (mDragging)
        mPanel.EndEdit();
    mDragging = false;
}

// A host that can resize its window does so and answers 1.
void PanelWindow::SwitchSize()
{
    const PanelSize wanted = mSize.width == kSmall.width ? kLarge : kSmall;
    if (!mPanel.AskForSize(wanted.width, wanted.height))
        return;
    mSize = wanted;
    mWindow.Resize(mSize.width, mSize.height);
    Draw();
}

} // namespace effects::vst2
