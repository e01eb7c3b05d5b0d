// The editor of ZebPanel2 in a window of an X server.
#include "tests/plugins/ChildWindow.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/vst2/direct/DirectVST2.h"

#include <chrono>
#include <gtest/gtest.h>
#include <thread>

namespace
{

using namespace zebtest;
using namespace zebaudiofilterhost::vst;

constexpr unsigned long kKnobColour = 0xf2a93b;

class ZebPanel2InAWindow : public testing::Test
{
protected:
    void SetUp() override
    {
        mDisplay = XOpenDisplay(nullptr);
        if (mDisplay == nullptr)
            GTEST_SKIP() << "no X server";
        const ERect rect = Rect();
        ASSERT_EQ(rect.right - rect.left, 360);
        ASSERT_EQ(rect.bottom - rect.top, 140);
        mParent = XCreateSimpleWindow(mDisplay, DefaultRootWindow(mDisplay), 0, 0, 640, 240, 0, 0, 0);
        XMapWindow(mDisplay, mParent);
        XSync(mDisplay, False);
        // A window ID travels as a pointer.
        ASSERT_EQ(mPlugin.Call(effEditOpen, 0, 0, reinterpret_cast<void*>(mParent)), 1);
        mChild = FindChildWindow(mDisplay, mParent);
        ASSERT_NE(mChild, 0U);
        ASSERT_TRUE(IdleUntil([&] { return PixelAt(180, 70) == kKnobColour; }));
    }

    void TearDown() override
    {
        if (mDisplay == nullptr)
            return;
        mPlugin.Call(effEditClose); // before the parent goes
        XCloseDisplay(mDisplay);
    }

    ERect Rect()
    {
        ERect* rect = nullptr;
        mPlugin.Call(effEditGetRect, 0, 0, &rect);
        return rect != nullptr ? *rect : ERect{};
    }

    unsigned long PixelAt(int x, int y) { return WindowPixelAt(mDisplay, mChild, x, y); }

    // Idles at the pace of a host.
    template <class Done>
    bool IdleUntil(Done done)
    {
        const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
        while (!done() && std::chrono::steady_clock::now() < end)
        {
            mPlugin.Call(effEditIdle);
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        return done();
    }

    void SendMouse(int type, int x, int y) { SendMouseTo(mDisplay, mChild, type, x, y); }

    DirectVST2 mPlugin{VST2Effect("ZebPanel2")};
    Display* mDisplay = nullptr;
    Window mParent = 0;
    Window mChild = 0;
};

TEST_F(ZebPanel2InAWindow, DragsItsSliderBetweenBeginAndEnd)
{
    SendMouse(ButtonPress, 260, 70); // 20 + 0.75 * 320
    SendMouse(MotionNotify, 340, 70);
    SendMouse(ButtonRelease, 340, 70);
    ASSERT_TRUE(IdleUntil([&] { return !mPlugin.told.empty() && mPlugin.told.back() == "end 0"; }));
    EXPECT_EQ(mPlugin.told, (std::vector<std::string>{"begin 0", "automate 0", "automate 0", "automate 0", "end 0"}));
    EXPECT_EQ(mPlugin.lastValue, 1.0F);
    EXPECT_EQ(mPlugin.effect->getParameter(mPlugin.effect, 0), 1.0F);
    EXPECT_TRUE(IdleUntil([&] { return PixelAt(340, 70) == kKnobColour; }));
}

TEST_F(ZebPanel2InAWindow, FollowsAValueThatTheHostSets)
{
    mPlugin.effect->setParameter(mPlugin.effect, 0, 0.0F);
    EXPECT_TRUE(IdleUntil([&] { return PixelAt(20, 70) == kKnobColour; }));
    EXPECT_NE(PixelAt(180, 70), kKnobColour);
}

TEST_F(ZebPanel2InAWindow, SwitchesItsSizeWhenTheHostAgrees)
{
    mPlugin.canResize = false;
    SendMouse(ButtonPress, 355, 135);
    ASSERT_TRUE(IdleUntil([&] { return mPlugin.told.size() == 1; }));
    EXPECT_EQ(mPlugin.told.back(), "size 540 210");
    EXPECT_EQ(Rect().right, 360);
    mPlugin.canResize = true;
    SendMouse(ButtonPress, 355, 135);
    ASSERT_TRUE(IdleUntil([&] { return mPlugin.told.size() == 2; }));
    EXPECT_EQ(Rect().right, 540);
    EXPECT_EQ(Rect().bottom, 210);
    XWindowAttributes attributes{};
    XGetWindowAttributes(mDisplay, mChild, &attributes);
    EXPECT_EQ(attributes.width, 540);
    EXPECT_EQ(attributes.height, 210);
}

TEST_F(ZebPanel2InAWindow, EndsAGestureThatClosingCutsShort)
{
    SendMouse(ButtonPress, 180, 70);
    ASSERT_TRUE(IdleUntil([&] { return mPlugin.told.size() == 2; }));
    mPlugin.Call(effEditClose);
    EXPECT_EQ(mPlugin.told.back(), "end 0");
    EXPECT_EQ(FindChildWindow(mDisplay, mParent), 0U);
    mPlugin.Call(effEditIdle);
}

} // namespace
