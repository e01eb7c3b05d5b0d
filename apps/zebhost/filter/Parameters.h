#pragma once

#include "filter/LoadFilter.h"

#include <string>
#include <utility>

namespace zebhost
{

// The index of the parameter that a user means: its name, the beginning of its name if that fits one only, or "#3"
// for the third. Throws a usage Failure that tells what there is.
int FindParameter(const zebaudiofilterhost::AudioFilter& filter, const std::string& name);

// "Gain", cleaned for printing.
std::string ParameterName(const zebaudiofilterhost::AudioFilter& filter, int index);

// Splits NAME=TEXT; a name that holds an equal sign itself is recognised. Throws a usage Failure without one.
std::pair<int, std::string> SplitAssignment(const zebaudiofilterhost::AudioFilter& filter, const std::string& text);

// A normalised value as --norm and automation files write it. Throws a usage Failure unless it is from 0 to 1.
float ParseNormalised(const std::string& text);

} // namespace zebhost
