#include "host/src/VST3/src/PlatformView.h"

#include <pluginterfaces/gui/iplugview.h>

#include <array>

namespace zebaudiofilterhost::vst3
{

std::span<const Steinberg::FIDString> GetPlatformViewTypes()
{
    static const std::array<Steinberg::FIDString, 1> kTypes = {Steinberg::kPlatformTypeX11EmbedWindowID};
    return kTypes;
}

// An X11 window is opaque unless a window manager decides otherwise.
void MakeParentWindowOpaque(void* /*parent*/)
{
}

} // namespace zebaudiofilterhost::vst3
