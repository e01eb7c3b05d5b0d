#pragma once

#include "audiofilter/AudioFilterEditor.h"
#include "host/src/VST3/src/HostRunLoop.h"
#include "host/src/VST3/src/PluginPtr.h"
#include "host/src/VST3/src/VST3VendorInterfaces.h"

#include <pluginterfaces/gui/iplugview.h>
#include <pluginterfaces/vst/ivsteditcontroller.h>

namespace zebaudiofilterhost::vst3
{

/// The view of a plug-in, and the frame that the plug-in asks for a new size or, on Linux, for an event loop. Main
/// thread only.
class VST3AudioFilterEditor : public AudioFilterEditor, public Steinberg::IPlugFrame
{
public:
    /// Takes a reference on `view` and gives it this object as its frame. `controller` is not owned. Neither may be
    /// null. [main]
    VST3AudioFilterEditor(Steinberg::Vst::IEditController* controller, Steinberg::IPlugView* view);
    ~VST3AudioFilterEditor() override;

    /// Whether the view knows any type of view of this platform. [main]
    bool HasSupportedView() const;

    /// (left, top, width, height) in the platform's units, as the view tells now. [main]
    zebcore::geom::RectT<int> GetEditorRect() const override;

    /// `parent` is the platform's view or window, of the best type that the view knows; a view that knows none is not
    /// attached. [main]
    void Open(void* parent) override;
    void Close() override;
    void Idle() override;
    bool CanEmbedView() const override;
    void SetBrightness(float brightness, bool flag) override;
    bool GainFocus(bool forward) override;
    bool SetCurrentFocus() override;

    /// IPlugFrame: the counts are no counts, each returns 1. [main]
    Steinberg::tresult PLUGIN_API resizeView(Steinberg::IPlugView* view, Steinberg::ViewRect* newSize) override;
    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** obj) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

private:
    bool IsSupported(Steinberg::FIDString type) const;
    Steinberg::FIDString FindSupportedType() const;

    Steinberg::Vst::IEditController* mController;
    PluginPtr<IVST3CorvaneVendorSpecificEffect> mVendorEffect;
    PluginPtr<Steinberg::IPlugView> mView;
    Steinberg::ViewRect mViewRect;
    bool mUseViewRect = false;
    bool mOpen = false;
    HostRunLoop mRunLoop;
    unsigned int mRegistrationsBeforeOpen = 0;
};

} // namespace zebaudiofilterhost::vst3
