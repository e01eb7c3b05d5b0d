#include "audiofilter/PresetData.h"

#include "foundation/zebcore/BinaryText.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/PropListVisitor.h"

#include <typeinfo>
#include <utility>

namespace zebaudiofilterhost
{

const UTF8String PresetData::kVersionKey = u8"Version";
const UTF8String PresetData::kTypeKey = u8"Type";
const UTF8String PresetData::kParamListKey = u8"ParamList";
const UTF8String PresetData::kChunkDataKey = u8"ChunkData";
const UTF8String PresetData::kCustomDataKey = u8"CustomData";
const UTF8String PresetData::kFactoryPresetKey = u8"FactoryPreset";
const UTF8String PresetData::kFactoryIndexKey = u8"FactoryIndex";

namespace
{

template <typename T>
T ValueOr(const PropList* propList, const UTF8String& key, T value)
{
    if (propList != nullptr)
        propList->GetValue(key, value);
    return value;
}

// Decodes the chunk where its text lies: it may have megabytes.
class ChunkDecoder final : public zebcore::proplist::PropListVisitor
{
public:
    explicit ChunkDecoder(std::vector<unsigned char>& chunk) : mChunk(chunk) {}

    using PropListVisitor::VisitValue;
    void VisitValue(const UTF8String& key, const UTF8String& value) override
    {
        if (key == PresetData::kChunkDataKey)
            mIsDecoded = !value.empty() && zebcore::utility::DecodeBinaryDataFromUTF8String(value, mChunk);
    }

    bool IsDecoded() const { return mIsDecoded; }

private:
    std::vector<unsigned char>& mChunk;
    bool mIsDecoded = false;
};

} // namespace

PresetData::PresetData(PropList& propList) : mPropList(&propList)
{
}

PresetData::PresetData(PropList* propList) : mPropList(propList)
{
}

PresetData::~PresetData() = default;

bool PresetData::IsEmpty() const
{
    return mPropList == nullptr || mPropList->IsEmpty();
}

void PresetData::Clear()
{
    if (mPropList != nullptr)
        mPropList->Clear();
}

void PresetData::SetDataFromExistingPreset(const PresetData& other)
{
    if (mPropList == nullptr || other.mPropList == nullptr)
        return;
    UTF8String text;
    zebcore::proplist::utils::WritePropList(text, *other.mPropList);
    zebcore::proplist::utils::ReadPropList(text, *mPropList);
    Signal();
}

float PresetData::GetVersion() const
{
    return ValueOr(mPropList, kVersionKey, 0.0F);
}

void PresetData::SetVersion(float version)
{
    Store(kVersionKey, version);
}

PresetData::PresetType PresetData::GetPresetType() const
{
    return static_cast<PresetType>(ValueOr(mPropList, kTypeKey, 0));
}

void PresetData::SetPresetType(PresetType type)
{
    Store(kTypeKey, static_cast<int>(type));
}

void PresetData::GetParamList(std::list<float>& params) const
{
    params = ValueOr(mPropList, kParamListKey, std::list<float>());
}

void PresetData::SetParamList(const std::list<float>& params)
{
    Store(kParamListKey, params);
}

bool PresetData::GetChunkData(std::vector<unsigned char>& chunk) const
{
    chunk.clear();
    ChunkDecoder decoder(chunk);
    if (mPropList == nullptr)
        return false;
    if (typeid(*mPropList) == typeid(PropList))
        mPropList->Visit(decoder);
    else if (UTF8String text; mPropList->GetValue(kChunkDataKey, text)) // A list may get its values from elsewhere
        decoder.VisitValue(kChunkDataKey, text);
    return decoder.IsDecoded();
}

void PresetData::SetChunkData(const unsigned char* data, unsigned long size)
{
    UTF8String text;
    if (mPropList != nullptr && zebcore::utility::EncodeBinaryDataToUTF8String(data, size, text))
    {
        mPropList->SetValue(kChunkDataKey, std::move(text));
        Signal();
    }
}

PropList* PresetData::GetCustomDataSection()
{
    return mPropList != nullptr ? &mPropList->GetOrCreateSubList(kCustomDataKey) : nullptr;
}

const PropList* PresetData::GetCustomDataSection() const
{
    return mPropList != nullptr ? &mPropList->GetOrCreateSubList(kCustomDataKey) : nullptr;
}

UTF16String PresetData::GetFactoryPresetName() const
{
    return ValueOr(mPropList, kFactoryPresetKey, UTF16String());
}

void PresetData::SetFactoryPresetName(const UTF16String& name)
{
    Store(kFactoryPresetKey, name);
}

int PresetData::GetFactoryIndex() const
{
    return ValueOr(mPropList, kFactoryIndexKey, -1);
}

void PresetData::SetFactoryIndex(int index)
{
    if (mPropList != nullptr)
        mPropList->SetValue(kFactoryIndexKey, index);
}

PresetData::PresetChangedSignal& PresetData::GetPresetChangedSignal()
{
    return mPresetChangedSignal;
}

PropList* PresetData::GetRawData() const
{
    return mPropList;
}

template <typename T>
void PresetData::Store(const UTF8String& key, const T& value)
{
    if (mPropList == nullptr)
        return;
    mPropList->SetValue(key, value);
    Signal();
}

void PresetData::Signal() const
{
    mPresetChangedSignal(*this);
}

} // namespace zebaudiofilterhost
