// What the example effects promise, called without our library in between.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/direct/DirectPlugin.h"

#include <cmath>
#include <gtest/gtest.h>

namespace
{

using namespace zebtest;
using Vst::SpeakerArr::k51;
using Vst::SpeakerArr::kMono;
using Vst::SpeakerArr::kStereo;

Channels Constant(std::size_t channels, std::size_t length, float value)
{
    return Channels(channels, std::vector<float>(length, value));
}

Channels Impulse(std::size_t channels, std::size_t length)
{
    Channels result = Constant(channels, length, 0.0F);
    for (auto& channel : result)
        channel.front() = 1.0F;
    return result;
}

TEST(ZebGain, PassesEveryBitAtItsDefaultAndFollowsPointsToTheSample)
{
    DirectPlugin gain(EffectBundle("ZebGain"));
    gain.Activate(48000.0, 64);
    EXPECT_EQ(gain.Process(Constant(2, 64, 0.3F)), Constant(2, 64, 0.3F));

    const double minusSix = gain.Value(0, u"-6 dB");
    const Channels out = gain.Process(Constant(2, 64, 1.0F), {{0, 10, 0.0}, {0, 20, minusSix}});
    EXPECT_EQ(out[0][9], 1.0F);
    EXPECT_EQ(out[1][10], 0.0F);
    EXPECT_EQ(out[0][19], 0.0F);
    EXPECT_NEAR(out[0][20], std::pow(10.0, -6.0 / 20.0), 1e-6);
    EXPECT_NEAR(out[1][63], std::pow(10.0, -6.0 / 20.0), 1e-6);
}

TEST(ZebGain, ReadsTheTextThatItWrites)
{
    DirectPlugin gain(EffectBundle("ZebGain"));
    for (const char16_t* text : {u"-inf", u"-71.0", u"-6.0", u"0.0", u"12.5", u"24.0"})
        EXPECT_TRUE(gain.Text(0, gain.Value(0, text)) == text) << gain.Value(0, text);
    EXPECT_EQ(gain.Value(0, u"loud"), -1.0);
    EXPECT_TRUE(gain.Text(1, gain.Value(1, u"On")) == u"On");
}

TEST(ZebGain, TakesMonoStereoAndFiveOneAndTellsItsControllerSo)
{
    DirectPlugin gain(EffectBundle("ZebGain"));
    EXPECT_FALSE(gain.Arrange({kStereo}, {kMono}));
    EXPECT_FALSE(gain.Arrange({0xff}, {0xff}));
    for (const auto& [arrangement, text] : {std::pair{kMono, u"1"}, std::pair{kStereo, u"2"}, std::pair{k51, u"6"}})
    {
        ASSERT_TRUE(gain.Arrange({arrangement}, {arrangement}));
        gain.Activate(48000.0, 64);
        EXPECT_TRUE(gain.Text(2, gain.controller->getParamNormalized(2)) == text);
        gain.Deactivate();
    }
}

TEST(ZebGain, MarksSilenceThatItGetsAndThatItMakes)
{
    DirectPlugin gain(EffectBundle("ZebGain"));
    gain.Activate(48000.0, 64);
    gain.Process(Constant(2, 64, 0.0F), {}, 2);
    EXPECT_EQ(gain.outputSilence, 2U);
    gain.Process(Constant(2, 64, 1.0F), {{0, 1, 0.0}});
    EXPECT_EQ(gain.outputSilence, 0U); // the first sample still sounds
    gain.Process(Constant(2, 64, 1.0F));
    EXPECT_EQ(gain.outputSilence, 3U);
}

TEST(ZebGain, KeepsItsStateAndRefusesADamagedOne)
{
    DirectPlugin gain(EffectBundle("ZebGain"));
    gain.Process({}, {{0, 0, 0.5}}); // a flush
    const std::string state = gain.State();
    gain.Process({}, {{0, 0, 0.25}});
    ASSERT_NE(gain.State(), state);
    EXPECT_EQ(gain.SetState(state), kResultOk);
    EXPECT_EQ(gain.State(), state);

    std::string lie = state;
    lie.replace(0, 4, "\xff\xff\xff\xff");
    for (const std::string& damaged : {std::string(), state.substr(0, state.size() - 1), lie})
        EXPECT_EQ(gain.SetState(damaged), kResultFalse);
    EXPECT_EQ(gain.State(), state);
}

TEST(ZebDelay, DelaysByTheLatencyThatItReports)
{
    DirectPlugin delay(EffectBundle("ZebDelay"));
    ASSERT_EQ(delay.processor->getLatencySamples(), 128U);
    delay.Activate(48000.0, 512);
    const Channels out = delay.Process(Impulse(2, 512), {{2, 0, 0.0}});
    for (std::size_t i = 0; i < 512; ++i)
        ASSERT_EQ(out[1][i], i == 128 ? 1.0F : 0.0F) << i;
}

TEST(ZebDelay, AnnouncesANewLatencyAndObeysItFromTheNextActivation)
{
    DirectPlugin delay(EffectBundle("ZebDelay"));
    delay.Activate(48000.0, 512);
    delay.controller->setParamNormalized(3, delay.Value(3, u"200"));
    EXPECT_EQ(delay.host->told, std::vector<std::string>{"restart 8"});
    EXPECT_EQ(delay.processor->getLatencySamples(), 200U);
    EXPECT_EQ(delay.Process(Impulse(2, 512), {{2, 0, 0.0}})[0][128], 1.0F);
    delay.Deactivate();
    delay.Activate(48000.0, 512);
    EXPECT_EQ(delay.Process(Impulse(2, 512))[0][200], 1.0F);
}

TEST(ZebDelay, RepeatsUntilTheEndOfItsTail)
{
    DirectPlugin delay(EffectBundle("ZebDelay"));
    const auto milliseconds = [&](const char16_t* text)
    {
        return delay.Value(0, text);
    };
    delay.Activate(1000.0, 4096); // a sample is a millisecond
    const Channels out = delay.Process(Impulse(2, 4096), {{0, 0, milliseconds(u"100")}, {2, 0, 1.0}});
    EXPECT_EQ(out[0][128], 0.0F);
    EXPECT_NEAR(out[0][228], 1.0, 1e-6);
    EXPECT_NEAR(out[0][328], 0.3, 1e-6);
    const std::size_t tail = delay.processor->getTailSamples();
    ASSERT_LT(tail, 2000U);
    for (std::size_t i = tail + 1; i < 4096; ++i)
        ASSERT_LT(std::abs(out[0][i]), 0.001F) << i;
}

TEST(ZebCompressor, ListensToTheSideChainOnlyWhenItIsActive)
{
    for (const bool active : {false, true})
    {
        DirectPlugin compressor(EffectBundle("ZebCompressor"));
        compressor.component->activateBus(kAudio, kInput, 1, active ? 1 : 0);
        compressor.Activate(48000.0, 4800);
        Channels in = Constant(4, 4800, 0.01F); // main: -40 dB
        in[2] = in[3] = std::vector<float>(4800, 1.0F);
        const Channels out = compressor.Process(in);
        if (active)
            EXPECT_NEAR(out[0].back(), 0.01 * std::pow(10.0, -15.0 / 20.0), 1e-4); // 20 dB over, 4 : 1
        else
            EXPECT_EQ(out[0].back(), 0.01F);
        EXPECT_EQ(compressor.outputPoints.empty(), !active);
    }
}

TEST(ZebCompressor, WritesItsReductionOnceWhileItStays)
{
    DirectPlugin compressor(EffectBundle("ZebCompressor"));
    compressor.Activate(48000.0, 48000);
    compressor.Process(Constant(4, 48000, 1.0F));
    ASSERT_EQ(compressor.outputPoints.size(), 1U);
    EXPECT_EQ(compressor.outputPoints[0].id, 5U);
    EXPECT_NEAR(compressor.outputPoints[0].value, 0.25, 0.001); // 15 of 60 dB
    compressor.Process(Constant(4, 480, 0.0F));
    EXPECT_EQ(compressor.outputPoints.size(), 1U);
}

TEST(ZebTrio, HasTwoEffectsAndAnInstrumentInOneBundle)
{
    IPluginFactory* factory = OpenBundle(EffectBundle("ZebTrio"));
    ASSERT_EQ(factory->countClasses(), 3);
    const FUnknownPtr<IPluginFactory3> unicode(factory);
    ASSERT_NE(unicode, nullptr);
    PClassInfoW info;
    ASSERT_EQ(unicode->getClassInfoUnicode(2, &info), kResultOk);
    EXPECT_TRUE(std::u16string(info.name) == u"Zeb Tone");
    EXPECT_STREQ(info.subCategories, "Instrument|Synth");
    EXPECT_EQ(unicode->getClassInfoUnicode(3, &info), kInvalidArgument);
}

TEST(ZebTrio, ChangesProgramsByItsParameter)
{
    DirectPlugin tremolo(EffectBundle("ZebTrio"), "Zeb Tremolo");
    const FUnknownPtr<IUnitInfo> units(tremolo.controller);
    ASSERT_NE(units, nullptr);
    String128 name{};
    EXPECT_EQ(units->getProgramName(1, 4, name), kResultOk);
    EXPECT_TRUE(std::u16string(name) == u"Chopper");
    EXPECT_NE(units->getProgramName(1, 5, name), kResultOk);

    tremolo.controller->setParamNormalized(2, 4 / 4.0);
    EXPECT_TRUE(tremolo.Text(0, tremolo.controller->getParamNormalized(0)) == u"8.0");
    EXPECT_TRUE(tremolo.Text(1, tremolo.controller->getParamNormalized(1)) == u"100.0");
    tremolo.Process({}, {{2, 0, 1 / 4.0}});
    EXPECT_TRUE(tremolo.Text(1, tremolo.controller->getParamNormalized(1)) == u"60.0");
}

TEST(ZebTrio, TiltLeavesTheSoundAloneInTheMiddle)
{
    DirectPlugin tilt(EffectBundle("ZebTrio"), "Zeb Tilt");
    tilt.Activate(48000.0, 64);
    const Channels same = tilt.Process(Impulse(2, 64));
    for (std::size_t i = 0; i < 64; ++i)
        EXPECT_NEAR(same[1][i], i == 0 ? 1.0 : 0.0, 1e-6);
    const Channels steady = tilt.Process(Constant(2, 4800, 1.0F), {{0, 0, 1.0}});
    EXPECT_NEAR(steady[0].back(), std::pow(10.0, -12.0 / 20.0), 0.001); // the lowest low is lowered in full
}

TEST(ZebView, BalancesAndReportsTheLevel)
{
    DirectPlugin balance(EffectBundle("ZebView"));
    balance.Activate(48000.0, 64);
    const Channels out = balance.Process(Constant(2, 64, 0.5F), {{0, 0, 1.0}});
    EXPECT_EQ(out[0][0], 0.0F);
    EXPECT_EQ(out[1][0], 0.5F);
    ASSERT_EQ(balance.outputPoints.size(), 1U);
    EXPECT_EQ(balance.outputPoints[0].value, 0.5);
}

TEST(ZebView, AttachesToNothingWithoutARunLoop)
{
    DirectPlugin balance(EffectBundle("ZebView"));
    const IPtr<IPlugView> view(balance.controller->createView("editor"), false);
    ASSERT_NE(view, nullptr);
    EXPECT_NE(view->isPlatformTypeSupported("NSView"), kResultOk);
    EXPECT_NE(view->attached(nullptr, "X11EmbedWindowID"), kResultOk);
    EXPECT_NE(view->removed(), kResultOk);
    EXPECT_EQ(balance.controller->createView("other"), nullptr);
}

} // namespace
