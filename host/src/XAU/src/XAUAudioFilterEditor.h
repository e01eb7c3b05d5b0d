#pragma once

#include "audiofilter/AudioFilterEditor.h"
#include "host/src/XAU/src/XAUView.h"

#include <AudioToolbox/AudioToolbox.h>

#include <memory>

namespace zebaudiofilterhost::xau
{

class XAUAudioFilter;

/// Shows a unit's view, or a general one. The view is made once, and stays in its parent until that goes.
class XAUAudioFilterEditor : public AudioFilterEditor
{
public:
    /// Both are borrowed and outlive the editor. [main]
    XAUAudioFilterEditor(XAUAudioFilter* filter, AudioUnit instance);
    ~XAUAudioFilterEditor() override;

    zebcore::geom::RectT<int> GetEditorRect() const override;
    void Open(void* parent) override;
    void Close() override;
    void Idle() override;
    bool CanEmbedView() const override;

    /// Before the unit goes, which the view listens to: an editor that somebody keeps is empty from here on. [main]
    void ReleaseView();

    /// Takes over the view's size, and tells. [main]
    void OnCocoaViewResized();

private:
    XAUAudioFilter* mFilter;
    AudioUnit mInstance;
    int mViewClassCount;
    std::unique_ptr<XAUView> mView;
    float mWidth = 0.0F;
    float mHeight = 0.0F;
    bool mResizing = false;
};

} // namespace zebaudiofilterhost::xau
