// The event loop that plug-ins get on Linux, on a clock of the test's own.

#include "foundation/zebcore/MainThreadLoop.h"
#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <functional>
#include <thread>
#include <unistd.h>

using namespace fakeplugin;
using Steinberg::Linux::IEventHandler;
using Steinberg::Linux::IRunLoop;
using Steinberg::Linux::ITimerHandler;
using testing::ElementsAre;
using zebaudiofilterhost::vst3::PluginPtr;

namespace
{

// Counts its references from 1, the test's; does not die of them.
template <class Interface>
class Handler : public Interface
{
public:
    tresult PLUGIN_API queryInterface(const TUID, void** obj) override
    {
        *obj = nullptr;
        return kNoInterface;
    }
    uint32 PLUGIN_API addRef() override { return ++references; }
    uint32 PLUGIN_API release() override { return --references; }

    uint32 references = 1;
    int calls = 0;
    std::function<void()> action;

protected:
    void Called()
    {
        ++calls;
        if (action)
            action();
    }
};

class EventHandler final : public Handler<IEventHandler>
{
public:
    void PLUGIN_API onFDIsSet(Linux::FileDescriptor fd) override
    {
        descriptors.push_back(fd);
        Called();
    }

    std::vector<int> descriptors;
};

class TimerHandler final : public Handler<ITimerHandler>
{
public:
    void PLUGIN_API onTimer() override { Called(); }
};

class Pipe
{
public:
    Pipe()
    {
        if (pipe(mEnds.data()) != 0)
            ADD_FAILURE() << "no pipe";
    }
    ~Pipe()
    {
        HangUp();
        close(mEnds[0]);
    }
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;

    int ReadEnd() const { return mEnds[0]; }
    void Fill() { EXPECT_EQ(write(mEnds[1], "x", 1), 1); }
    void HangUp()
    {
        if (mEnds[1] >= 0)
            close(mEnds[1]);
        mEnds[1] = -1;
    }

private:
    std::array<int, 2> mEnds = {-1, -1};
};

class RunLoopOfHost : public testing::Test
{
protected:
    RunLoopOfHost()
    {
        zebcore::threads::SetMainThreadClock([this] { return mNanos; });
        plugin.hasView = true;
        plugin.viewTypes = {kPlatformTypeX11EmbedWindowID};
        filter = plugin.MakeFilter();
        ofContext = PluginPtr<IRunLoop>::Query(plugin.hostContext);
        ofFrame = PluginPtr<IRunLoop>::Query(plugin.frame);
    }
    ~RunLoopOfHost() override { zebcore::threads::SetMainThreadClock({}); }

    void Pass(unsigned int milliseconds)
    {
        for (unsigned int passed = 0; passed < milliseconds; ++passed)
        {
            mNanos += 1000000;
            zebcore::threads::PumpMainThread();
        }
    }

    FakePlugin plugin;
    boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> filter;
    PluginPtr<IRunLoop> ofContext;
    PluginPtr<IRunLoop> ofFrame;

private:
    unsigned long long mNanos = 1;
};

} // namespace

TEST_F(RunLoopOfHost, IsThereForContextAndFrame)
{
    EXPECT_TRUE(ofContext);
    EXPECT_TRUE(ofFrame);
    EXPECT_NE(ofContext.Get(), ofFrame.Get());
    void* object = nullptr;
    EXPECT_EQ(ofContext->queryInterface(FUnknown::iid, &object), kResultOk);
    static_cast<FUnknown*>(object)->release();
}

TEST_F(RunLoopOfHost, TimersRepeatUntilUnregistered)
{
    TimerHandler handler;
    EXPECT_EQ(ofContext->registerTimer(&handler, 10), kResultOk);
    EXPECT_EQ(handler.references, 2U);
    Pass(9);
    EXPECT_EQ(handler.calls, 0);
    Pass(21);
    EXPECT_EQ(handler.calls, 3);
    EXPECT_EQ(ofContext->unregisterTimer(&handler), kResultOk);
    EXPECT_EQ(ofContext->unregisterTimer(&handler), kResultFalse);
    EXPECT_EQ(handler.references, 1U);
    Pass(30);
    EXPECT_EQ(handler.calls, 3);
}

TEST_F(RunLoopOfHost, SeveralHandlersShareADescriptor)
{
    Pipe pipe;
    EventHandler first;
    EventHandler second;
    EXPECT_EQ(ofContext->registerEventHandler(&first, pipe.ReadEnd()), kResultOk);
    EXPECT_EQ(ofFrame->registerEventHandler(&second, pipe.ReadEnd()), kResultOk);
    EXPECT_EQ(ofContext->registerEventHandler(&first, pipe.ReadEnd()), kResultOk);
    Pass(1);
    EXPECT_EQ(first.calls + second.calls, 0);
    pipe.Fill();
    Pass(1);
    EXPECT_THAT(first.descriptors, ElementsAre(pipe.ReadEnd(), pipe.ReadEnd()));
    EXPECT_THAT(second.descriptors, ElementsAre(pipe.ReadEnd()));
    EXPECT_EQ(ofContext->unregisterEventHandler(&first), kResultOk);
    EXPECT_EQ(first.references, 1U);
    Pass(1);
    EXPECT_EQ(first.calls, 2);
    EXPECT_EQ(second.calls, 2);
    EXPECT_EQ(ofFrame->unregisterEventHandler(&second), kResultOk);
}

