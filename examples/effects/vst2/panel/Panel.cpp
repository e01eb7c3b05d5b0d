// ZebPanel2: an editor on X11.
#include "examples/effects/vst2/panel/Panel.h"

#include "examples/effects/vst2/support/Text.h"

#include <algorithm>

namespace effects::vst2
{

namespace
{

constexpr float kMostPercent = 200.0F;

} // namespace

Panel::Panel(audioMasterCallback host)
    : Effect(host, {.uniqueID = FourCharacters("ZbPn"),
                    .name = "Zeb Panel 2",
                    .category = kPlugCategSpacializer,
                    .parameters = {{"Width", "%", 0.5F}},
                    .flags = effFlagsHasEditor})
{
}

void Panel::Process(const float* const* inputs, float* const* outputs, std::int32_t frames)
{
    const float width = 2.0F * Get(kWidth);
    for (std::int32_t i = 0; i < frames; ++i)
    {
        const float middle = 0.5F * (inputs[0][i] + inputs[1][i]);
        const float side = 0.5F * width * (inputs[0][i] - inputs[1][i]);
        outputs[0][i] = middle + side;
        outputs[1][i] = middle - side;
    }
}

std::string Panel::Display(std::int32_t) const
{
    return Decimal(kMostPercent * Get(kWidth), 0);
}

std::optional<float> Panel::Read(std::int32_t, const std::string& text) const
{
    const auto percent = Number(text);
    return percent ? std::optional(std::clamp(*percent / kMostPercent, 0.0F, 1.0F)) : std::nullopt;
}

void Panel::BeginEdit()
{
    AskHost(audioMasterBeginEdit, kWidth, 0, nullptr, 0.0F);
}

void Panel::PerformEdit(float value)
{
    SetParameter(kWidth, value);
    AskHost(audioMasterAutomate, kWidth, 0, nullptr, value);
}

void Panel::EndEdit()
{
    AskHost(audioMasterEndEdit, kWidth, 0, nullptr, 0.0F);
}

bool Panel::AskForSize(int width, int height)
{
    return AskHost(audioMasterSizeWindow, width, height, nullptr, 0.0F) != 0;
}

long long Panel::Open(void* parent)
{
    mWindow = std::make_unique<PanelWindow>(*this, mSize, parent);
    if (!mWindow->IsOpen())
        mWindow.reset();
    return mWindow != nullptr ? 1 : 0;
}

long long Panel::Answer(const Call& call)
{
    switch (call.opcode)
    {
    case effEditGetRect:
        mRect = {0, 0, static_cast<std::int16_t>(mSize.height), static_cast<std::int16_t>(mSize.width)};
        *static_cast<ERect**>(call.ptr) = &mRect;
        return 1;
    case effEditOpen:
        return Open(call.ptr);
    case effEditClose:
        mWindow.reset();
        return 1;
    case effEditIdle:
        if (mWindow != nullptr)
            mWindow->Idle();
        return 0;
    default:
        return 0;
    }
}

std::unique_ptr<Effect> MakeEffect(audioMasterCallback host)
{
    return std::make_unique<Panel>(host);
}

} // namespace effects::vst2
