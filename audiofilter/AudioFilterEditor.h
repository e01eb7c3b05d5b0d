// A plug-in's own view.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/Rect.h"
#include "foundation/zebcore/RefCountedObject.h"

#include <boost/core/noncopyable.hpp>
#include <boost/signals2/signal.hpp>

namespace zebaudiofilterhost
{

/// What AudioFilter::CreateCustomEditor gives: the content of a plug-in's window, which the application puts into a
/// view of its own. Held by boost::intrusive_ptr; must not outlive its filter. Order of use: Open, Idle again and
/// again, Close, release.
class ZEB_EXPORT AudioFilterEditor : public virtual zebcore::utility::RefCountedObject, private boost::noncopyable
{
public:
    using ContentSizeChangedSignal = boost::signals2::signal<void()>;
    using AdvanceFocusSignal = boost::signals2::signal<void(bool)>;

    AudioFilterEditor();
    ~AudioFilterEditor() override;

    /// The size of the view in pixels; may be asked before Open. [main]
    virtual zebcore::geom::RectT<int> GetEditorRect() const = 0;

    /// Attaches the view to the platform view `parent`, which must not be null: an NSView*, or the X11 window's
    /// number. A plug-in that refuses shows nothing; nobody is told. [main]
    virtual void Open(void* parent) = 0;

    /// Detaches the view. [main]
    virtual void Close() = 0;

    /// To be called regularly while the view is open. [main]
    virtual void Idle() = 0;

    /// Whether the view can sit inside a view of the application. [main]
    virtual bool CanEmbedView() const = 0;

    /// Passes on the brightness of the application's interface, 0 to 1. [main]
    virtual void SetBrightness(float brightness, bool highlight);

    /// Offers the keyboard focus, from the front or from the back; whether the editor took it. [main]
    virtual bool GainFocus(bool forward);

    /// Asks the editor to keep the focus where it is; whether it does. [main]
    virtual bool SetCurrentFocus();

    /// Fires when the plug-in has changed the size of its view. [main]
    ContentSizeChangedSignal& GetContentSizeChangedSignal();

    /// Fires when the plug-in gives the keyboard focus back; the argument tells the direction, true for forward.
    /// [main]
    AdvanceFocusSignal& GetAdvanceFocusSignal();

private:
    ContentSizeChangedSignal mContentSizeChangedSignal;
    AdvanceFocusSignal mAdvanceFocusSignal;
};

} // namespace zebaudiofilterhost
