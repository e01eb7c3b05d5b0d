#include "host/src/VST3/src/PlatformView.h"

#include <pluginterfaces/gui/iplugview.h>

#import <AppKit/AppKit.h>

#include <array>

namespace zebaudiofilterhost::vst3
{

std::span<const Steinberg::FIDString> GetPlatformViewTypes()
{
    static const std::array<Steinberg::FIDString, 2> kTypes = {Steinberg::kPlatformTypeNSView,
                                                               Steinberg::kPlatformTypeHIView};
    return kTypes;
}

void MakeParentWindowOpaque(void* parent)
{
    // A message to nil does nothing: neither a missing parent nor a missing window needs a test.
    [[static_cast<NSView*>(parent) window] setAlphaValue:1.0];
}

} // namespace zebaudiofilterhost::vst3
