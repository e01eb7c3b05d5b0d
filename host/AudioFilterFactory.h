#pragma once

#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/Export.h"
#include "utility/CommonTypes.h"

#include <boost/function.hpp>
#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <map>

namespace zebaudiofilterhost
{

/// Makes a filter from its ID: the ID's descriptor names a GUID, and the GUID selects a function. No lock: nothing
/// may register while filters are being made. All operations: [main]
class ZEB_EXPORT AudioFilterFactory
{
public:
    /// Takes a filter ID; returns a suspended filter, or null.
    using FactoryFunction = boost::function<boost::intrusive_ptr<AudioFilter>(const UTF16String&)>;

    /// Lives until process exit.
    static AudioFilterFactory& GetInstance();

    AudioFilterFactory(const AudioFilterFactory&) = delete;
    AudioFilterFactory& operator=(const AudioFilterFactory&) = delete;

    /// The first registration of a GUID stays. [main], or a static initializer
    void RegisterFactoryFunction(const Guid& guid, FactoryFunction function);

    /// Null for an unknown ID or GUID, and whenever the function returns null. Makes disabled filters too;
    /// utility::CreateAudioFilter does not. An ID without its technology digit is tried as Audio Unit, then as VST 2.
    /// Exceptions of the function pass through; an empty one throws boost::bad_function_call.
    boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& id) const;

private:
    AudioFilterFactory();
    ~AudioFilterFactory();

    std::map<Guid, FactoryFunction> mFunctions;
};

} // namespace zebaudiofilterhost
