// Presets and lists of presets.
#pragma once

#include "audiofilter/PresetData.h"
#include "audiofilter/PresetList.h"
