// Construction and destruction of a VST 3 filter: exact orders, names, and plug-ins that do not come up.

#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/PluginLocator.h"
#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

using namespace fakeplugin;
using testing::ElementsAre;
using zebaudiofilterhost::ChannelFlags;
using zebaudiofilterhost::PresetData;
using zebaudiofilterhost::PropList;
using zebaudiofilterhost::UTF16String;

namespace
{

UTF16String Padded(UTF16String text)
{
    text.resize(64, u'\0');
    return text;
}

} // namespace

TEST(FilterLifecycle, ConstructionCallsInOrder)
{
    FakePlugin plugin;
    plugin.hasView = true;
    plugin.hasVendorEffect = true;
    plugin.state = "abc";
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->IsInitialized());
    EXPECT_THAT(plugin.CallsTo("c"),
                ElementsAre("component.initialize", "controller.initialize", "controller.setComponentHandler",
                            "component.connect", "controller.connect", "component.getState",
                            "controller.setComponentState abc", "component.activateBus in 0 1",
                            "component.activateBus out 0 1", "controller.createView editor"));
    EXPECT_EQ(plugin.Calls().back(), "view.setFrame");
}

TEST(FilterLifecycle, DestructionCallsInOrder)
{
    FakePlugin plugin;
    plugin.hasView = true;
    plugin.hasVendorEffect = true;
    plugin.hasUnits = true;
    plugin.parameters = {{7}};
    auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    filter.reset();
    EXPECT_THAT(plugin.Calls(),
                ElementsAre("view.setFrame null", "view destroyed", "component.disconnect", "controller.disconnect",
                            "controller.setComponentHandler null", "controller.terminate", "controller destroyed",
                            "component.terminate", "component destroyed", "factory destroyed"));
    EXPECT_EQ(plugin.livingObjects, 0);
}

TEST(FilterLifecycle, PluginThatThrowsWhileItIsMadeIsTakenDown)
{
    FakePlugin plugin;
    plugin.countingParameters = []
    {
        throw std::runtime_error("no parameters");
    };
    EXPECT_THROW(plugin.MakeFilter(), std::runtime_error);
    EXPECT_EQ(plugin.CallsTo("controller.setComponentHandler"),
              (std::vector<std::string>{"controller.setComponentHandler", "controller.setComponentHandler null"}));
    EXPECT_EQ(plugin.CallsTo("controller.terminate").size(), 1U);
    EXPECT_EQ(plugin.CallsTo("component.terminate").size(), 1U);
    EXPECT_EQ(plugin.livingObjects, 0);
}

TEST(FilterLifecycle, RestartOfAPluginThatGoesTouchesNothing)
{
    FakePlugin plugin;
    auto filter = plugin.MakeFilter();
    int asked = 0;
    int answers = 0;
    plugin.ClearCalls();
    plugin.countingParameters = [&]
    {
        ++asked;
    };
    plugin.called = [&, host = filter.get()](const std::string& call)
    {
        if (call == "controller.setComponentHandler null" || call == "component.terminate")
        {
            EXPECT_EQ(host->restartComponent(kParamTitlesChanged | kLatencyChanged), kResultOk);
            ++answers;
        }
    };
    filter.reset();
    EXPECT_EQ(answers, 2);
    EXPECT_EQ(asked, 0);
    EXPECT_TRUE(plugin.CallsTo("processor.getLatencySamples").empty());
}

TEST(FilterLifecycle, SingleComponentIsTerminatedOnce)
{
    FakePlugin plugin;
    plugin.controllerKind = ControllerKind::kSame;
    auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->IsInitialized());
    EXPECT_EQ(plugin.CallsTo("controller.initialize").size(), 0U);
    EXPECT_THAT(plugin.CallsTo("component.connect"), ElementsAre("component.connect"));
    plugin.ClearCalls();
    filter.reset();
    EXPECT_THAT(plugin.Calls(), ElementsAre("component.disconnect", "controller.disconnect",
                                            "controller.setComponentHandler null", "component.terminate",
                                            "controller destroyed", "component destroyed", "factory destroyed"));
}

