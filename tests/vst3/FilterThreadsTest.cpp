// A VST 3 filter whose plug-in calls its host from threads of its own while audio runs.

#include "tests/vst3/FakePlugin.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>

using namespace fakeplugin;
using zebaudiofilterhost::ChannelFlags;

namespace
{

void RunBlocks(zebaudiofilterhost::AudioFilter& filter, int count)
{
    std::array<float, 64> samples = {};
    std::array<float*, 2> channels = {samples.data(), samples.data()};
    for (int block = 0; block < count; ++block)
    {
        ChannelFlags flags;
        filter.ProcessWithMapping(channels.data(), channels.data(), 64, ChannelFlags(), flags);
    }
}

} // namespace

TEST(FilterThreads, RestartsAndEditsWhileAudioRuns)
{
    constexpr int kBlocks = 3000;
    FakePlugin plugin;
    for (ParamID id = 0; id < 20; ++id)
        plugin.parameters.push_back({id});
    const auto filter = plugin.MakeFilter();
    filter->SetBlockSize(64);
    filter->Resume();
    plugin.recording = false;
    std::atomic<bool> running = true;

    std::thread process(
        [&]
        {
            RunBlocks(*filter, kBlocks);
            running = false;
        });
    std::thread restarter(
        [&]
        {
            while (running)
                filter->restartComponent(kParamValuesChanged | kLatencyChanged);
        });
    std::thread editor(
        [&]
        {
            for (ParamID id = 0; running; id = (id + 1) % 25)
            {
                filter->beginEdit(id);
                filter->performEdit(id, 0.5);
                filter->endEdit(id);
            }
        });
    // The main thread reads, posts and ticks meanwhile.
    for (int round = 0; running; ++round)
    {
        const auto info = filter->GetParameterInfo(round % 22);
        EXPECT_EQ(info == nullptr, round % 22 >= 20);
        EXPECT_TRUE(!info || info->FromNormalized(1.0F) == 10.0F);
        filter->PostSetParameter(round % 20, 0.25F);
        filter->GetInitialDelay();
        filter->OnUITimerTick();
    }
    process.join();
    restarter.join();
    editor.join();
    filter->Suspend();
    while (filter->GetRefCount() > 1) // queued messages keep it alive
        filter->FlushMessageQueue();
    EXPECT_EQ(filter->GetParameterCount(), 20);
}

TEST(FilterThreads, APluginThatGoesIsNotAskedWhatItsOwnThreadTells)
{
    for (int round = 0; round < 100; ++round)
    {
        FakePlugin plugin;
        plugin.parameters = {{1}, {2}, {3}};
        std::atomic<bool> running = true;
        std::atomic<bool> isAsked = false;
        auto filter = plugin.MakeFilter();
        plugin.countingParameters = [&]
        {
            isAsked = true;
            std::this_thread::yield();
            isAsked = false;
        };
        std::thread teller;
        plugin.called = [&](const std::string& call)
        {
            EXPECT_FALSE(call.starts_with("controller.setComponentHandler") && isAsked);
            if (call == "component.terminate") // where such plug-ins end their threads
            {
                running = false;
                teller.join();
            }
        };
        teller = std::thread(
            [&, host = filter.get()]
            {
                while (running)
                    host->restartComponent(kParamTitlesChanged | kLatencyChanged);
            });
        filter.reset();
        EXPECT_FALSE(teller.joinable());
    }
}

TEST(FilterThreads, RestartFromInsideProcess)
{
    FakePlugin plugin;
    plugin.parameters = {{1}, {2}};
    const auto filter = plugin.MakeFilter();
    filter->SetBlockSize(64);
    filter->Resume();
    plugin.recording = false;
    plugin.process = [&](ProcessData&)
    {
        plugin.handler->restartComponent(kParamTitlesChanged | kLatencyChanged);
        plugin.handler->performEdit(2, 0.5);
        return kResultOk;
    };
    std::atomic<bool> running = true;
    std::thread process(
        [&]
        {
            RunBlocks(*filter, 500);
            running = false;
        });
    while (running)
    {
        filter->GetParameterCount();
        filter->OnUITimerTick();
    }
    process.join();
    filter->Suspend();
    EXPECT_EQ(filter->GetParameterCount(), 2);
}
