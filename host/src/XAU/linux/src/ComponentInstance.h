#pragma once

#include "AudioToolbox/AUComponent.h"
#include "host/src/XAU/linux/src/ListenerTable.h"

#include <array>
#include <cstddef>

/// An open unit with its functions, which are looked up once.
struct ComponentInstanceRecord
{
    /// One above the highest selector in use.
    static constexpr std::size_t kSelectorCount = 0x13;

    ComponentInstanceRecord(AudioComponent component, AudioComponentPlugInInterface* unit)
        : mComponent(component), mUnit(unit)
    {
    }

    AudioComponent mComponent;
    AudioComponentPlugInInterface* mUnit;
    std::array<AudioComponentMethod, kSelectorCount> mMethods = {};
    zebaudiofilterhost::xau::ListenerTable mListeners;
};
