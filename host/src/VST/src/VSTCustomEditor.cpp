// The filter's editor: made at the first wish, and kept for the filter's life.

#include "foundation/zebcore/DebugDatabase.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTAudioFilterEditor.h"

namespace zebaudiofilterhost::vst
{

namespace
{

bool HasEditor(const AEffect* effect)
{
    return effect != nullptr && (effect->flags & effFlagsHasEditor) != 0;
}

} // namespace

bool VSTAudioFilter::HasCustomEditor() const
{
    return HasEditor(GetEffect()) &&
           !zebcore::debug::DebugDatabase::Instance().GetEntryAs<bool>(u8"DisableVSTCustomUI", false);
}

// The debug setting deliberately plays no part here.
boost::intrusive_ptr<AudioFilterEditor> VSTAudioFilter::CreateCustomEditor()
{
    if (!mEditor && HasEditor(GetEffect()))
        mEditor = new VSTAudioFilterEditor(GetEffect(), this);
    return mEditor;
}

} // namespace zebaudiofilterhost::vst
