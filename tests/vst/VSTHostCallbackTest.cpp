// What a plug-in gets from its host, by the layer that answers.

#include "foundation/zebcore/Trace.h"
#include "host/PluginModule.h"
#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

#include <array>
#include <cstring>

using namespace fakeeffect;
using testing::ElementsAre;
using testing::HasSubstr;
using zebaudiofilterhost::PluginModule;

namespace
{

long long Ask(int opcode, int index = 0, void* ptr = nullptr, AEffect* effect = nullptr)
{
    return VSTAudioFilter::StaticAudioMasterCallback(effect, opcode, index, 0, ptr, 0.0F);
}

long long AskCanDo(std::string text)
{
    return Ask(audioMasterCanDo, 0, text.data());
}

using HostCallback = FilterTest;

} // namespace

TEST_F(HostCallback, AnswersWithoutAnInstance)
{
    const std::pair<int, long long> rows[] = {
        {audioMasterAutomate, 0},
        {audioMasterVersion, 2400},
        {audioMasterPinConnected, 0},
        {audioMasterGetTime, 0},
        {audioMasterIOChanged, 0},
        {audioMasterGetSampleRate, 0},
        {audioMasterGetBlockSize, 0},
        {audioMasterGetVendorVersion, 4},
        {audioMasterSetIcon, 0},
        {audioMasterGetLanguage, 1},
        {audioMasterUpdateDisplay, 0},
        {-1, 0},
        {1000000, 0},
    };
    AEffect unknown = {};
    for (const auto& [opcode, answer] : rows)
    {
        EXPECT_EQ(Ask(opcode), answer) << opcode;
        EXPECT_EQ(Ask(opcode, 0, nullptr, &unknown), answer) << opcode;
    }
}

TEST_F(HostCallback, NamesTheHost)
{
    const std::pair<int, std::string> rows[] = {{audioMasterGetVendorString, "Corvane Systems"},
                                                {audioMasterGetProductString, "Opal"}};
    for (const auto& [opcode, text] : rows)
    {
        std::string buffer(64, 'x');
        EXPECT_EQ(Ask(opcode, 0, buffer.data()), 1);
        EXPECT_EQ(buffer, text + '\0' + std::string(63 - text.size(), 'x'));
        EXPECT_EQ(Ask(opcode), 0);
    }
}

TEST_F(HostCallback, TellsTheMemberOfAShell)
{
    for (const int id : {7, 0x7fffffff, static_cast<int>(0xfedcba98U), 0})
    {
        VSTAudioFilter::SetCurrentFilterID(id);
        EXPECT_EQ(static_cast<std::int32_t>(Ask(audioMasterCurrentId)), id);
        EXPECT_EQ(VSTAudioFilter::GetCurrentFilterID(), id);
    }
}

TEST_F(HostCallback, AffirmsTwoAbilities)
{
    const std::pair<const char*, long long> rows[] = {
        {"shellCategory", 1}, {"SHELLCATEGORY", 1},    {"sendVstTimeInfo", 1},  {"SendVSTTimeInfo", 1},
        {"sizeWindow", 0},    {"shellCategory ", 0},   {"shellCategor", 0},     {"", 0},
        {"sendVstEvents", 0}, {"sendVstMidiEvent", 0}, {"startStopProcess", 0},
    };
    for (const auto& [text, answer] : rows)
        EXPECT_EQ(AskCanDo(text), answer) << text;
    EXPECT_EQ(Ask(audioMasterCanDo), 0);
}

TEST_F(HostCallback, TracesWhatIsAskedOfIt)
{
    constexpr const char* kCategory = "VSTAudioFilter::StaticAudioMasterCallback";
    std::string trace;
    zebcore::debug::SetTraceSink([&trace](std::string_view line) { trace += line; });
    zebcore::debug::SetTraceCategoryEnabled(kCategory, true);
    AskCanDo("juggle");
    Ask(audioMasterCanDo);
    zebcore::debug::SetTraceCategoryEnabled(kCategory, false);
    zebcore::debug::SetTraceSink({});
    EXPECT_THAT(trace, HasSubstr("audioMasterCanDo->juggle\n"));
    EXPECT_THAT(trace, HasSubstr("audioMasterCanDo->\n"));
}

TEST_F(HostCallback, TellsTheLanguage)
{
    constexpr int kLanguage = 0x70400000;
    const std::pair<const char16_t*, long long> rows[] = {
        {u"de_DE", 1}, {u"fr_FR", 2}, {u"ja_JP", 3}, {u"es_ES", 4}, {u"it_IT", 5}, {u"ko_KR", 6},
        {u"zh_CN", 7}, {u"zh_TW", 0}, {u"de", 0},    {u"DE_DE", 0}, {u"", 0},      {u"en_US", 0},
    };
    for (const auto& [locale, code] : rows)
    {
        PluginModule::SetLocaleIdentifier(locale);
        // At an odd address, and with something behind it.
        std::array<char, 10> memory = {};
        memory.fill('x');
        EXPECT_EQ(Ask(audioMasterVendorSpecific, kLanguage, memory.data() + 1), 0x11005678);
        long long told = -1;
        std::memcpy(&told, memory.data() + 1, sizeof(told));
        EXPECT_EQ(told, code) << testing::PrintToString(locale);
        EXPECT_EQ(memory.back(), 'x');
    }
    EXPECT_EQ(Ask(audioMasterVendorSpecific, kLanguage), 0);
}

