#include "examples/effects/support/PluginFactory.h"

#include <algorithm>
#include <cstring>

namespace effects
{

namespace
{

// The fields of the class records are zeroed before; text that fills one to the last unit has no terminator.
template <std::size_t Size>
void Copy(const std::string& text, char8 (&target)[Size])
{
    std::copy_n(text.data(), std::min(text.size(), Size), target);
}

template <std::size_t Size>
void Copy(const std::u16string& text, char16 (&target)[Size])
{
    std::copy_n(text.data(), std::min(text.size(), Size), target);
}

// Each unit on its own: enough for the names of effects.
std::string ToUTF8(const std::u16string& text)
{
    std::string result;
    for (const char16_t unit : text)
    {
        if (unit < 0x80)
        {
            result += static_cast<char>(unit);
            continue;
        }
        if (unit >= 0x800)
            result += static_cast<char>(0xe0 | (unit >> 12));
        result += static_cast<char>(unit >= 0x800 ? 0x80 | ((unit >> 6) & 0x3f) : 0xc0 | (unit >> 6));
        result += static_cast<char>(0x80 | (unit & 0x3f));
    }
    return result;
}

template <class Info>
void FillCommon(const ClassDescription& description, Info& info)
{
    info = {};
    description.id.toTUID(info.cid);
    info.cardinality = PClassInfo::kManyInstances;
    Copy(description.category, info.category);
}

} // namespace

tresult PLUGIN_API PluginFactory::queryInterface(const TUID id, void** object)
{
    const bool known =
        FUnknownPrivate::iidEqual(id, FUnknown::iid) || FUnknownPrivate::iidEqual(id, IPluginFactory::iid) ||
        (mDescription.level >= FactoryLevel::kSubCategories && FUnknownPrivate::iidEqual(id, IPluginFactory2::iid)) ||
        (mDescription.level >= FactoryLevel::kUnicode && FUnknownPrivate::iidEqual(id, IPluginFactory3::iid));
    if (known)
        addRef();
    *object = known ? static_cast<IPluginFactory3*>(this) : nullptr;
    return known ? kResultOk : kNoInterface;
}

const ClassDescription* PluginFactory::At(int32 index) const
{
    const auto& classes = mDescription.classes;
    return index >= 0 && index < static_cast<int32>(classes.size()) ? &classes[static_cast<std::size_t>(index)]
                                                                    : nullptr;
}

const std::u16string& PluginFactory::VendorOf(const ClassDescription& description) const
{
    return description.vendor.empty() ? mDescription.vendor : description.vendor;
}

tresult PLUGIN_API PluginFactory::getFactoryInfo(PFactoryInfo* info)
{
    *info = {};
    Copy(ToUTF8(mDescription.vendor), info->vendor);
    Copy(mDescription.url, info->url);
    Copy(mDescription.email, info->email);
    info->flags = kDefaultFactoryFlags;
    return kResultOk;
}

tresult PLUGIN_API PluginFactory::getClassInfo(int32 index, PClassInfo* info)
{
    const ClassDescription* description = At(index);
    if (description == nullptr)
        return kInvalidArgument;
    FillCommon(*description, *info);
    Copy(ToUTF8(description->name), info->name);
    return kResultOk;
}

tresult PLUGIN_API PluginFactory::getClassInfo2(int32 index, PClassInfo2* info)
{
    const ClassDescription* description = At(index);
    if (description == nullptr)
        return kInvalidArgument;
    FillCommon(*description, *info);
    Copy(ToUTF8(description->name), info->name);
    Copy(description->subCategories, info->subCategories);
    Copy(ToUTF8(VendorOf(*description)), info->vendor);
    Copy(ToUTF8(mDescription.version), info->version);
    Copy(std::string(kVstVersionString), info->sdkVersion);
    return kResultOk;
}

tresult PLUGIN_API PluginFactory::getClassInfoUnicode(int32 index, PClassInfoW* info)
{
    const ClassDescription* description = At(index);
    if (description == nullptr)
        return kInvalidArgument;
    FillCommon(*description, *info);
    Copy(description->name, info->name);
    Copy(description->subCategories, info->subCategories);
    Copy(VendorOf(*description), info->vendor);
    Copy(mDescription.version, info->version);
    Copy(std::u16string(u"" kVstVersionString), info->sdkVersion);
    return kResultOk;
}

tresult PLUGIN_API PluginFactory::createInstance(FIDString classID, FIDString interfaceID, void** object)
{
    *object = nullptr;
    for (const ClassDescription& description : mDescription.classes)
    {
        if (std::memcmp(description.id.toTUID(), classID, sizeof(TUID)) != 0)
            continue;
        const IPtr<FUnknown> instance(description.create(), false);
        return instance != nullptr ? instance->queryInterface(interfaceID, object) : kResultFalse;
    }
    return kInvalidArgument;
}

} // namespace effects
