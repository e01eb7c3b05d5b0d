#include "host/src/VST/src/VSTParameterInfo.h"

#include "foundation/zebcore/Contract.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTText.h"

#include <array>
#include <cstdint>

namespace zebaudiofilterhost::vst
{

using zebcore::utility::UTF16FromNarrow;

namespace
{

UTF16String ReadText(const VSTDispatcherBase& plugin, AEffectOpcodes opcode, int index)
{
    std::array<char, kTextBufferSize> text = {};
    plugin.Dispatcher(opcode, index, 0, text.data(), 0.0F);
    return UTF16FromNarrow(BoundedText(text));
}

// False if the plug-in does not tell; what it wrote then has no meaning.
bool ReadProperties(const VSTDispatcherBase& plugin, int index, VstParameterProperties& properties)
{
    properties = {};
    return plugin.Dispatcher(effGetParameterProperties, index, 0, &properties, 0.0F) != 0;
}

UTF16String ReadName(AEffect* effect, int index)
{
    return ReadText(VSTDispatcherBase(effect), effGetParamName, index);
}

UTF16String ReadLabel(AEffect* effect, int index)
{
    const VSTDispatcherBase plugin(effect);
    VstParameterProperties properties{};
    if (ReadProperties(plugin, index, properties))
        return UTF16FromNarrow(BoundedText(properties.label));
    return ReadText(plugin, effGetParamLabel, index);
}

} // namespace

// Braces, so that the plug-in is asked for the name before the label.
VSTParameterInfo::VSTParameterInfo(AEffect* inAEffect, int index)
    : AudioFilterParameterInfo{ReadName(inAEffect, index), ReadLabel(inAEffect, index),
                               AudioFilterParameterInfoUnit()}
    , VSTDispatcherBase(inAEffect)
    , mIndex(index)
{
    ZEB_CONTRACT(inAEffect);
    VstParameterProperties properties{};
    if (!ReadProperties(*this, mIndex, properties))
        return;
    const std::int64_t range = std::int64_t{properties.maxInteger} - properties.minInteger;
    if ((properties.flags & kVstParameterUsesIntegerMinMax) != 0 && range != 0)
    {
        mOffset = static_cast<float>(properties.minInteger);
        mScale = 1.0F / static_cast<float>(range);
    }
    if ((properties.flags & kVstParameterUsesIntStep) != 0)
        mStepCount = properties.stepInteger;
    else if ((properties.flags & kVstParameterIsSwitch) != 0)
        mStepCount = 1;
}

VSTParameterInfo::~VSTParameterInfo() = default;

float VSTParameterInfo::ToNormalized(float value) const
{
    return (value - mOffset) * mScale;
}

float VSTParameterInfo::FromNormalized(float normalized) const
{
    return normalized / mScale + mOffset;
}

bool VSTParameterInfo::CanRamp() const
{
    VstParameterProperties properties{};
    return ReadProperties(*this, mIndex, properties) && (properties.flags & kVstParameterCanRamp) != 0;
}

bool VSTParameterInfo::CanBeAutomated() const
{
    return Dispatcher(effCanBeAutomated, mIndex, 0, nullptr, 0.0F) != 0;
}

bool VSTParameterInfo::SupportsStringForArbitraryValues() const
{
    return false;
}

UTF16String VSTParameterInfo::GetParameterString(float /*normalized*/) const
{
    return ReadText(*this, effGetParamDisplay, mIndex);
}

int VSTParameterInfo::GetStepCount() const
{
    return mStepCount;
}

} // namespace zebaudiofilterhost::vst
