#pragma once

#include "foundation/zebcore/Export.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterFactory.h"

#include <boost/function.hpp>
#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <utility>
#include <vector>

namespace zebaudiofilterhost
{

/// Registers a built-in filter, usually as a static object of the application or of a library. The object holds
/// nothing and may go at once.
class ZEB_EXPORT AudioFilterRegistrar
{
public:
    using DescriptorFunction = boost::function<boost::intrusive_ptr<AudioFilterDescriptor>()>;
    using FactoryFunction = AudioFilterFactory::FactoryFunction;
    using FactoryVector = std::vector<std::pair<DescriptorFunction, FactoryFunction>>;

    /// Queues the pair for the next Initialize. Neither function is called here. [main], or a static initializer
    AudioFilterRegistrar(DescriptorFunction descriptorFunction, FactoryFunction factoryFunction);

    /// All pairs in order of construction. [main]
    static FactoryVector& GetFactoryVector();

    /// Enters every pair into catalogue and factory; Initialize calls it. The pairs stay, so that a second run makes
    /// new descriptors for the same IDs. An empty descriptor function throws boost::bad_function_call. [main]
    static void RegisterDeferredDescriptors();
};

} // namespace zebaudiofilterhost
