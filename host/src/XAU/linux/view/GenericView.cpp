#include "host/src/XAU/linux/view/GenericView.h"

#include <cairo-xcb.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <utility>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr int kOpeningWidth = 480;
constexpr float kListenerSeconds = 0.03F;
constexpr xcb_button_t kLeftButton = 1;
constexpr std::uint8_t kSentMask = 0x80; // in an event's type: another client sent it

struct FreeEvent
{
    void operator()(void* event) const { std::free(event); } // NOLINT(cppcoreguidelines-no-malloc): xcb's way
};

template <typename T>
using Reply = std::unique_ptr<T, FreeEvent>;

xcb_screen_t* FirstScreen(xcb_connection_t* connection)
{
    return xcb_setup_roots_iterator(xcb_get_setup(connection)).data;
}

// Null if the screen does not list it.
xcb_visualtype_t* FindVisual(const xcb_screen_t& screen)
{
    for (auto depth = xcb_screen_allowed_depths_iterator(&screen); depth.rem > 0; xcb_depth_next(&depth))
    {
        for (auto visual = xcb_depth_visuals_iterator(depth.data); visual.rem > 0; xcb_visualtype_next(&visual))
        {
            if (visual.data->visual_id == screen.root_visual)
                return visual.data;
        }
    }
    return nullptr;
}

} // namespace

std::unique_ptr<GenericView> GenericView::Create(AudioUnit unit, xcb_window_t parent, boost::function<void()> resized)
{
    xcb_connection_t* connection = xcb_connect(nullptr, nullptr);
    if (xcb_connection_has_error(connection) != 0)
    {
        xcb_disconnect(connection);
        return nullptr;
    }
    std::unique_ptr<GenericView> view(new GenericView(connection, unit, std::move(resized)));
    if (!view->OpenWindow(parent))
        return nullptr;
    view->Listen();
    return view;
}

GenericView::GenericView(xcb_connection_t* connection, AudioUnit unit, boost::function<void()> resized)
    : mConnection(connection)
    , mRows(ReadParameterRows(unit))
    , mGeometry(ViewGeometry::Fit(mRows.size(), kOpeningWidth))
    , mResized(std::move(resized))
{
}

GenericView::~GenericView()
{
    *mIsAlive = false;
    if (mListener)
        AUListenerDispose(mListener);
    zebcore::threads::RemoveDescriptorWatch(mWatch);
    // cairo keeps what it knows of a connection under its address, which the next one may get.
    cairo_device_finish(mDevice);
    cairo_device_destroy(mDevice);
    xcb_disconnect(mConnection); // the window goes with it
}

bool GenericView::OpenWindow(xcb_window_t parent)
{
    const xcb_screen_t* screen = FirstScreen(mConnection);
    mVisual = screen ? FindVisual(*screen) : nullptr;
    if (!mVisual)
        return false;
    mWindow = xcb_generate_id(mConnection);
    const std::uint32_t events = XCB_EVENT_MASK_EXPOSURE | XCB_EVENT_MASK_BUTTON_PRESS |
                                 XCB_EVENT_MASK_BUTTON_RELEASE | XCB_EVENT_MASK_BUTTON_MOTION;
    // In the order of their bits. A parent of another depth lends neither its border nor its colours.
    const std::array<std::uint32_t, 3> values = {0, events, screen->default_colormap};
    const auto cookie = xcb_create_window_checked(
        mConnection, screen->root_depth, mWindow, parent, 0, 0, static_cast<std::uint16_t>(mGeometry.width),
        static_cast<std::uint16_t>(mGeometry.height), 0, XCB_WINDOW_CLASS_INPUT_OUTPUT, screen->root_visual,
        XCB_CW_BORDER_PIXEL | XCB_CW_EVENT_MASK | XCB_CW_COLORMAP, values.data());
    const Reply<xcb_generic_error_t> error(xcb_request_check(mConnection, cookie));
    if (error)
        return false;
    xcb_map_window(mConnection, mWindow);
    xcb_flush(mConnection);
    return true;
}

void GenericView::Listen()
{
    mWatch =
        zebcore::threads::AddDescriptorWatch(xcb_get_file_descriptor(mConnection), [this](int) { OnReadable(); });
    if (AUEventListenerCreate(OnParameterChanged, this, CFRunLoopGetCurrent(), kCFRunLoopDefaultMode,
                              kListenerSeconds, kListenerSeconds, &mListener) != noErr)
        return;
    for (ParameterRow& row : mRows)
    {
        AudioUnitEvent event = {};
        event.mEventType = kAudioUnitEvent_ParameterValueChange;
        event.mArgument.mParameter = row.GetParameter();
        AUEventListenerAddEventType(mListener, &row, &event);
    }
}

void GenericView::OnParameterChanged(void* userData, void* object, const AudioUnitEvent* /*event*/,
                                     UInt64 /*hostTime*/, AudioUnitParameterValue /*value*/)
{
    if (static_cast<ParameterRow*>(object)->Refresh())
        static_cast<GenericView*>(userData)->Paint();
}

