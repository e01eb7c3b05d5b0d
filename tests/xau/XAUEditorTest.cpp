// The view of a unit in a real window: wants an X server.

#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/XAU/linux/view/ViewPainter.h"
#include "tests/xau/support/DescribedUnit.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>
#include <xcb/xcb.h>

#include <array>
#include <cstdlib>
#include <cstring>
#include <numeric>
#include <set>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr unsigned int kPatience = 5000; // milliseconds

struct FreeReply
{
    void operator()(void* reply) const { std::free(reply); }
};
template <typename T>
using Reply = std::unique_ptr<T, FreeReply>;

class XAUEditorTest : public testing::Test
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        mConnection = xcb_connect(nullptr, nullptr);
        ASSERT_EQ(xcb_connection_has_error(mConnection), 0) << "there is no X server";
        const xcb_screen_t* screen = xcb_setup_roots_iterator(xcb_get_setup(mConnection)).data;
        mParent = xcb_generate_id(mConnection);
        xcb_create_window(mConnection, XCB_COPY_FROM_PARENT, mParent, screen->root, 0, 0, 900, 400, 0,
                          XCB_WINDOW_CLASS_INPUT_OUTPUT, screen->root_visual, 0, nullptr);
        xcb_map_window(mConnection, mParent);
        xcb_flush(mConnection);
        DescribeParameters();
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
        mEditor = mFilter->CreateCustomEditor();
    }

    void TearDown() override
    {
        mEditor.reset();
        mFilter.reset();
        xcb_disconnect(mConnection);
    }

    // A slider, three steps and a switch.
    void DescribeParameters()
    {
        mUnit.SetParameters({0, 1, 2}, 0.0F, 1.0F);
        const std::array<AudioUnitParameterUnit, 3> units = {
            kAudioUnitParameterUnit_Generic, kAudioUnitParameterUnit_Indexed, kAudioUnitParameterUnit_Boolean};
        for (AudioUnitParameterID id = 0; id < units.size(); ++id)
        {
            const FakeUnit::Key key(kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, id);
            auto info = mUnit.Read<AudioUnitParameterInfo>(key);
            info.unit = units[id];
            info.maxValue = id == 1 ? 2.0F : 1.0F;
            mUnit.Answer(key, info);
        }
    }

    void Open()
    {
        mEditor->Open(reinterpret_cast<void*>(static_cast<std::uintptr_t>(mParent)));
        const Reply<xcb_query_tree_reply_t> tree(
            xcb_query_tree_reply(mConnection, xcb_query_tree(mConnection, mParent), nullptr));
        ASSERT_EQ(xcb_query_tree_children_length(tree.get()), 1);
        mView = *xcb_query_tree_children(tree.get());
        EXPECT_TRUE(WaitFor([&] { return CountColours() > 3; })) << "nothing was drawn";
    }

    static bool WaitFor(const boost::function<bool()>& done)
    {
        return zebcore::threads::RunMainThreadUntil(done, kPatience);
    }

    std::vector<std::uint32_t> Pixels() const
    {
        const auto rect = mEditor->GetEditorRect();
        const Reply<xcb_get_image_reply_t> image(xcb_get_image_reply(
            mConnection,
            xcb_get_image(mConnection, XCB_IMAGE_FORMAT_Z_PIXMAP, mView, 0, 0, static_cast<std::uint16_t>(rect.right),
                          static_cast<std::uint16_t>(rect.bottom), ~0U),
            nullptr));
        if (!image)
            return {};
        std::vector<std::uint32_t> pixels(static_cast<std::size_t>(xcb_get_image_data_length(image.get())) / 4);
        std::memcpy(pixels.data(), xcb_get_image_data(image.get()), pixels.size() * 4);
        return pixels;
    }
    std::size_t CountColours() const
    {
        const std::vector<std::uint32_t> pixels = Pixels();
        return std::set<std::uint32_t>(pixels.begin(), pixels.end()).size();
    }

    void Send(std::uint8_t type, int x, int y, std::uint16_t state = 0, xcb_button_t button = 1) const
    {
        xcb_button_press_event_t event = {}; // of the same form as the other two
        event.response_type = type;
        event.detail = type == XCB_MOTION_NOTIFY ? xcb_button_t{0} : button;
        event.event = mView;
        event.event_x = static_cast<std::int16_t>(x);
        event.event_y = static_cast<std::int16_t>(y);
        event.state = state;
        xcb_send_event(mConnection, 0, mView, XCB_EVENT_MASK_BUTTON_PRESS | XCB_EVENT_MASK_BUTTON_RELEASE,
                       reinterpret_cast<const char*>(&event));
        xcb_flush(mConnection);
    }

    // Once, with something done in the midst of it.
    void DragTheCorner(const boost::function<void()>& react)
    {
        Open();
        const auto before = mEditor->GetEditorRect();
        int told = 0;
        const boost::signals2::scoped_connection connection = mEditor->GetContentSizeChangedSignal().connect(
            [&]
            {
                ++told;
                react();
            });
        Send(XCB_BUTTON_PRESS, before.right - 2, before.bottom - 2);
        Send(XCB_MOTION_NOTIFY, 700, before.bottom);
        Send(XCB_BUTTON_RELEASE, 700, before.bottom);
        EXPECT_TRUE(WaitFor([&] { return told > 0; }));
        zebcore::threads::RunMainThreadUntil({}, 50); // whatever is left to do for the view
        EXPECT_EQ(told, 1);
    }

    Float32 Value(AudioUnitParameterID id) { return mUnit.mValues[{kAudioUnitScope_Global, id}]; }
    static int RowMiddle(int row) { return ViewGeometry::kMargin + row * ViewGeometry::kRowHeight + 13; }

    DescribedUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
    boost::intrusive_ptr<AudioFilterEditor> mEditor;
    xcb_connection_t* mConnection = nullptr;
    xcb_window_t mParent = XCB_NONE;
    xcb_window_t mView = XCB_NONE;
};

