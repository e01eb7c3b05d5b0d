#pragma once

#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/XAU/linux/view/ParameterRow.h"
#include "host/src/XAU/linux/view/ViewPainter.h"
#include "host/src/XAU/src/XAUView.h"

#include <xcb/xcb.h>

#include <map>
#include <memory>
#include <optional>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// All parameters of a unit in an X11 window of our own, which follows changes from elsewhere. A parameter is read,
/// and listened to, when it is first shown: there may be thousands. It has a connection to the X server of its own,
/// whose errors do not end the process when the parent has gone first. [main]
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
    struct Disconnect
    {
        void operator()(xcb_connection_t* connection) const { xcb_disconnect(connection); } // the window goes with it
    };
    using Connection = std::unique_ptr<xcb_connection_t, Disconnect>;

    GenericView(Connection connection, AudioUnit unit, boost::function<void()> resized);

    bool OpenWindow(xcb_window_t parent);
    void Listen();
    void OnReadable();
    void OnEvent(const xcb_generic_event_t& event);
    void OnPress(const xcb_button_press_event_t& event);
    void OnScroll(int rows);
    void OnMotion(int x, int y);
    void OnRelease();
    void DragControl(int x);
    void Scroll(const ViewGeometry& geometry);
    void Resize(int width, int height);
    void WatchLevels();
    ParameterRow& GetRow(std::size_t index);
    std::vector<ParameterRow*> GetShownRows();
    void PaintSoon();
    void Paint();
    static void OnParameterChanged(void* userData, void* object, const AudioUnitEvent* event, UInt64 hostTime,
                                   AudioUnitParameterValue value);

    Connection mConnection;
    AudioUnit mUnit;
    xcb_window_t mWindow = XCB_NONE;
    xcb_visualtype_t* mVisual = nullptr; // the connection's
    cairo_device_t* mDevice = nullptr;   // one reference, once something is drawn
    zebcore::threads::WatchID mWatch = zebcore::threads::kNoWatch;
    zebcore::threads::WatchID mLevelTimer = zebcore::threads::kNoWatch; // units do not tell of levels
    AUEventListenerRef mListener = nullptr;
    std::vector<AudioUnitParameterID> mIDs;
    std::map<std::size_t, ParameterRow> mRows; // those shown so far
    ViewGeometry mGeometry;
    boost::function<void()> mResized;
    std::optional<std::size_t> mHeldRow; // under a pressed button
    bool mHoldsGrip = false;
    bool mHoldsBar = false;
    bool mPaintsSoon = false;
    std::shared_ptr<bool> mIsAlive = std::make_shared<bool>(true); // for what may end it in the middle of an event
};

} // namespace zebaudiofilterhost::xau
