#include "host/AudioFilterRegistrar.h"

#include "host/AudioFilterDescriptorManager.h"
#include "module/ModuleSteps.h"

#include <utility>

namespace zebaudiofilterhost
{

namespace
{

[[maybe_unused]] const bool sStepAdded = ModuleSteps::GetInstance().Add(
    ModuleStepOrder::kDeferredDescriptors, &AudioFilterRegistrar::RegisterDeferredDescriptors);

} // namespace

AudioFilterRegistrar::AudioFilterRegistrar(DescriptorFunction descriptorFunction, FactoryFunction factoryFunction)
{
    GetFactoryVector().emplace_back(std::move(descriptorFunction), std::move(factoryFunction));
}

AudioFilterRegistrar::FactoryVector& AudioFilterRegistrar::GetFactoryVector()
{
    static FactoryVector sFactories;
    return sFactories;
}

void AudioFilterRegistrar::RegisterDeferredDescriptors()
{
    // By index and with a copy of the pair: a descriptor function may itself make a registrar.
    std::size_t index = 0;
    while (index < GetFactoryVector().size())
    {
        const auto [descriptorFunction, factoryFunction] = GetFactoryVector()[index];
        ++index;
        const boost::intrusive_ptr<AudioFilterDescriptor> descriptor = descriptorFunction();
        if (descriptor)
        {
            AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(descriptor);
            AudioFilterFactory::GetInstance().RegisterFactoryFunction(descriptor->GetFactoryGuid(), factoryFunction);
        }
    }
}

} // namespace zebaudiofilterhost
