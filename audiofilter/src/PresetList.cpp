#include "audiofilter/PresetList.h"

#include "foundation/zebcore/StringConversion.h"

namespace zebaudiofilterhost
{

using zebcore::utility::UTF16to8;

PresetList::PresetList(PropList& propList) : mPropList(&propList)
{
}

PresetList::PresetList(PropList* propList) : mPropList(propList)
{
}

PresetList::~PresetList() = default;

void PresetList::Clear()
{
    if (mPropList == nullptr)
        return;
    mPropList->Clear();
    mPresetListChangedSignal(*this);
}

void PresetList::GetPresetNames(std::set<UTF16String>& names) const
{
    names.clear();
    if (mPropList == nullptr)
        return;
    for (const UTF8String& key : mPropList->GetSubListKeys())
        names.insert(zebcore::utility::UTF8to16(key));
}

boost::intrusive_ptr<PresetData> PresetList::GetPreset(const UTF16String& name) const
{
    PropList* section = mPropList != nullptr ? mPropList->GetSubList(UTF16to8(name)) : nullptr;
    return section != nullptr ? new PresetData(*section) : nullptr;
}

boost::intrusive_ptr<PresetData> PresetList::AppendPreset(const UTF16String& name)
{
    if (mPropList == nullptr || mPropList->GetSubList(UTF16to8(name)) != nullptr)
        return {};
    boost::intrusive_ptr<PresetData> preset(new PresetData(mPropList->GetOrCreateSubList(UTF16to8(name))));
    mPresetListChangedSignal(*this);
    return preset;
}

void PresetList::RemovePreset(const UTF16String& name)
{
    if (mPropList == nullptr)
        return;
    mPropList->RemoveValue(UTF16to8(name));
    mPresetListChangedSignal(*this);
}

PresetList::PresetListChangedSignal& PresetList::GetPresetListChangedSignal()
{
    return mPresetListChangedSignal;
}

} // namespace zebaudiofilterhost
