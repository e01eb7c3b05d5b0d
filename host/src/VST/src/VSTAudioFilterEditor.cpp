#include "host/src/VST/src/VSTAudioFilterEditor.h"

#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTText.h"

namespace zebaudiofilterhost::vst
{

namespace
{

// Vendor-specific selectors, which travel in the index: to the plug-in,
constexpr unsigned int kSetBrightness = 0x80000009U;
constexpr unsigned int kGainFocusForward = 0x8000000aU;
constexpr unsigned int kGainFocusBackward = 0x8000000bU;
constexpr unsigned int kSetCurrentFocus = 0x8000000cU;
// and to the host.
constexpr int kFocusLeavesForward = 0x70400003;
constexpr int kFocusLeavesBackward = 0x70400004;

} // namespace

VSTAudioFilterEditor::VSTAudioFilterEditor(AEffect* effect, VSTAudioFilter* filter)
    : VSTDispatcherBase(effect), mFilter(filter)
{
}

VSTAudioFilterEditor::~VSTAudioFilterEditor() = default;

zebcore::geom::RectT<int> VSTAudioFilterEditor::GetEditorRect() const
{
    const Size size = mSize.load(std::memory_order_relaxed); // says nothing about other data
    if (size.mWidth > 0 && size.mHeight > 0)
        return {0, 0, size.mWidth, size.mHeight};
    const ERect* rect = nullptr;
    Dispatcher(effEditGetRect, 0, 0, &rect, 0.0F);
    if (!rect)
        return {};
    return {rect->left, rect->top, rect->right - rect->left, rect->bottom - rect->top};
}

void VSTAudioFilterEditor::Open(void* parent)
{
    mFilter->AddAudioMasterHandler(this, [this](int opcode, int index, long long value, void* ptr, float opt)
                                   { return AudioMasterCallback(opcode, index, value, ptr, opt); });
    Dispatcher(effEditOpen, 0, 0, parent, 0.0F);
}

void VSTAudioFilterEditor::Close()
{
    Dispatcher(effEditClose, 0, 0, nullptr, 0.0F);
    mFilter->RemoveAudioMasterHandler(this);
}

void VSTAudioFilterEditor::Idle()
{
    AEffect* const effect = GetEffect();
    if (effect && effect->dispatcher)
        effect->dispatcher(effect, effEditIdle, 0, 0, nullptr, 0.0F);
}

bool VSTAudioFilterEditor::CanEmbedView() const
{
    return true;
}

long long VSTAudioFilterEditor::CallVendorSpecific(unsigned int selector, long long value, float opt) const
{
    return Dispatcher(effVendorSpecific, static_cast<int>(selector), value, nullptr, opt);
}

void VSTAudioFilterEditor::SetBrightness(float brightness, bool highlight)
{
    CallVendorSpecific(kSetBrightness, highlight ? 1 : 0, brightness);
}

bool VSTAudioFilterEditor::GainFocus(bool forward)
{
    return CallVendorSpecific(forward ? kGainFocusForward : kGainFocusBackward, 0, 0.0F) != 0;
}

bool VSTAudioFilterEditor::SetCurrentFocus()
{
    return CallVendorSpecific(kSetCurrentFocus, 0, 0.0F) != 0;
}

long long VSTAudioFilterEditor::AudioMasterCallback(int opcode, int index, long long value, void* ptr, float /*opt*/)
{
    switch (opcode)
    {
    case audioMasterSizeWindow:
        mSize.store({index, static_cast<std::int32_t>(value)}, std::memory_order_relaxed);
        GetContentSizeChangedSignal()();
        return 1;
    case audioMasterVendorSpecific: // answered whatever the selector: while a view is open, none gets further
        if (index == kFocusLeavesForward || index == kFocusLeavesBackward)
            GetAdvanceFocusSignal()(index == kFocusLeavesForward);
        return 1;
    case audioMasterCanDo:
        return EqualsText(ptr, "sizeWindow") ? 1 : 0;
    case audioMasterBeginEdit:
        if (mFilter)
            mFilter->BeginEditing(index);
        return 1;
    case audioMasterEndEdit:
        if (mFilter)
            mFilter->EndEditing(index);
        return 1;
    default:
        return 0;
    }
}

} // namespace zebaudiofilterhost::vst