TEST_F(HostCallback, KnowsItsOwnSelectorsAlone)
{
    long long memory = 42;
    EXPECT_EQ(Ask(audioMasterVendorSpecific, 0x2e903f43, &memory), 0x11005678);
    EXPECT_EQ(Ask(audioMasterVendorSpecific, 0x2e903f43), 0x11005678);
    for (const int index : {0, 1, 0x70400001, 0x70400003, -1})
        EXPECT_EQ(Ask(audioMasterVendorSpecific, index, &memory), 0);
    EXPECT_EQ(memory, 42);
}

TEST_F(HostCallback, ReachesTheFilterUnderConstruction)
{
    fake.effect.numParams = 1;
    fake.parameters = {0.0F};
    std::vector<long long> answers;
    for (const auto opcode : {effOpen, effSetBlockSize, effGetParamName})
        fake.On(opcode,
                [&](int, long long, void*, float)
                {
                    answers.push_back(fake.CallHost(audioMasterGetTime));
                    answers.push_back(fake.CallHost(audioMasterPinConnected, 0, 0));
                    answers.push_back(fake.CallHost(audioMasterVersion));
                    fake.CallHost(audioMasterAutomate, 0, 0, nullptr, 0.5F);
                    return 0LL;
                });
    Make();
    EXPECT_THAT(answers, ElementsAre(0, 1, 2400, 0, 1, 2400, 0, 1, 2400));
    EXPECT_EQ(filter->GetParameterDirtyCount(), 3U);
    EXPECT_EQ(fake.parameters[0], 0.5F);
    EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 0, 0), 0);
}

TEST_F(HostCallback, DoesNotReachTheFilterWhileItCloses)
{
    MakeRunning();
    ASSERT_NE(fake.CallHost(audioMasterGetTime), 0);
    filter->AddAudioMasterHandler(this, [](int, int, long long, void*, float) { return 5LL; });
    ASSERT_EQ(fake.CallHost(audioMasterPinConnected, 9, 0), 5);
    std::vector<long long> answers;
    fake.On(effClose,
            [&](int, long long, void*, float)
            {
                answers = {fake.CallHost(audioMasterGetTime), fake.CallHost(audioMasterPinConnected, 9, 0),
                           fake.CallHost(audioMasterVersion)};
                fake.CallHost(audioMasterAutomate, 0, 0, nullptr, 0.5F);
                return 0LL;
            });
    filter.reset();
    EXPECT_THAT(answers, ElementsAre(0, 0, 2400));
    EXPECT_EQ(fake.CallHost(audioMasterGetTime), 0);
    EXPECT_EQ(fake.Count("setParameter"), 0U);
}

TEST_F(HostCallback, EachPlugInReachesItsOwnFilter)
{
    FakeEffect other;
    other.effect.numInputs = 1;
    fake.effect.numInputs = 6;
    MakeRunning();
    auto otherFilter = MakeFilter(other);
    EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 5, 0), 0);
    EXPECT_EQ(other.CallHost(audioMasterPinConnected, 1, 0), 1);
    EXPECT_NE(fake.CallHost(audioMasterGetTime), 0);
    EXPECT_EQ(other.CallHost(audioMasterGetTime), 0);
    otherFilter.reset();
    EXPECT_NE(fake.CallHost(audioMasterGetTime), 0);
}

TEST_F(HostCallback, TheFirstFilterOfAPlugInKeepsItsCalls)
{
    MakeRunning();
    const auto second = MakeFilter(fake);
    EXPECT_NE(fake.CallHost(audioMasterGetTime), 0);
}

// The plug-in hears of its own change again, ahead of the application.
TEST_F(HostCallback, AutomationReachesThePlugInAndTheApplication)
{
    fake.effect.numParams = 2;
    fake.parameters = {0.0F, 0.0F};
    Make();
    std::vector<std::pair<int, float>> told;
    filter->ConnectAutomatedParameterChange(
        [&](int index, float value)
        {
            EXPECT_EQ(fake.parameters[1], value);
            told.emplace_back(index, value);
        });
    EXPECT_EQ(fake.CallHost(audioMasterAutomate, 1, 0, nullptr, 0.25F), 0);
    EXPECT_THAT(told, ElementsAre(std::pair(1, 0.25F)));
    EXPECT_EQ(filter->GetParameterDirtyCount(), 1U);
}

TEST_F(HostCallback, PinsCountAsFarAsTheBusesReach)
{
    constexpr int kInput = 0;
    constexpr int kOutput = 1;
    struct
    {
        int index;
        int value;
        long long answer;
    } const stereoToSix[] = {
        {0, kInput, 0},  {1, kInput, 0},  {2, kInput, 1}, {0, kOutput, 0},
        {5, kOutput, 0}, {6, kOutput, 1}, {0, 2, 1},      {0, -1, 1},
    };
    fake.effect.numOutputs = 6;
    Make();
    for (const auto& row : stereoToSix)
        EXPECT_EQ(fake.CallHost(audioMasterPinConnected, row.index, row.value), row.answer)
            << row.index << ", " << row.value;

    fake.effect.numOutputs = 2;
    fake.effect.flags |= effFlagsCanMono;
    filter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 0, kOutput), 0);
    EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 1, kOutput), 1);
    EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 1, kInput), 1);
}
