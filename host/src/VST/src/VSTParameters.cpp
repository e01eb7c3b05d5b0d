// Parameters of the filter as the plug-in describes them.

#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTText.h"

#include <array>

namespace zebaudiofilterhost::vst
{

// Deliberately byte by byte and not as UTF-8, unlike the texts of the parameter's description.
UTF16String VSTAudioFilter::GetParameterString(int index) const
{
    std::array<char, kTextBufferSize> text = {};
    Dispatcher(effGetParamDisplay, index, 0, text.data(), 0.0F);
    if (text.front() == '\0')
        return AudioFilter::GetParameterString(index);
    return zebcore::utility::AsciiToUTF16(BoundedText(text));
}

} // namespace zebaudiofilterhost::vst
