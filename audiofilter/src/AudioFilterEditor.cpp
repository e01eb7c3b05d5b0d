#include "audiofilter/AudioFilterEditor.h"

namespace zebaudiofilterhost
{

AudioFilterEditor::AudioFilterEditor() = default;

AudioFilterEditor::~AudioFilterEditor() = default;

void AudioFilterEditor::SetBrightness(float, bool)
{
}

bool AudioFilterEditor::GainFocus(bool)
{
    return false;
}

bool AudioFilterEditor::SetCurrentFocus()
{
    return false;
}

AudioFilterEditor::ContentSizeChangedSignal& AudioFilterEditor::GetContentSizeChangedSignal()
{
    return mContentSizeChangedSignal;
}

AudioFilterEditor::AdvanceFocusSignal& AudioFilterEditor::GetAdvanceFocusSignal()
{
    return mAdvanceFocusSignal;
}

} // namespace zebaudiofilterhost
