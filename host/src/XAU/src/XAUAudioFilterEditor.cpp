#include "host/src/XAU/src/XAUAudioFilterEditor.h"

#include "host/src/XAU/src/CallGuarded.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

namespace zebaudiofilterhost::xau
{

namespace
{

// A unit says where the views' bundle is, and then the name of each view's class.
int CountViewClasses(AudioUnit unit)
{
    constexpr UInt32 kReference = 8; // bytes
    UInt32 size = 0;
    Boolean isWritable = 0;
    const OSStatus result = CallGuarded<AudioUnitGetPropertyInfo>(unit, kAudioUnitProperty_CocoaUI,
                                                                  kAudioUnitScope_Global, 0, &size, &isWritable);
    return result == noErr && size >= kReference ? static_cast<int>((size - kReference) / kReference) : 0;
}

} // namespace

XAUAudioFilterEditor::XAUAudioFilterEditor(XAUAudioFilter* filter, AudioUnit instance)
    : mFilter(filter), mInstance(instance), mViewClassCount(CountViewClasses(instance))
{
}

XAUAudioFilterEditor::~XAUAudioFilterEditor() = default;

zebcore::geom::RectT<int> XAUAudioFilterEditor::GetEditorRect() const
{
    return {0, 0, static_cast<int>(mWidth), static_cast<int>(mHeight)};
}

void XAUAudioFilterEditor::Open(void* parent)
{
    if (!CanEmbedView())
        return;
    mView = OpenXAUView(mInstance, mViewClassCount, parent, [this] { OnCocoaViewResized(); });
    mWidth = mView ? mView->GetWidth() : 0.0F;
    mHeight = mView ? mView->GetHeight() : 0.0F;
}

// The view goes with its parent.
void XAUAudioFilterEditor::Close()
{
}

void XAUAudioFilterEditor::Idle()
{
}

// Always, while there is a unit to show.
bool XAUAudioFilterEditor::CanEmbedView() const
{
    return mInstance != nullptr;
}

void XAUAudioFilterEditor::ReleaseView()
{
    mView.reset();
    mInstance = nullptr;
}

void XAUAudioFilterEditor::OnCocoaViewResized()
{
    if (!mView || mResizing)
        return;
    const boost::intrusive_ptr<XAUAudioFilterEditor> self(this); // until whoever hears the signal is done
    mResizing = true;                                            // the frame's own change comes back here
    mWidth = mView->GetWidth();
    mHeight = mView->GetHeight();
    mView->FitFrame();
    try
    {
        GetContentSizeChangedSignal()();
    }
    catch (...)
    {
        mResizing = false;
        throw;
    }
    mResizing = false;
}

} // namespace zebaudiofilterhost::xau