TEST(FilterLifecycle, ComponentWithoutControllerWorks)
{
    FakePlugin plugin;
    plugin.controllerKind = ControllerKind::kNone;
    plugin.parameters = {{7}};
    plugin.latency = 33;
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->IsInitialized());
    EXPECT_EQ(filter->GetParameterCount(), 0);
    EXPECT_EQ(filter->GetInitialDelay(), 33);
    EXPECT_EQ(plugin.CallsTo("component.connect").size(), 0U);
    EXPECT_FALSE(filter->HasCustomEditor());
    EXPECT_FALSE(filter->CreateCustomEditor());
    EXPECT_EQ(filter->GetInputBuses().size(), 1U);
}

TEST(FilterLifecycle, FailingStateOfTheComponentIsNotPassedOn)
{
    FakePlugin plugin;
    plugin.getStateResult = kResultFalse;
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->IsInitialized());
    EXPECT_EQ(plugin.CallsTo("controller.setComponentState").size(), 0U);
}

struct BrokenPlugin
{
    const char* name;
    void (*breakIt)(FakePlugin&);
};

class BrokenFilter : public testing::TestWithParam<BrokenPlugin>
{
};

// Whatever is called on a filter that did not come up: no crash, no processing, no buses.
TEST_P(BrokenFilter, EveryOperationIsSafe)
{
    FakePlugin plugin;
    plugin.hasView = true;
    plugin.parameters = {{7}};
    plugin.eventInputs = 1;
    GetParam().breakIt(plugin);
    auto filter = plugin.MakeFilter();
    EXPECT_FALSE(filter->IsInitialized());
    plugin.ClearCalls();

    filter->SetSampleRate(44100.0F);
    filter->SetBlockSize(64);
    filter->SetCurrentOffset(10);
    filter->Resume();
    float left[4] = {};
    float* channels[] = {left, left};
    ChannelFlags silent;
    filter->Process(channels, channels, 4, ChannelFlags(), silent);
    EXPECT_EQ(silent.Value(), ~0ULL);
    filter->Suspend();
    filter->FlushMessageQueue();
    filter->OnUITimerTick();
    EXPECT_EQ(filter->GetTail(), 0U);
    filter->GetInitialDelay();
    filter->GetMaxProcessingBlockSize();
    filter->SetParameter(0, 0.5F);
    filter->FlushMessageQueue();
    filter->GetParameter(0);
    filter->GetParameterInfo(0);
    filter->GetParameterString(0);
    filter->GetParameterCount();
    EXPECT_EQ(filter->GetNumFactoryPresets(), 0);
    EXPECT_TRUE(filter->GetFactoryPresetName(0).empty());
    filter->SetFactoryPreset(0);
    PropList list;
    PresetData preset(list);
    filter->SaveChunkData(preset);
    filter->LoadChunkData(preset);
    const auto mono = zebmediatypes::CreateMonoChannelLayout();
    filter->RequestIOConfiguration({mono}, {mono});
    filter->HasCustomEditor();
    filter->CreateCustomEditor();
    EXPECT_FALSE(filter->CreateFilterDescriptor(zebaudiofilterhost::PluginLocator(), false));
    filter->beginEdit(7);
    filter->performEdit(7, 0.5);
    filter->endEdit(7);
    filter->restartComponent(kParamValuesChanged | kLatencyChanged);
    EXPECT_TRUE(filter->GetInputBuses().empty());
    EXPECT_TRUE(filter->GetOutputBuses().empty());
    EXPECT_EQ(plugin.CallsTo("processor.process").size(), 0U);
    EXPECT_EQ(plugin.CallsTo("processor.set").size(), 0U);
    EXPECT_EQ(plugin.CallsTo("component.setActive").size(), 0U);
    filter.reset();
    EXPECT_EQ(plugin.livingObjects, 0);
}

