#pragma once

#include <pluginterfaces/base/ftypes.h>

#include <span>

namespace zebaudiofilterhost::vst3
{

/// The types of a plug-in's view that this platform can show, best first; never empty. A view of the best type can
/// sit inside a view of the application, those of the others can't. [any]
std::span<const Steinberg::FIDString> GetPlatformViewTypes();

/// Makes the window around `parent`, a view of the best type, fully opaque, where windows can be otherwise. `parent`
/// may be null. [main]
void MakeParentWindowOpaque(void* parent);

} // namespace zebaudiofilterhost::vst3
