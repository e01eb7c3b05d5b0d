#pragma once

#include "tests/plugins/support/FixtureObject.h"

namespace fixture
{

// A view that draws nothing and records what the host does with it.
class FixtureView : public FixtureObject<IPlugView>
{
public:
    FixtureView();
    ~FixtureView() override;

    tresult PLUGIN_API isPlatformTypeSupported(FIDString type) override;
    tresult PLUGIN_API attached(void* parent, FIDString type) override;
    tresult PLUGIN_API removed() override;
    tresult PLUGIN_API onWheel(float) override { return kResultFalse; }
    tresult PLUGIN_API onKeyDown(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API onKeyUp(char16, int16, int16) override { return kResultFalse; }
    tresult PLUGIN_API getSize(ViewRect* size) override;
    tresult PLUGIN_API onSize(ViewRect* newSize) override;
    tresult PLUGIN_API onFocus(TBool state) override;
    tresult PLUGIN_API setFrame(IPlugFrame* frame) override;
    tresult PLUGIN_API canResize() override { return kResultOk; }
    tresult PLUGIN_API checkSizeConstraint(ViewRect*) override { return kResultOk; }

    tresult AskForSize(int32 width, int32 height); // kNotInitialized without a frame
    IPlugFrame* Frame() const { return mFrame; }

private:
    IPlugFrame* mFrame = nullptr;
};

} // namespace fixture
