#include "host/src/XAU/linux/view/GenericView.h"

#include "foundation/zebcore/Threads.h"

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
constexpr int kOpeningHeight = 640; // at most: fits the smallest screens
constexpr int kRowsPerTurn = 3;     // of the wheel
constexpr unsigned int kLevelMs = 50;
constexpr float kPollSeconds = 0.03F;
constexpr xcb_button_t kLeftButton = 1;
constexpr xcb_button_t kWheelUp = 4;
constexpr xcb_button_t kWheelDown = 5;
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
    Connection connection(xcb_connect(nullptr, nullptr)); // never null
    if (xcb_connection_has_error(connection.get()) != 0)
        return nullptr;
    std::unique_ptr<GenericView> view(new GenericView(std::move(connection), unit, std::move(resized)));
    if (!view->OpenWindow(parent))
        return nullptr;
    view->Listen();
    return view;
}

GenericView::GenericView(Connection connection, AudioUnit unit, boost::function<void()> resized)
    : mConnection(std::move(connection))
    , mUnit(unit)
    , mIDs(ReadParameterIDs(unit))
    , mGeometry(ViewGeometry::Fit(mIDs.size(), kOpeningWidth, kOpeningHeight))
    , mResized(std::move(resized))
{
}

GenericView::~GenericView()
{
    *mIsAlive = false;
    OnRelease(); // a gesture ends with the view
    if (mListener)
        AUListenerDispose(mListener);
    zebcore::threads::RemoveTimerWatch(mLevelTimer);
    zebcore::threads::RemoveDescriptorWatch(mWatch);
    // cairo keeps what it knows of a connection under its address, which the next one may get.
    cairo_device_finish(mDevice);
    cairo_device_destroy(mDevice);
}

bool GenericView::OpenWindow(xcb_window_t parent)
{
    const xcb_screen_t* screen = FirstScreen(mConnection.get());
    mVisual = screen ? FindVisual(*screen) : nullptr;
    if (!mVisual)
        return false;
    mWindow = xcb_generate_id(mConnection.get());
    const std::uint32_t events = XCB_EVENT_MASK_EXPOSURE | XCB_EVENT_MASK_BUTTON_PRESS |
                                 XCB_EVENT_MASK_BUTTON_RELEASE | XCB_EVENT_MASK_BUTTON_MOTION;
    // In the order of their bits. A parent of another depth lends neither its border nor its colours.
    const std::array<std::uint32_t, 3> values = {0, events, screen->default_colormap};
    const auto cookie = xcb_create_window_checked(
        mConnection.get(), screen->root_depth, mWindow, parent, 0, 0, static_cast<std::uint16_t>(mGeometry.width),
        static_cast<std::uint16_t>(mGeometry.height), 0, XCB_WINDOW_CLASS_INPUT_OUTPUT, screen->root_visual,
        XCB_CW_BORDER_PIXEL | XCB_CW_EVENT_MASK | XCB_CW_COLORMAP, values.data());
    const Reply<xcb_generic_error_t> error(xcb_request_check(mConnection.get(), cookie));
    if (error)
        return false;
    xcb_map_window(mConnection.get(), mWindow);
    xcb_flush(mConnection.get());
    return true;
}

void GenericView::Listen()
{
    mWatch = zebcore::threads::AddDescriptorWatch(xcb_get_file_descriptor(mConnection.get()),
                                                  [this](int) { OnReadable(); });
    if (AUEventListenerCreate(OnParameterChanged, this, CFRunLoopGetCurrent(), kCFRunLoopDefaultMode, kPollSeconds,
                              kPollSeconds, &mListener) != noErr)
        mListener = nullptr;
}

void GenericView::OnParameterChanged(void* userData, void* object, const AudioUnitEvent* /*event*/,
                                     UInt64 /*hostTime*/, AudioUnitParameterValue /*value*/)
{
    if (static_cast<ParameterRow*>(object)->Refresh())
        static_cast<GenericView*>(userData)->PaintSoon();
}

ParameterRow& GenericView::GetRow(std::size_t index)
{
    const auto known = mRows.find(index);
    if (known != mRows.end())
        return known->second;
    ParameterRow& row = mRows.try_emplace(index, mUnit, kAudioUnitScope_Global, mIDs[index]).first->second;
    AudioUnitEvent event = {};
    event.mEventType = kAudioUnitEvent_ParameterValueChange;
    event.mArgument.mParameter = row.GetParameter();
    if (mListener)
        AUEventListenerAddEventType(mListener, &row, &event);
    if (row.GetControl() == ParameterRow::Control::Level && mLevelTimer == zebcore::threads::kNoWatch)
        mLevelTimer = zebcore::threads::AddTimerWatch(kLevelMs, [this] { WatchLevels(); });
    return row;
}

std::vector<ParameterRow*> GenericView::GetShownRows()
{
    std::vector<ParameterRow*> shown;
    for (std::size_t place = 0; place < mGeometry.GetShown(); ++place)
        shown.push_back(&GetRow(mGeometry.first + place));
    return shown;
}

void GenericView::WatchLevels()
{
    bool hasChanged = false;
    for (ParameterRow* row : GetShownRows())
        hasChanged = (row->GetControl() == ParameterRow::Control::Level && row->Refresh()) || hasChanged;
    if (hasChanged)
        Paint();
}

