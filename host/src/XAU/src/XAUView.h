#pragma once

#include <AudioToolbox/AudioToolbox.h>

#include <boost/function.hpp>

#include <memory>

namespace zebaudiofilterhost::xau
{

/// A unit's view inside a frame of the host's, which sits inside the parent and follows the view's size. [main]
class XAUView
{
public:
    virtual ~XAUView() = default;

    /// In the platform's units: points, or pixels on X11.
    virtual float GetWidth() const = 0;
    virtual float GetHeight() const = 0;

    /// Fits the frame to the view's size.
    virtual void FitFrame() = 0;
};

/// The unit's own view if it offers one that can be made, else a general one that shows each parameter. Null if there
/// is nothing to show it in. `parent` is a view of the platform's best type. `resized` is called when the view's size
/// has changed. [main]
std::unique_ptr<XAUView> OpenXAUView(AudioUnit unit, int viewClasses, void* parent,
                                     const boost::function<void()>& resized);

} // namespace zebaudiofilterhost::xau
