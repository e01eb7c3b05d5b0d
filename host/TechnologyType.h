#pragma once

#include <cstdint>

namespace zebaudiofilterhost
{

/// The kind of a plug-in. The numbers stand in settings files and in filter IDs, so they never change.
enum TechnologyType : std::int32_t
{
    kTechnologyNone = 0,     // a locator that is default-made or failed to parse
    kTechnologyInternal = 1, // a filter built into the application or a library
    kTechnologyVST = 2,
    kTechnologyVST3 = 3,
    kTechnologyAudioUnit = 4
};

} // namespace zebaudiofilterhost