void GenericView::OnReadable()
{
    const std::shared_ptr<bool> isAlive = mIsAlive;
    while (const Reply<xcb_generic_event_t> event{xcb_poll_for_event(mConnection.get())})
    {
        OnEvent(*event);
        if (!*isAlive)
            return;
    }
    if (xcb_connection_has_error(mConnection.get()) != 0)
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
        OnMotion(reinterpret_cast<const xcb_motion_notify_event_t&>(event).event_x,
                 reinterpret_cast<const xcb_motion_notify_event_t&>(event).event_y);
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
    if (mHeldRow || mHoldsGrip || mHoldsBar)
        return;
    if (event.detail == kWheelUp || event.detail == kWheelDown)
        OnScroll(event.detail == kWheelUp ? -kRowsPerTurn : kRowsPerTurn);
    if (event.detail != kLeftButton)
        return;
    mHoldsGrip = mGeometry.IsGrip(event.event_x, event.event_y);
    mHoldsBar = !mHoldsGrip && mGeometry.IsScrollBar(event.event_x);
    if (mHoldsBar)
        Scroll(mGeometry.ScrolledToBar(event.event_y));
    if (mHoldsGrip || mHoldsBar)
        return;
    const auto row = mGeometry.FindControl(event.event_x, event.event_y);
    if (!row || !GetRow(*row).IsWritable())
        return;
    mHeldRow = row;
    ParameterRow& held = GetRow(*row);
    held.Notify(kAudioUnitEvent_BeginParameterChangeGesture);
    if ((event.state & XCB_MOD_MASK_CONTROL) != 0)
        held.SetDefault();
    else if (held.GetControl() == ParameterRow::Control::Switch)
        held.SetPosition(held.GetPosition() >= 0.5 ? 0.0 : 1.0);
    else
        DragControl(event.event_x);
    Paint();
}

void GenericView::OnMotion(int x, int y)
{
    if (mHoldsGrip)
        Resize(x, y);
    else if (mHoldsBar)
        Scroll(mGeometry.ScrolledToBar(y));
    else if (mHeldRow && GetRow(*mHeldRow).GetControl() != ParameterRow::Control::Switch)
    {
        DragControl(x);
        Paint();
    }
}

void GenericView::DragControl(int x)
{
    ParameterRow& row = GetRow(*mHeldRow);
    double position = mGeometry.GetPosition(x);
    if (HasStepFields(mGeometry, row))
    {
        // The field that the pointer is in, and not the nearest end of one.
        const auto count = static_cast<double>(row.GetStepNames().size());
        const auto field = static_cast<double>(static_cast<int>(std::min(position * count, count - 1.0)));
        position = field / (count - 1.0);
    }
    row.SetPosition(position);
}

void GenericView::OnRelease()
{
    mHoldsGrip = false;
    mHoldsBar = false;
    if (const auto row = std::exchange(mHeldRow, std::nullopt))
        GetRow(*row).Notify(kAudioUnitEvent_EndParameterChangeGesture);
}

void GenericView::OnScroll(int rows)
{
    Scroll(mGeometry.ScrolledTo(static_cast<std::ptrdiff_t>(mGeometry.first) + rows));
}

void GenericView::Scroll(const ViewGeometry& geometry)
{
    if (geometry.first == mGeometry.first)
        return;
    mGeometry = geometry;
    for (ParameterRow* row : GetShownRows())
        row->Refresh(); // levels were not watched
    Paint();
}

void GenericView::Resize(int width, int height)
{
    const ViewGeometry geometry = ViewGeometry::Fit(mIDs.size(), width, height + ViewGeometry::kRowHeight / 2)
                                      .ScrolledTo(static_cast<std::ptrdiff_t>(mGeometry.first));
    if (geometry.width == mGeometry.width && geometry.height == mGeometry.height)
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
    xcb_configure_window(mConnection.get(), mWindow, XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT, size.data());
    xcb_flush(mConnection.get());
}

// Once for all that changes at a time.
void GenericView::PaintSoon()
{
    if (std::exchange(mPaintsSoon, true))
        return;
    zebcore::threads::AsyncCallFromMainThread(
        [this, isAlive = mIsAlive]
        {
            if (!*isAlive)
                return;
            mPaintsSoon = false;
            Paint();
        },
        0);
}

void GenericView::Paint()
{
    const std::vector<ParameterRow*> shown = GetShownRows();
    cairo_surface_t* surface =
        cairo_xcb_surface_create(mConnection.get(), mWindow, mVisual, mGeometry.width, mGeometry.height);
    if (!mDevice)
        mDevice = cairo_device_reference(cairo_surface_get_device(surface));
    cairo_t* context = cairo_create(surface);
    cairo_push_group(context); // at once, without flicker
    PaintView(context, mGeometry, {shown.begin(), shown.end()});
    cairo_pop_group_to_source(context);
    cairo_paint(context);
    cairo_destroy(context);
    cairo_surface_destroy(surface);
    xcb_flush(mConnection.get());
}

// There are no views of the units' own on this system: what they could be made of is not here.
std::unique_ptr<XAUView> OpenXAUView(AudioUnit unit, int /*viewClasses*/, void* parent,
                                     const boost::function<void()>& resized)
{
    return GenericView::Create(unit, static_cast<xcb_window_t>(reinterpret_cast<std::uintptr_t>(parent)), resized);
}

} // namespace zebaudiofilterhost::xau