TEST_F(XAUEditorTest, AClickOnAControlChangesTheParameterWithinAGesture)
{
    Open();
    const int middle = mEditor->GetEditorRect().right / 2;
    std::vector<std::string> heard;
    mFilter->ConnectEditingStateChange([&](int, bool starts) { heard.emplace_back(starts ? "begin" : "end"); });
    mFilter->GetAutomatedParameterChangeSignal().connect([&](int index, float)
                                                         { heard.push_back(std::to_string(index)); });
    Send(XCB_BUTTON_PRESS, middle, RowMiddle(0));
    EXPECT_TRUE(WaitFor([&] { return Value(0) > 0.2F && Value(0) < 0.8F; })) << Value(0);
    Send(XCB_MOTION_NOTIFY, 5000, RowMiddle(0));
    EXPECT_TRUE(WaitFor([&] { return Value(0) == 1.0F; })) << Value(0);
    Send(XCB_BUTTON_RELEASE, 5000, RowMiddle(0));
    EXPECT_TRUE(WaitFor([&] { return !heard.empty() && heard.back() == "end"; }));
    ASSERT_FALSE(heard.empty());
    EXPECT_EQ(heard.front(), "begin");
    EXPECT_EQ(std::count(heard.begin(), heard.end(), "0"), static_cast<long>(heard.size()) - 2);
    Send(XCB_MOTION_NOTIFY, 0, RowMiddle(0)); // nothing is held any more

    Send(XCB_BUTTON_PRESS, middle, RowMiddle(1));
    Send(XCB_BUTTON_RELEASE, middle, RowMiddle(1));
    EXPECT_TRUE(WaitFor([&] { return Value(1) == 1.0F; })) << "the second of three steps: " << Value(1);
    for (const Float32 value : {1.0F, 0.0F})
    {
        Send(XCB_BUTTON_PRESS, middle - 70, RowMiddle(2));
        Send(XCB_BUTTON_RELEASE, middle - 70, RowMiddle(2));
        EXPECT_TRUE(WaitFor([&] { return Value(2) == value; })) << "the switch: " << Value(2);
    }
    EXPECT_EQ(Value(0), 1.0F);
}

TEST_F(XAUEditorTest, ALevelIsFollowedAndNotToBeChanged)
{
    mUnit.Describe(0, kAudioUnitParameterUnit_Generic,
                   kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_MeterReadOnly);
    Open();
    const std::vector<std::uint32_t> before = Pixels();
    mUnit.mValues[{kAudioUnitScope_Global, 0}] = 0.5F; // told to nobody
    EXPECT_TRUE(WaitFor([&] { return Pixels() != before; }));
    Send(XCB_BUTTON_PRESS, mEditor->GetEditorRect().right / 3 + 60, RowMiddle(0));
    Send(XCB_BUTTON_RELEASE, mEditor->GetEditorRect().right / 3 + 60, RowMiddle(0));
    Send(XCB_BUTTON_PRESS, mEditor->GetEditorRect().right / 2 - 70, RowMiddle(2));
    EXPECT_TRUE(WaitFor([&] { return Value(2) == 1.0F; }));
    EXPECT_EQ(Value(0), 0.5F);
}

TEST_F(XAUEditorTest, ThousandsOfParametersAreScrolledThrough)
{
    constexpr AudioUnitParameterID kCount = 32768;
    std::vector<AudioUnitParameterID> ids(kCount);
    std::iota(ids.begin(), ids.end(), 0);
    mUnit.SetParameters(ids, 0.0F, 1.0F);
    Open();
    const auto rect = mEditor->GetEditorRect();
    EXPECT_LT(rect.bottom, 768);
    EXPECT_GT(rect.bottom, 400);
    const int middle = rect.right / 2;
    const auto click = [&](int row)
    {
        Send(XCB_BUTTON_PRESS, middle, RowMiddle(row));
        Send(XCB_BUTTON_RELEASE, middle, RowMiddle(row));
    };
    const auto changed = [&](AudioUnitParameterID id)
    {
        return WaitFor([&] { return Value(id) > 0.2F; });
    };
    Send(XCB_BUTTON_PRESS, middle, RowMiddle(0), 0, 4); // the wheel, at the top already
    click(1);
    EXPECT_TRUE(changed(1));
    Send(XCB_BUTTON_PRESS, middle, RowMiddle(0), 0, 5);
    click(1);
    EXPECT_TRUE(changed(4)) << "three rows further";
    Send(XCB_BUTTON_PRESS, rect.right - 3, rect.bottom / 2);
    Send(XCB_MOTION_NOTIFY, rect.right - 3, rect.bottom - 5);
    Send(XCB_BUTTON_RELEASE, rect.right - 3, rect.bottom - 5);
    const auto shown = static_cast<int>(ViewGeometry::Fit(kCount, rect.right, rect.bottom).GetShown());
    click(shown - 1);
    EXPECT_TRUE(changed(kCount - 1)) << "the last one of all";
    EXPECT_EQ(mUnit.mValues.size(), kCount);
}