TEST_F(RunLoopOfHost, HangUpWakesAHandler)
{
    Pipe pipe;
    EventHandler handler;
    ofContext->registerEventHandler(&handler, pipe.ReadEnd());
    pipe.HangUp();
    Pass(1);
    EXPECT_EQ(handler.calls, 1);
    ofContext->unregisterEventHandler(&handler);
}

TEST_F(RunLoopOfHost, UnregisteringInsideACallTakesEffectAtOnce)
{
    Pipe pipe;
    EventHandler first;
    EventHandler second;
    first.action = [&]
    {
        EXPECT_GE(first.references, 2U); // alive to the end of its own call
        ofContext->unregisterEventHandler(&first);
        ofContext->unregisterEventHandler(&second);
        EXPECT_GE(first.references, 2U);
    };
    ofContext->registerEventHandler(&first, pipe.ReadEnd());
    ofContext->registerEventHandler(&second, pipe.ReadEnd());
    pipe.Fill();
    Pass(3);
    EXPECT_EQ(first.calls, 1);
    EXPECT_EQ(second.calls, 0);
    EXPECT_EQ(first.references, 1U);
    EXPECT_EQ(second.references, 1U);

    TimerHandler timer;
    timer.action = [&]
    {
        ofContext->unregisterTimer(&timer);
    };
    ofContext->registerTimer(&timer, 1);
    ofContext->registerTimer(&timer, 1);
    Pass(5);
    EXPECT_EQ(timer.calls, 1);
    EXPECT_EQ(timer.references, 1U);
}

TEST_F(RunLoopOfHost, WhatAHandlerThrowsGoesNoFurther)
{
    TimerHandler handler;
    handler.action = []
    {
        throw 1;
    };
    ofContext->registerTimer(&handler, 1);
    EXPECT_NO_THROW(Pass(2));
    EXPECT_EQ(handler.calls, 2);
    ofContext->unregisterTimer(&handler);
}

TEST_F(RunLoopOfHost, NonsenseIsRefused)
{
    EventHandler handler;
    EXPECT_EQ(ofContext->registerEventHandler(nullptr, 0), kInvalidArgument);
    EXPECT_EQ(ofContext->registerEventHandler(&handler, -1), kInvalidArgument);
    EXPECT_EQ(ofContext->registerTimer(nullptr, 1), kInvalidArgument);
    EXPECT_EQ(ofContext->unregisterTimer(nullptr), kInvalidArgument);
    EXPECT_EQ(ofContext->unregisterEventHandler(&handler), kResultFalse);
    EXPECT_EQ(handler.references, 1U);
}

TEST_F(RunLoopOfHost, ForeignThreadsAreRefused)
{
    Pipe pipe;
    EventHandler event;
    TimerHandler timer;
    TimerHandler stranger;
    ASSERT_EQ(ofContext->registerEventHandler(&event, pipe.ReadEnd()), kResultOk);
    ASSERT_EQ(ofContext->registerTimer(&timer, 1), kResultOk);
    std::thread(
        [&]
        {
            for (IRunLoop* const loop : {ofContext.Get(), ofFrame.Get()})
            {
                EXPECT_EQ(loop->registerEventHandler(&event, pipe.ReadEnd()), kResultFalse);
                EXPECT_EQ(loop->registerTimer(&stranger, 1), kResultFalse);
                EXPECT_EQ(loop->unregisterEventHandler(&event), kResultFalse);
                EXPECT_EQ(loop->unregisterTimer(&timer), kResultFalse);
                EXPECT_EQ(loop->registerTimer(nullptr, 1), kInvalidArgument);
            }
        })
        .join();
    EXPECT_EQ(event.references, 2U);
    EXPECT_EQ(stranger.references, 1U);
    pipe.Fill();
    Pass(1);
    EXPECT_EQ(event.calls, 1);
    EXPECT_EQ(timer.calls, 1) << "what was registered before goes on";
    EXPECT_EQ(stranger.calls, 0);
    EXPECT_EQ(ofContext->unregisterEventHandler(&event), kResultOk);
    EXPECT_EQ(ofContext->unregisterTimer(&timer), kResultOk);
}

TEST_F(RunLoopOfHost, ClosedViewKeepsOnlyWhatItHadBefore)
{
    TimerHandler early;
    TimerHandler late;
    ofFrame->registerTimer(&early, 1);
    const auto editor = filter->CreateCustomEditor();
    editor->Open(nullptr);
    ofFrame->registerTimer(&late, 1);
    Pass(1);
    editor->Close();
    EXPECT_EQ(late.references, 1U);
    Pass(1);
    EXPECT_EQ(late.calls, 1);
    EXPECT_EQ(early.calls, 2);
    ofFrame->unregisterTimer(&early);
}

TEST_F(RunLoopOfHost, DeadOwnersForgetTheirRegistrations)
{
    TimerHandler ofFilter;
    TimerHandler ofEditor;
    ofContext->registerTimer(&ofFilter, 1);
    ofFrame->registerTimer(&ofEditor, 1);
    filter.reset();
    EXPECT_EQ(ofFilter.references, 1U);
    EXPECT_EQ(ofEditor.references, 1U);
    Pass(2);
    EXPECT_EQ(ofFilter.calls + ofEditor.calls, 0);
    // The plug-in may still hold the loop: it takes nothing any more.
    EXPECT_EQ(ofContext->registerTimer(&ofFilter, 1), kResultFalse);
    EXPECT_EQ(ofFilter.references, 1U);
}
