#pragma once

#include "examples/effects/vst2/panel/PanelWindow.h"
#include "examples/effects/vst2/support/Effect.h"

#include <memory>

namespace effects::vst2
{

// A stereo width with an editor: 0 % is mono, 50 % what came in, 100 % twice as wide.
class Panel : public Effect
{
public:
    explicit Panel(audioMasterCallback host);

    static constexpr std::int32_t kWidth = 0;
    float Value() const { return Get(kWidth); }

    // What the editor does: the host hears of it and may record it.
    void BeginEdit();
    void PerformEdit(float value);
    void EndEdit();
    bool AskForSize(int width, int height); // whether the host took it

protected:
    void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) override;
    std::string Display(std::int32_t index) const override;
    std::optional<float> Read(std::int32_t index, const std::string& text) const override;
    long long Answer(const Call& call) override;

private:
    long long Open(void* parent);

    PanelSize mSize;
    ERect mRect{};                        // the host reads it until it asks again
    std::unique_ptr<PanelWindow> mWindow; // null while closed
};

} // namespace effects::vst2