INSTANTIATE_TEST_SUITE_P(All, BrokenFilter,
                         testing::Values(BrokenPlugin{"NoComponent",
                                                      [](FakePlugin& plugin)
                                                      {
                                                          plugin.createsComponent = false;
                                                      }},
                                         BrokenPlugin{"InitializeFails",
                                                      [](FakePlugin& plugin)
                                                      {
                                                          plugin.initializeResult = kResultFalse;
                                                      }},
                                         BrokenPlugin{"NoProcessor",
                                                      [](FakePlugin& plugin)
                                                      {
                                                          plugin.hasProcessor = false;
                                                      }},
                                         BrokenPlugin{"ControllerFails",
                                                      [](FakePlugin& plugin)
                                                      {
                                                          plugin.controllerInitializeResult = kInternalError;
                                                      }}),
                         [](const auto& test) { return test.param.name; });

TEST(FilterLifecycle, BrokenComponentIsTerminatedAllTheSame)
{
    FakePlugin plugin;
    plugin.initializeResult = kResultFalse;
    auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    filter.reset();
    EXPECT_THAT(plugin.Calls(), ElementsAre("component.terminate", "component destroyed", "factory destroyed"));
}

TEST(FilterLifecycle, FailingControllerStaysConnected)
{
    FakePlugin plugin;
    plugin.controllerInitializeResult = kInternalError;
    plugin.hasView = true;
    auto filter = plugin.MakeFilter();
    EXPECT_THAT(plugin.CallsTo("controller"),
                ElementsAre("controller.initialize", "controller.setComponentHandler", "controller.connect",
                            "controller.setComponentState ", "controller.createView editor"));
    plugin.ClearCalls();
    filter.reset();
    EXPECT_THAT(plugin.CallsTo("controller"),
                ElementsAre("controller.disconnect", "controller.setComponentHandler null", "controller.terminate",
                            "controller destroyed"));
}

TEST(FilterLifecycle, NameComesFromTheBestFactory)
{
    struct Case
    {
        FactoryLevel level;
        UTF16String name;
        UTF16String vendor;
    };
    for (const Case& expected : {Case{FactoryLevel::kOne, u"Class One", u"Factory Vendor"},
                                 Case{FactoryLevel::kTwo, u"Class Two", u"Vendor Two"},
                                 Case{FactoryLevel::kThree, Padded(u"Class Three"), Padded(u"Vendor Three")}})
    {
        FakePlugin plugin;
        plugin.level = expected.level;
        const auto filter = plugin.MakeFilter();
        EXPECT_TRUE(filter->GetDisplayName() == expected.name) << static_cast<int>(expected.level);
        const auto descriptor = filter->CreateFilterDescriptor(zebaudiofilterhost::PluginLocator(), true);
        EXPECT_TRUE(descriptor->GetVendorString() == expected.vendor) << static_cast<int>(expected.level);
        EXPECT_EQ(plugin.CallsTo("factory.setHostContext").size(), 0U);
        EXPECT_EQ(plugin.CallsTo("factory.getClassInfo2").size(), expected.level == FactoryLevel::kTwo ? 1U : 0U);
    }
}

TEST(FilterLifecycle, NameFallsBackOnTheGivenClassInfo)
{
    FakePlugin silent;
    silent.factoryInfoResult = kResultFalse;
    silent.level = FactoryLevel::kThree;
    EXPECT_TRUE(silent.MakeFilter()->GetDisplayName() == u"Class One");

    FakePlugin nameless;
    nameless.classInfo2.name[0] = '\0';
    nameless.classInfo2.vendor[0] = '\0';
    const auto filter = nameless.MakeFilter();
    EXPECT_TRUE(filter->GetDisplayName() == u"Class One");
    const auto descriptor = filter->CreateFilterDescriptor(zebaudiofilterhost::PluginLocator(), true);
    EXPECT_TRUE(descriptor->GetVendorString() == u"Factory Vendor");
}

TEST(FilterLifecycle, UnterminatedTextsEndWithTheirArrays)
{
    FakePlugin plugin;
    std::fill(std::begin(plugin.classInfo2.name), std::end(plugin.classInfo2.name), 'n');
    std::fill(std::begin(plugin.classInfo2.vendor), std::end(plugin.classInfo2.vendor), 'v');
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(filter->GetDisplayName() == UTF16String(64, u'n'));
}

