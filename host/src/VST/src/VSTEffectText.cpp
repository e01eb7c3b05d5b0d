#include "host/src/VST/src/VSTEffectText.h"

#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/interface/VST2Interface.h"

#include <array>
#include <cstring>

namespace zebaudiofilterhost::vst
{

namespace
{

// The published lengths are 32 and 64 bytes; many plug-ins write more.
constexpr std::size_t kTextSize = 256;

UTF16String AskForText(AEffect* effect, AEffectOpcodes opcode)
{
    UTF16String text;
    if (!effect || !effect->dispatcher)
        return text;
    try
    {
        std::array<char, kTextSize> buffer{};
        effect->dispatcher(effect, opcode, 0, 0, buffer.data(), 0.0F);
        text = zebcore::utility::UTF16FromNarrow({buffer.data(), strnlen(buffer.data(), buffer.size())});
    }
    catch (...)
    {
        // What a plug-in wrote before it threw does not count.
    }
    return text;
}

} // namespace

UTF16String GetEffectName(AEffect* effect)
{
    return AskForText(effect, effGetEffectName);
}

UTF16String GetVendorString(AEffect* effect)
{
    return AskForText(effect, effGetVendorString);
}

UTF16String GetProductString(AEffect* effect)
{
    return AskForText(effect, effGetProductString);
}

} // namespace zebaudiofilterhost::vst
