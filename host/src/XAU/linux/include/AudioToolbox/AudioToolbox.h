#pragma once

#include "AudioToolbox/AUComponent.h"
#include "AudioToolbox/AudioComponent.h"
#include "AudioToolbox/AudioUnitProperties.h"
#include "AudioToolbox/AudioUnitUtilities.h"
#include "AudioToolbox/CoreAudioTypes.h"
