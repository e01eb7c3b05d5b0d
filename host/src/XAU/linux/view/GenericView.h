#pragma once

#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/XAU/linux/view/ParameterRow.h"
#include "host/src/XAU/linux/view/ViewPainter.h"
#include "host/src/XAU/src/XAUView.h"

#include <xcb/xcb.h>

#include <memory>
#include <optional>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// All parameters of a unit in an X11 window of our own, which follows changes from elsewhere. It has a connection to
/// the X server of its own, whose errors do not end the process when the parent has gone first. [main]
class GenericView : public XAUView
{
public:
    /// Null if there is no X server. `parent` is a window.
    static std::unique_ptr<GenericView> Create(AudioUnit unit, xcb_window_t parent, boost::function<void()> resized);
    ~GenericView() override;

    float GetWidth() const override;
    float GetHeight() const override;
    void FitFrame() override;

private:
    GenericView(xcb_connection_t* connection, AudioUnit unit, boost::function<void()> resized);

    bool OpenWindow(xcb_window_t parent);
    void Listen();
    void OnReadable();
    void OnEvent(const xcb_generic_event_t& event);
    void OnPress(const xcb_button_press_event_t& event);
    void OnMotion(int x);
    void OnRelease();
    void Resize(int width);
    void Paint();
    static void OnParameterChanged(void* userData, void* object, const AudioUnitEvent* event, UInt64 hostTime,
                                   AudioUnitParameterValue value);

    xcb_connection_t* mConnection;
    xcb_window_t mWindow = XCB_NONE;
    xcb_visualtype_t* mVisual = nullptr; // the connection's
    cairo_device_t* mDevice = nullptr;   // one reference, once something is drawn
    zebcore::threads::WatchID mWatch = zebcore::threads::kNoWatch;
    AUEventListenerRef mListener = nullptr;
    std::vector<ParameterRow> mRows;
    ViewGeometry mGeometry;
    boost::function<void()> mResized;
    std::optional<std::size_t> mHeldRow; // under a pressed button
    bool mHoldsGrip = false;
    std::shared_ptr<bool> mIsAlive = std::make_shared<bool>(true); // for what may end it in the middle of an event
};

} // namespace zebaudiofilterhost::xau
