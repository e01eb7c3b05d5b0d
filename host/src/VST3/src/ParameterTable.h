#pragma once

#include "host/src/VST3/src/VST3ParameterInfo.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <cstdint>
#include <map>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The controller's parameters as they were found at one moment.
struct ParameterTable
{
    /// What the application sees, by its index.
    std::vector<boost::intrusive_ptr<VST3ParameterInfo>> mParameterInfos;

    /// Parameter ID to index in mParameterInfos.
    std::map<std::uint32_t, unsigned long> mParameterIndexByID;

    /// Every ID of the controller in its own order, also those hidden from the application.
    std::vector<std::uint32_t> mParameterIDs;
};

} // namespace zebaudiofilterhost::vst3
