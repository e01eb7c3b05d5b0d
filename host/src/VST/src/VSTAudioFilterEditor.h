#pragma once

#include "audiofilter/AudioFilterEditor.h"
#include "host/src/VST/src/VSTDispatcherBase.h"

#include <atomic>
#include <cstdint>

namespace zebaudiofilterhost::vst
{

class VSTAudioFilter;

/// A plug-in's own view. While it is open it answers for the filter what a plug-in asks its host about the view.
/// Neither the plug-in nor the filter is owned; the filter, which owns its editor, must outlive its use. [main]
class VSTAudioFilterEditor : public AudioFilterEditor, public VSTDispatcherBase
{
public:
    VSTAudioFilterEditor(AEffect* effect, VSTAudioFilter* filter);
    ~VSTAudioFilterEditor() override;

    /// (left, top, width, height): the size that the plug-in has asked for last or, as long as it has not, what it
    /// answers now, which may be nothing before Open. [main]
    zebcore::geom::RectT<int> GetEditorRect() const override;

    /// `parent` goes to the plug-in as it is: an NSView*, or the X11 window's number. Open and Close may follow each
    /// other several times. [main]
    void Open(void* parent) override;
    void Close() override;

    /// To be called 25 times a second or more while the view is open; unlike in all other calls, what the plug-in
    /// throws comes through. [main]
    void Idle() override;
    bool CanEmbedView() const override;
    void SetBrightness(float brightness, bool highlight) override;
    bool GainFocus(bool forward) override;
    bool SetCurrentFocus() override;

    /// The answer to a call of the plug-in's; 0 passes it on. [any]
    long long AudioMasterCallback(int opcode, int index, long long value, void* ptr, float opt);

private:
    // Aligned as a whole: clang calls a function for an atomic whose type could lie across words.
    struct alignas(std::int64_t) Size
    {
        std::int32_t mWidth; // in pixels, 0 until the plug-in asks for a size
        std::int32_t mHeight;
    };
    static_assert(std::atomic<Size>::is_always_lock_free);

    long long CallVendorSpecific(unsigned int selector, long long value, float opt) const;

    VSTAudioFilter* mFilter;
    std::atomic<Size> mSize = Size{0, 0}; // as one, for a plug-in may ask on any thread while another reads
};

} // namespace zebaudiofilterhost::vst
