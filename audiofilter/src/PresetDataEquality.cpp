#include "audiofilter/PresetData.h"
#include "foundation/zebcore/PropListUtils.h"

namespace zebaudiofilterhost
{

namespace
{

UTF8String TextOf(const PropList* section)
{
    UTF8String text;
    if (section != nullptr)
        zebcore::proplist::utils::WritePropList(text, *section);
    return text;
}

} // namespace

bool PresetData::operator==(const PresetData& other) const
{
    // Asked for, not "unequal", so that a version that is not a number equals nothing.
    if (mPropList == nullptr || !(GetVersion() == other.GetVersion()) || GetPresetType() != other.GetPresetType())
        return false;
    switch (GetPresetType())
    {
    case kPresetType_Params:
        return IsParamDataEqual(other);
    case kPresetType_Chunk:
        return IsChunkDataEqual(other);
    case kPresetType_Factory:
        return IsFactoryDataEqual(other);
    case kPresetType_Custom:
        return IsCustomDataEqual(other);
    }
    return false;
}

bool PresetData::IsParamDataEqual(const PresetData& other) const
{
    std::list<float> mine;
    std::list<float> theirs;
    GetParamList(mine);
    other.GetParamList(theirs);
    return mine == theirs;
}

bool PresetData::IsChunkDataEqual(const PresetData& other) const
{
    std::vector<unsigned char> mine;
    std::vector<unsigned char> theirs;
    return GetChunkData(mine) == other.GetChunkData(theirs) && mine == theirs;
}

bool PresetData::IsFactoryDataEqual(const PresetData& other) const
{
    return GetFactoryPresetName() == other.GetFactoryPresetName();
}

bool PresetData::IsCustomDataEqual(const PresetData& other) const
{
    // Without a PropList there is no text, while even an empty section has some.
    return TextOf(GetCustomDataSection()) == TextOf(other.GetCustomDataSection()) && IsParamDataEqual(other) &&
           IsChunkDataEqual(other);
}

} // namespace zebaudiofilterhost