TEST_F(XAUEditorTest, AViewThatGoesEndsItsGesture)
{
    Open();
    std::vector<std::string> heard;
    mFilter->ConnectEditingStateChange([&](int, bool starts) { heard.emplace_back(starts ? "begin" : "end"); });
    Send(XCB_BUTTON_PRESS, mEditor->GetEditorRect().right / 2, RowMiddle(0));
    EXPECT_TRUE(WaitFor([&] { return !heard.empty(); }));
    mEditor->Open(reinterpret_cast<void*>(static_cast<std::uintptr_t>(mParent)));
    EXPECT_TRUE(WaitFor([&] { return heard.size() == 2; }));
    EXPECT_EQ(heard, (std::vector<std::string>{"begin", "end"}));
}

TEST_F(XAUEditorTest, ASliderOfStepsGoesToTheNearest)
{
    mUnit.DescribeSteps(15, {});
    Open();
    const ViewGeometry geometry = ViewGeometry::Fit(3, mEditor->GetEditorRect().right, 400);
    // Of 16 fields it would be the third.
    const int place = static_cast<int>(geometry.GetControlLeft() + geometry.GetControlWidth() * 2.8 / 15.0);
    Send(XCB_BUTTON_PRESS, place, RowMiddle(1));
    Send(XCB_BUTTON_RELEASE, place, RowMiddle(1));
    EXPECT_TRUE(WaitFor([&] { return Value(1) == 3.0F; })) << Value(1);
}

TEST_F(XAUEditorTest, AChangeFromElsewhereIsDrawn)
{
    Open();
    const std::vector<std::uint32_t> before = Pixels();
    mFilter->SetParameter(0, 0.75F);
    EXPECT_TRUE(WaitFor([&] { return Pixels() != before; }));
}

TEST_F(XAUEditorTest, DraggingTheCornerResizesTheViewAndSaysSo)
{
    Open();
    const auto before = mEditor->GetEditorRect();
    int told = 0;
    mEditor->GetContentSizeChangedSignal().connect(
        [&]
        {
            ++told;
            EXPECT_EQ(mEditor->GetEditorRect().right, 700);
        });
    Send(XCB_BUTTON_PRESS, before.right - 2, before.bottom - 2);
    Send(XCB_MOTION_NOTIFY, 700, before.bottom);
    Send(XCB_BUTTON_RELEASE, 700, before.bottom);
    EXPECT_TRUE(WaitFor([&] { return told > 0; }));
    EXPECT_EQ(told, 1);
    const auto isWide = [this]
    {
        const Reply<xcb_get_geometry_reply_t> geometry(
            xcb_get_geometry_reply(mConnection, xcb_get_geometry(mConnection, mView), nullptr));
        return geometry && geometry->width == 700;
    };
    EXPECT_TRUE(WaitFor(isWide)); // the view's own connection may be served later than this one
}

TEST_F(XAUEditorTest, WhoHearsOfTheSizeMayOpenTheViewAgain)
{
    DragTheCorner([this] { mEditor->Open(reinterpret_cast<void*>(static_cast<std::uintptr_t>(mParent))); });
    EXPECT_GT(mEditor->GetEditorRect().right, 0);
}

TEST_F(XAUEditorTest, WhoHearsOfTheSizeMayLetTheFilterGo)
{
    DragTheCorner(
        [this]
        {
            mEditor.reset();
            mFilter.reset();
        });
}

TEST_F(XAUEditorTest, TheEditorStaysOneAndOutlivesItsParent)
{
    EXPECT_EQ(mFilter->CreateCustomEditor(), mEditor);
    EXPECT_EQ(mEditor->GetEditorRect().right, 0);
    EXPECT_TRUE(mEditor->CanEmbedView());
    Open();
    EXPECT_GT(mEditor->GetEditorRect().right, 0);
    mEditor->Close();
    xcb_destroy_window(mConnection, mParent);
    xcb_flush(mConnection);
    mFilter->SetParameter(0, 0.75F); // draws into nothing
    zebcore::threads::RunMainThreadUntil({}, 100);
    mEditor->Idle();
}

} // namespace
} // namespace zebaudiofilterhost::xau
