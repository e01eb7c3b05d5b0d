#include "tests/plugins/support/FixtureView.h"

#include "tests/plugins/support/HostAccess.h"

namespace fixture
{

FixtureView::FixtureView()
{
    SetNewestView(this);
}

FixtureView::~FixtureView()
{
    Record("view.destroyed");
    if (NewestView() == this)
        SetNewestView(nullptr);
}

tresult PLUGIN_API FixtureView::isPlatformTypeSupported(FIDString type)
{
    Record("view.isPlatformTypeSupported", std::string_view(type));
    const auto& types = TheBehaviour().viewTypes;
    return std::find(types.begin(), types.end(), type) != types.end() ? kResultOk : kResultFalse;
}

tresult PLUGIN_API FixtureView::attached(void* parent, FIDString type)
{
    Record("view.attached", std::string_view(type), parent != nullptr ? 1 : 0);
    if (IsOn(Knob::kResizeInAttached))
        AskForSize(GetInt(Knob::kResizeInAttached), GetInt(Knob::kViewHeight));
    return GetInt(Knob::kAttachedResult);
}

tresult PLUGIN_API FixtureView::removed()
{
    Record("view.removed");
    return kResultOk;
}

tresult PLUGIN_API FixtureView::getSize(ViewRect* size)
{
    *size = ViewRect(0, 0, GetInt(Knob::kViewWidth), GetInt(Knob::kViewHeight));
    return kResultOk;
}

tresult PLUGIN_API FixtureView::onSize(ViewRect* newSize)
{
    Record("view.onSize", newSize->getWidth(), newSize->getHeight());
    return kResultOk;
}

tresult PLUGIN_API FixtureView::onFocus(TBool state)
{
    Record("view.onFocus", static_cast<int>(state));
    return kResultOk;
}

tresult PLUGIN_API FixtureView::setFrame(IPlugFrame* frame)
{
    Record("view.setFrame", frame != nullptr ? 1 : 0);
    mFrame = frame;
    return kResultOk;
}

tresult FixtureView::AskForSize(int32 width, int32 height)
{
    ViewRect wanted(0, 0, width, height);
    return mFrame != nullptr ? mFrame->resizeView(this, &wanted) : static_cast<tresult>(kNotInitialized);
}

} // namespace fixture