void GenericView::OnReadable()
{
    const std::shared_ptr<bool> isAlive = mIsAlive;
    while (const Reply<xcb_generic_event_t> event{xcb_poll_for_event(mConnection)})
    {
        OnEvent(*event);
        if (!*isAlive)
            return;
    }
    if (xcb_connection_has_error(mConnection) != 0)
        zebcore::threads::RemoveDescriptorWatch(std::exchange(mWatch, zebcore::threads::kNoWatch));
}

void GenericView::OnEvent(const xcb_generic_event_t& event)
{
    switch (event.response_type & ~kSentMask)
    {
    case XCB_EXPOSE:
        if (reinterpret_cast<const xcb_expose_event_t&>(event).count == 0)
            Paint();
        break;
    case XCB_BUTTON_PRESS:
        OnPress(reinterpret_cast<const xcb_button_press_event_t&>(event));
        break;
    case XCB_MOTION_NOTIFY:
        OnMotion(reinterpret_cast<const xcb_motion_notify_event_t&>(event).event_x);
        break;
    case XCB_BUTTON_RELEASE:
        OnRelease();
        break;
    default: // errors among them: the parent has gone
        break;
    }
}

void GenericView::OnPress(const xcb_button_press_event_t& event)
{
    if (event.detail != kLeftButton || mHeldRow || mHoldsGrip)
        return;
    mHoldsGrip = mGeometry.IsGrip(event.event_x, event.event_y);
    const auto row = mHoldsGrip ? std::nullopt : mGeometry.FindControl(event.event_x, event.event_y);
    if (!row || !mRows[*row].IsWritable())
        return;
    mHeldRow = row;
    ParameterRow& held = mRows[*row];
    held.Notify(kAudioUnitEvent_BeginParameterChangeGesture);
    if ((event.state & XCB_MOD_MASK_CONTROL) != 0)
        held.SetDefault();
    else if (held.GetControl() == ParameterRow::Control::Switch)
        held.SetPosition(held.GetPosition() >= 0.5 ? 0.0 : 1.0);
    else
        OnMotion(event.event_x);
    Paint();
}

void GenericView::OnMotion(int x)
{
    if (mHoldsGrip)
    {
        Resize(x);
        return;
    }
    if (!mHeldRow)
        return;
    ParameterRow& row = mRows[*mHeldRow];
    if (row.GetControl() == ParameterRow::Control::Switch)
        return;
    double position = mGeometry.GetPosition(x);
    if (HasStepFields(mGeometry, row))
    {
        // The field that the pointer is in, and not the nearest end of one.
        const auto count = static_cast<double>(row.GetStepNames().size());
        const auto field = static_cast<double>(static_cast<int>(std::min(position * count, count - 1.0)));
        position = field / (count - 1.0);
    }
    row.SetPosition(position);
    Paint();
}

void GenericView::OnRelease()
{
    mHoldsGrip = false;
    if (const auto row = std::exchange(mHeldRow, std::nullopt))
        mRows[*row].Notify(kAudioUnitEvent_EndParameterChangeGesture);
}

void GenericView::Resize(int width)
{
    const ViewGeometry geometry = ViewGeometry::Fit(mRows.size(), width);
    if (geometry.width == mGeometry.width)
        return;
    mGeometry = geometry;
    FitFrame();
    const std::shared_ptr<bool> isAlive = mIsAlive;
    const boost::function<void()> resized = mResized;
    if (resized)
        resized(); // may be the end of this view
    if (*isAlive)
        Paint();
}

float GenericView::GetWidth() const
{
    return static_cast<float>(mGeometry.width);
}

float GenericView::GetHeight() const
{
    return static_cast<float>(mGeometry.height);
}

void GenericView::FitFrame()
{
    const std::array size = {static_cast<std::uint32_t>(mGeometry.width),
                             static_cast<std::uint32_t>(mGeometry.height)};
    xcb_configure_window(mConnection, mWindow, XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT, size.data());
    xcb_flush(mConnection);
}

void GenericView::Paint()
{
    cairo_surface_t* surface =
        cairo_xcb_surface_create(mConnection, mWindow, mVisual, mGeometry.width, mGeometry.height);
    if (!mDevice)
        mDevice = cairo_device_reference(cairo_surface_get_device(surface));
    cairo_t* context = cairo_create(surface);
    cairo_push_group(context); // at once, without flicker
    PaintView(context, mGeometry, mRows);
    cairo_pop_group_to_source(context);
    cairo_paint(context);
    cairo_destroy(context);
    cairo_surface_destroy(surface);
    xcb_flush(mConnection);
}

// There are no views of the units' own on this system: what they could be made of is not here.
std::unique_ptr<XAUView> OpenXAUView(AudioUnit unit, int /*viewClasses*/, void* parent,
                                     const boost::function<void()>& resized)
{
    return GenericView::Create(unit, static_cast<xcb_window_t>(reinterpret_cast<std::uintptr_t>(parent)), resized);
}

} // namespace zebaudiofilterhost::xau
