// The example editor in a real X11 window: what it draws, how it answers the mouse, how it resizes.
#include "tests/plugins/ChildWindow.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/direct/DirectPlugin.h"

#include <gtest/gtest.h>
#include <poll.h>

namespace
{

using namespace zebtest;

constexpr unsigned long kKnobColour = 0xf2a93b;

class ZebViewInAWindow : public testing::Test
{
protected:
    void SetUp() override
    {
        mDisplay = XOpenDisplay(nullptr);
        if (mDisplay == nullptr)
            GTEST_SKIP() << "no X server";
        mParent = XCreateSimpleWindow(mDisplay, DefaultRootWindow(mDisplay), 0, 0, 640, 240, 0, 0, 0);
        XMapWindow(mDisplay, mParent);
        XSync(mDisplay, False);
        mView = IPtr<IPlugView>(mPlugin.controller->createView("editor"), false);
        mView->setFrame(mPlugin.host);
        // A window ID travels as a pointer.
        ASSERT_EQ(mView->attached(reinterpret_cast<void*>(mParent), "X11EmbedWindowID"), kResultOk);
        ASSERT_NE(mPlugin.host->eventHandler, nullptr);
        ASSERT_NE(mPlugin.host->timerHandler, nullptr);
        mChild = FindChildWindow(mDisplay, mParent);
        ASSERT_TRUE(RunUntil([&] { return PixelAt(160, 40) == kKnobColour; }));
    }

    void TearDown() override
    {
        if (mDisplay == nullptr)
            return;
        if (mView != nullptr)
            mView->setFrame(nullptr);
        mView = nullptr;
        EXPECT_EQ(mPlugin.host->eventHandler, nullptr);
        EXPECT_EQ(mPlugin.host->timerHandler, nullptr);
        XCloseDisplay(mDisplay);
    }

    unsigned long PixelAt(int x, int y) { return WindowPixelAt(mDisplay, mChild, x, y); }

    // Serves the view's descriptor and timer as a host's run loop does: events that Xlib has read while it waited for
    // an answer wake no descriptor.
    template <class Done>
    bool RunUntil(Done done)
    {
        for (int tries = 0; tries < 100 && !done(); ++tries)
        {
            pollfd descriptor{mPlugin.host->descriptor, POLLIN, 0};
            if (poll(&descriptor, 1, 20) > 0)
                mPlugin.host->eventHandler->onFDIsSet(mPlugin.host->descriptor);
            else
                mPlugin.host->timerHandler->onTimer();
        }
        return done();
    }

    void SendMouse(int type, int x, int y) { SendMouseTo(mDisplay, mChild, type, x, y); }

    DirectPlugin mPlugin{EffectBundle("ZebView")};
    Display* mDisplay = nullptr;
    Window mParent = 0;
    Window mChild = 0;
    IPtr<IPlugView> mView;
};

TEST_F(ZebViewInAWindow, DragsItsSliderBetweenBeginAndEnd)
{
    SendMouse(ButtonPress, 232, 40); // 16 + 0.75 * 288
    SendMouse(MotionNotify, 304, 40);
    SendMouse(ButtonRelease, 304, 40);
    ASSERT_TRUE(RunUntil([&] { return !mPlugin.host->told.empty() && mPlugin.host->told.back() == "end 0"; }));
    EXPECT_EQ(mPlugin.host->told,
              (std::vector<std::string>{"begin 0", "perform 0", "perform 0", "perform 0", "end 0"}));
    EXPECT_EQ(mPlugin.host->lastValue, 1.0);
    EXPECT_EQ(mPlugin.controller->getParamNormalized(0), 1.0);
    EXPECT_TRUE(RunUntil([&] { return PixelAt(304, 40) == kKnobColour; }));
}

TEST_F(ZebViewInAWindow, FollowsAValueThatChangesElsewhere)
{
    mPlugin.controller->setParamNormalized(0, 0.0);
    mPlugin.host->timerHandler->onTimer();
    EXPECT_TRUE(RunUntil([&] { return PixelAt(16, 40) == kKnobColour; }));
    EXPECT_NE(PixelAt(160, 40), kKnobColour);
}

TEST_F(ZebViewInAWindow, SwitchesItsSizeWhenTheFrameAgrees)
{
    SendMouse(ButtonPress, 315, 115);
    ASSERT_TRUE(RunUntil([&] { return !mPlugin.host->told.empty(); }));
    EXPECT_EQ(mPlugin.host->told, std::vector<std::string>{"resize 480 180"});
    ViewRect size;
    mView->getSize(&size);
    EXPECT_EQ(size.getWidth(), 480);
    // The view resizes its window by a connection of its own.
    EXPECT_TRUE(RunUntil(
        [&]
        {
            XWindowAttributes attributes{};
            XGetWindowAttributes(mDisplay, mChild, &attributes);
            return attributes.width == 480 && attributes.height == 180;
        }));
}

TEST_F(ZebViewInAWindow, EndsAGestureThatClosingCutsShort)
{
    SendMouse(ButtonPress, 160, 40);
    ASSERT_TRUE(RunUntil([&] { return mPlugin.host->told.size() == 2; }));
    EXPECT_EQ(mView->removed(), kResultOk);
    EXPECT_EQ(mPlugin.host->told.back(), "end 0");
    EXPECT_EQ(FindChildWindow(mDisplay, mParent), 0U);
}

} // namespace
