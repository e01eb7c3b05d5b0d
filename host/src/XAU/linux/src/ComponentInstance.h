#pragma once

#include "AudioToolbox/AUComponent.h"
#include "host/src/XAU/linux/src/ListenerTable.h"

#include <array>
#include <cstddef>
#include <memory>

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
    /// Listeners keep it, who may be disposed of after the unit.
    std::shared_ptr<zebaudiofilterhost::xau::ListenerTable> mListeners =
        std::make_shared<zebaudiofilterhost::xau::ListenerTable>();
};
