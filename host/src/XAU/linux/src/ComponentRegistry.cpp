#include "host/src/XAU/linux/src/ComponentRegistry.h"

#include <algorithm>
#include <utility>

using namespace zebaudiofilterhost;
using namespace zebaudiofilterhost::xau;

namespace
{

bool Fits(const AudioComponentDescription& component, const AudioComponentDescription& wanted)
{
    const auto fits = [](OSType has, OSType wants)
    {
        return wants == 0 || has == wants;
    };
    return fits(component.componentType, wanted.componentType) &&
           fits(component.componentSubType, wanted.componentSubType) &&
           fits(component.componentManufacturer, wanted.componentManufacturer);
}

bool IsSame(const AudioComponentDescription& a, const AudioComponentDescription& b)
{
    return a.componentType == b.componentType && a.componentSubType == b.componentSubType &&
           a.componentManufacturer == b.componentManufacturer;
}

} // namespace

AudioComponentFactoryFunction OpaqueAudioComponent::GetFactory()
{
    if (!mFactory)
    {
        zebcore::utility::OSModuleRef const module = ComponentRegistry::GetInstance().LoadBundle(mListing.bundle);
        mFactory = reinterpret_cast<AudioComponentFactoryFunction>(
            zebcore::utility::GetFunctionPointerFromModuleImpl(module, mListing.factory));
    }
    return mFactory;
}

namespace zebaudiofilterhost::xau
{

ComponentRegistry& ComponentRegistry::GetInstance()
{
    static auto* sRegistry = new ComponentRegistry;
    return *sRegistry;
}

void ComponentRegistry::Update()
{
    for (const UTF16String& path : FindComponentBundles())
    {
        if (!mBundles.emplace(path, nullptr).second)
            continue;
        for (ComponentListing& listing : ReadComponentBundle(path))
        {
            if (!Find(listing.description))
                Add(std::move(listing), nullptr);
        }
    }
}

AudioComponent ComponentRegistry::FindNext(AudioComponent after, const AudioComponentDescription& description) const
{
    const auto begin = mComponents.begin() + static_cast<std::ptrdiff_t>(after ? after->mIndex + 1 : 0);
    const auto found =
        std::find_if(begin, mComponents.end(),
                     [&](const auto& component) { return Fits(component->mListing.description, description); });
    return found == mComponents.end() ? nullptr : found->get();
}

AudioComponent ComponentRegistry::Find(const AudioComponentDescription& description) const
{
    const auto found =
        std::find_if(mComponents.begin(), mComponents.end(),
                     [&](const auto& component) { return IsSame(component->mListing.description, description); });
    return found == mComponents.end() ? nullptr : found->get();
}

AudioComponent ComponentRegistry::Add(ComponentListing listing, AudioComponentFactoryFunction factory)
{
    mComponents.push_back(std::make_unique<OpaqueAudioComponent>(
        OpaqueAudioComponent{std::move(listing), mComponents.size(), factory}));
    return mComponents.back().get();
}

zebcore::utility::OSModuleRef ComponentRegistry::LoadBundle(const UTF16String& path)
{
    zebcore::utility::OSModuleRef& module = mBundles[path];
    if (!module)
        module = zebcore::utility::LoadOSModule(path);
    return module;
}

} // namespace zebaudiofilterhost::xau
