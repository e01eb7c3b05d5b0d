#include "host/src/VST3/src/VST3AudioFilterEditor.h"

#include "host/src/VST3/src/PlatformView.h"

#include <algorithm>

namespace zebaudiofilterhost::vst3
{

using Steinberg::FIDString;
using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::tresult;
using Steinberg::uint32;

namespace
{

// Of coordinates that a plug-in made up.
int Distance(Steinberg::int32 from, Steinberg::int32 to)
{
    return static_cast<int>(static_cast<uint32>(to) - static_cast<uint32>(from));
}

} // namespace

VST3AudioFilterEditor::VST3AudioFilterEditor(Steinberg::Vst::IEditController* controller, Steinberg::IPlugView* view)
    : mController(controller), mView(PluginPtr<Steinberg::IPlugView>::Retain(view))
{
    mVendorEffect = PluginPtr<IVST3CorvaneVendorSpecificEffect>::Query(mController);
    mView->setFrame(this);
}

VST3AudioFilterEditor::~VST3AudioFilterEditor()
{
    mVendorEffect.Reset();
    mView->setFrame(nullptr);
    mRunLoop.ForgetAll(); // ahead of the release: handlers may be parts of the view
    mView.Reset();
}

bool VST3AudioFilterEditor::IsSupported(FIDString type) const
{
    return mView->isPlatformTypeSupported(type) == kResultOk;
}

// The best type that the view knows, or null.
FIDString VST3AudioFilterEditor::FindSupportedType() const
{
    const auto types = GetPlatformViewTypes();
    const auto found = std::find_if(types.begin(), types.end(), [this](FIDString type) { return IsSupported(type); });
    return found == types.end() ? nullptr : *found;
}

bool VST3AudioFilterEditor::HasSupportedView() const
{
    return FindSupportedType() != nullptr;
}

bool VST3AudioFilterEditor::CanEmbedView() const
{
    return IsSupported(GetPlatformViewTypes().front());
}

zebcore::geom::RectT<int> VST3AudioFilterEditor::GetEditorRect() const
{
    Steinberg::ViewRect rect;
    if (mUseViewRect)
        rect = mViewRect;
    else
        mView->getSize(&rect);
    return {rect.left, rect.top, Distance(rect.left, rect.right), Distance(rect.top, rect.bottom)};
}

void VST3AudioFilterEditor::Open(void* parent)
{
    const FIDString type = FindSupportedType();
    mOpen = false;
    if (!type)
        return;
    mRegistrationsBeforeOpen = mRunLoop.Mark();
    mOpen = mView->attached(parent, type) == kResultOk;
    if (!mOpen)
        mRunLoop.ForgetSince(mRegistrationsBeforeOpen);
    if (parent != nullptr && type == GetPlatformViewTypes().front())
        MakeParentWindowOpaque(parent);
}

// The view counts as open until the next Open, so that a second call reaches the plug-in as well.
void VST3AudioFilterEditor::Close()
{
    if (!mOpen)
        return;
    mView->removed();
    mRunLoop.ForgetSince(mRegistrationsBeforeOpen);
}

// Plug-ins have their own timers.
void VST3AudioFilterEditor::Idle()
{
}

void VST3AudioFilterEditor::SetBrightness(float brightness, bool flag)
{
    if (!mVendorEffect)
        return;
    mVendorEffect->SetBrightness(brightness);
    mVendorEffect->SetBrightnessFlag(flag);
}

bool VST3AudioFilterEditor::GainFocus(bool forward)
{
    return mVendorEffect && mVendorEffect->GainFocus(forward) != 0;
}

bool VST3AudioFilterEditor::SetCurrentFocus()
{
    return mVendorEffect && mVendorEffect->SetCurrentFocus() != 0;
}

// The application resizes its own view at the signal; the plug-in is not told.
tresult PLUGIN_API VST3AudioFilterEditor::resizeView(Steinberg::IPlugView* /*view*/, Steinberg::ViewRect* newSize)
{
    if (!newSize || newSize->left == newSize->right || newSize->top == newSize->bottom)
        return kResultFalse;
    mViewRect = *newSize;
    GetContentSizeChangedSignal()();
    return kResultOk;
}

tresult PLUGIN_API VST3AudioFilterEditor::queryInterface(const Steinberg::TUID interfaceID, void** obj)
{
    using Steinberg::FUnknownPrivate::iidEqual;
    if (!obj)
        return Steinberg::kInvalidArgument;
    *obj = nullptr;
    if (!interfaceID)
        return Steinberg::kNoInterface;
    if (!iidEqual(interfaceID, Steinberg::FUnknown::iid) && !iidEqual(interfaceID, Steinberg::IPlugFrame::iid))
        return mRunLoop.QueryInterface(interfaceID, obj);
    *obj = static_cast<Steinberg::IPlugFrame*>(this);
    addRef();
    return kResultOk;
}

uint32 PLUGIN_API VST3AudioFilterEditor::addRef()
{
    return 1;
}

uint32 PLUGIN_API VST3AudioFilterEditor::release()
{
    return 1;
}

} // namespace zebaudiofilterhost::vst3