TEST(FilterLifecycle, ClassIsFoundBehindFailingIndicesAndLyingCounts)
{
    FakePlugin plugin;
    plugin.classCount = 3; // only the last can be read
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == u"Class Two");
    plugin.classCount = 2147483647;
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == u"Class Two");
    plugin.classCount = -5;
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == u"Class One");
}

TEST(FilterLifecycle, VendorNameOverridesEveryOther)
{
    FakePlugin plugin;
    plugin.level = FactoryLevel::kThree;
    plugin.vendorName = "Gr\xc3\xbc\xc3\x9f";
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == u"Grüß");
    plugin.vendorNameLength = 0;
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == Padded(u"Class Three"));
    plugin.vendorNameLength = 2147483647;
    EXPECT_TRUE(plugin.MakeFilter()->GetDisplayName() == Padded(u"Class Three"));
}

TEST(FilterLifecycle, FilterIDIsThatOfTheClass)
{
    FakePlugin plugin;
    EXPECT_TRUE(plugin.MakeFilter()->GetID() == u"3:01020304 5 ff00 a");
}

TEST(FilterLifecycle, DestructionTracesItsSteps)
{
    FakePlugin plugin;
    plugin.hasVendorEffect = true;
    auto filter = plugin.MakeFilter();
    std::string lines;
    zebcore::debug::SetTraceSink([&](std::string_view line) { lines += line.substr(line.find("> <6> ") + 6); });
    zebcore::debug::SetTraceCategoryEnabled("~VST3AudioFilter", true);
    filter.reset();
    zebcore::debug::SetTraceCategoryEnabled("~VST3AudioFilter", false);
    zebcore::debug::SetTraceSink({});
    EXPECT_EQ(lines,
              "entry\nreleasing vendor specific controller\ndisconnecting processor/controller\n"
              "releasing controller\nreleasing audio processor\nreleasing component\nreleasing factory\nexit\n");
}

TEST(FilterLifecycle, ResumeAndSuspendCallInOrder)
{
    FakePlugin plugin;
    plugin.inputs.push_back({SpeakerArr::kMono, u"Key", kAux});
    const auto filter = plugin.MakeFilter();
    filter->SetSampleRate(48000.0F);
    filter->SetBlockSize(256);
    plugin.ClearCalls();
    filter->Resume();
    EXPECT_THAT(plugin.Calls(), ElementsAre("processor.setupProcessing 0 0 256 48000", "component.setActive 1",
                                            "processor.getLatencySamples"));
    plugin.ClearCalls();
    filter->Suspend();
    EXPECT_THAT(plugin.Calls(), ElementsAre("component.setActive 0"));

    using Bus = zebaudiofilterhost::AudioFilterBusDescription;
    filter->SetSideChainTargetBus(Bus::CreateMono(u"", Bus::kBusType_SideChain));
    filter->SetRenderingContext(zebaudiofilterhost::kRenderingContext_Offline);
    plugin.ClearCalls();
    filter->Resume();
    EXPECT_THAT(plugin.Calls(), ElementsAre("processor.setupProcessing 2 0 256 48000", "component.setActive 1",
                                            "component.activateBus in 1 1", "processor.getLatencySamples"));
    filter->Suspend();
}

TEST(FilterLifecycle, LatencyIsAskedWhileSuspendedOnly)
{
    FakePlugin plugin;
    plugin.latency = 10;
    const auto filter = plugin.MakeFilter();
    plugin.latency = 20;
    EXPECT_EQ(filter->GetInitialDelay(), 20);
    filter->Resume();
    plugin.latency = 30;
    EXPECT_EQ(filter->GetInitialDelay(), 20);
    EXPECT_EQ(filter->restartComponent(kLatencyChanged), kResultOk);
    EXPECT_EQ(filter->GetInitialDelay(), 30);
    filter->Suspend();
    plugin.tail = 0xffffffffU;
    EXPECT_EQ(filter->GetTail(), 0xffffffffU);
}
