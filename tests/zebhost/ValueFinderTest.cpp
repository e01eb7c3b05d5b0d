#include "filter/ValueFinder.h"
#include "cli/Failure.h"
#include "filter/Quantity.h"

#include <audiofilter/AudioFilter.h>
#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gmock/gmock.h>

#include <cmath>
#include <functional>
#include <limits>

namespace zebhost
{

namespace
{

using TextFunction = std::function<std::string(double normalised)>;

// A parameter that displays what the test says.
class TestParameter : public zebaudiofilterhost::AudioFilterParameterInfo
{
public:
    TestParameter(TextFunction text, const std::u16string& unit, int steps = 0, double bottom = 0, double top = 0)
        : AudioFilterParameterInfo(u"Test", unit, {})
        , mText(std::move(text))
        , mSteps(steps)
        , mBottom(bottom)
        , mTop(top)
    {
    }

    // Useless unless the test gives a range, as with plug-ins that do not tell.
    float ToNormalized(float value) const override
    {
        return mTop == mBottom ? value
                               : static_cast<float>((static_cast<double>(value) - mBottom) / (mTop - mBottom));
    }
    float FromNormalized(float normalised) const override { return normalised; }
    int GetStepCount() const override { return mSteps; }
    zebaudiofilterhost::UTF16String GetParameterString(float normalised) const override
    {
        const std::string text = mText(static_cast<double>(normalised));
        return {text.begin(), text.end()};
    }

private:
    TextFunction mText;
    int mSteps;
    double mBottom;
    double mTop;
};

std::string Decimal(double value, int decimals)
{
    std::string text(64, '\0');
    const int length = std::snprintf(text.data(), text.size(), "%.*f", decimals, value);
    text.resize(static_cast<std::size_t>(length));
    return text;
}

float Find(const boost::intrusive_ptr<TestParameter>& parameter, const std::string& text)
{
    return ValueFinder(*parameter).Find(text).value;
}

boost::intrusive_ptr<TestParameter> Make(const TextFunction& text, const std::u16string& unit = u"", int steps = 0,
                                         double bottom = 0, double top = 0)
{
    return new TestParameter(text, unit, steps, bottom, top);
}

TEST(QuantityTest, ReadsNumbersWithTheirUnits)
{
    struct Case
    {
        const char* text;
        const char* defaultUnit;
        double value;
        double resolution;
    };
    const double infinity = std::numeric_limits<double>::infinity();
    for (const Case& each : {Case{"-6.00 dB", "", -6, 0.005}, Case{"1.2 kHz", "Hz", 1200, 50},
                             Case{"440", "Hz", 440, 0.5}, Case{"+3", "", 3, 0.5}, Case{"-inf dB", "", -infinity, 0.5},
                             Case{"20", "ms", 0.02, 0.0005}, Case{" 50 % ", "", 50, 0.5},
                             Case{"\xE2\x88\x92"
                                  "3.5",
                                  "", -3.5, 0.05},
                             Case{"1,5 s", "", 1.5, 0.05}, Case{"\xE2\x88\x9E", "", infinity, 0.5}})
    {
        const std::optional<Quantity> quantity = ParseQuantity(each.text, each.defaultUnit);
        ASSERT_TRUE(quantity) << each.text;
        EXPECT_DOUBLE_EQ(quantity->value, each.value) << each.text;
        EXPECT_NEAR(quantity->resolution, each.resolution, 1e-12) << each.text;
    }
    for (const char* text : {"", "dB", "Off", "-", "x3"})
    {
        EXPECT_FALSE(ParseQuantity(text, "")) << text;
    }
}

TEST(ValueFinderTest, TakesThePluginsOwnConversionWhenItFits)
{
    const auto gain = Make([](double value) { return Decimal(-72 + 96 * value, 1); }, u"dB", 0, -72, 24);
    EXPECT_EQ(Find(gain, "0"), 0.75F);
    EXPECT_EQ(Find(gain, "-6.03 dB"), static_cast<float>((-6.03F + 72.0) / 96.0));
}

TEST(ValueFinderTest, SearchesAlongTheDisplayWhenTheConversionIsUseless)
{
    const auto frequency = Make(
        [](double value)
        {
            const double hertz = 20 * std::pow(1000, value);
            return hertz < 1000 ? Decimal(hertz, 0) + " Hz" : Decimal(hertz / 1000, 2) + " kHz";
        });
    for (const auto& [text, hertz] : std::initializer_list<std::pair<const char*, double>>{
             {"440 Hz", 440}, {"2.5 kHz", 2500}, {"2500 Hz", 2500}, {"20 Hz", 20}, {"20 kHz", 20000}})
    {
        EXPECT_NEAR(20 * std::pow(1000, static_cast<double>(Find(frequency, text))), hertz, hertz * 0.002) << text;
    }
}

TEST(ValueFinderTest, FindsFallingRangesAndWordsAtTheEnds)
{
    const auto falling = Make([](double value) { return value >= 1 ? "Off" : Decimal(100 - 100 * value, 1); }, u"%");
    EXPECT_NEAR(Find(falling, "25"), 0.75F, 0.0006F);
    EXPECT_EQ(Find(falling, "off"), 1.0F);
    const auto level =
        Make([](double value) { return value <= 0 ? "-inf" : Decimal(20 * std::log10(value), 1); }, u"dB");
    EXPECT_EQ(Find(level, "-inf"), 0.0F);
    EXPECT_NEAR(Find(level, "-6 dB"), 0.501F, 0.003F);
    EXPECT_EQ(Find(level, "0"), 1.0F);
}

TEST(ValueFinderTest, TellsWhenOnlyTheNearestCanBeHad)
{
    const auto coarse = Make([](double value) { return Decimal(std::round(value * 10) * 10, 0); });
    const ValueFinder::Found found = ValueFinder(*coarse).Find("33");
    EXPECT_FALSE(found.exact);
    EXPECT_TRUE(found.shown == "30" || found.shown == "40") << found.shown;
}

TEST(ValueFinderTest, StepsAreFoundByTextNumberOrBeginning)
{
    const std::vector<std::string> texts = {"Off", "1/8", "1/4", "12 dB", "Slow"};
    const auto steps =
        Make([&texts](double value) { return texts[static_cast<std::size_t>(std::lround(value * 4))]; }, u"", 4);
    EXPECT_EQ(Find(steps, "off"), 0.0F);
    EXPECT_EQ(Find(steps, "1/4"), 0.5F);
    EXPECT_EQ(Find(steps, "12"), 0.75F);
    EXPECT_EQ(Find(steps, "sl"), 1.0F);
    EXPECT_THROW(Find(steps, "fast"), Failure);
    EXPECT_THROW(Find(steps, ""), Failure);
}

TEST(ValueFinderTest, SaysSoWhenItCannot)
{
    const auto wave = Make([](double value) { return Decimal(std::sin(value * 6.28), 2); });
    const auto word = Make([](double) { return std::string("yes"); });
    const auto range = Make([](double value) { return Decimal(value * 10, 1); }, u"", 0, 0, 10);
    const auto liar = Make([](double value) { return Decimal(value, 2); }, u"", 2147483647);
    EXPECT_THROW(Find(wave, "7"), Failure);
    EXPECT_THROW(Find(word, "3"), Failure);
    EXPECT_THROW(Find(word, "no"), Failure);
    EXPECT_THROW(Find(range, "10.2"), Failure);
    EXPECT_NEAR(Find(liar, "0.5"), 0.5F, 0.01F);
}

// A filter of one parameter, whose plug-in only displays its current value.
class CurrentTextFilter : public zebaudiofilterhost::AudioFilter
{
public:
    class Info : public TestParameter
    {
    public:
        Info(CurrentTextFilter& filter, int steps, float range, const std::u16string& unit = u"")
            : TestParameter({}, unit, steps), mFilter(filter), mRange(range)
        {
        }
        bool SupportsStringForArbitraryValues() const override { return false; }
        float FromNormalized(float normalised) const override { return normalised * mRange; }
        zebaudiofilterhost::UTF16String GetParameterString(float) const override
        {
            const std::string text = mFilter.text(static_cast<double>(mFilter.value));
            return {text.begin(), text.end()};
        }

    private:
        CurrentTextFilter& mFilter;
        float mRange;
    };

    explicit CurrentTextFilter(TextFunction display, int steps = 0, float range = 1)
        : AudioFilter(u"id", u"name"), text(std::move(display)), info(new Info(*this, steps, range))
    {
    }

    void SetParameter(int, float newValue) override
    {
        value = newValue;
        ++changes;
    }
    float GetParameter(int) const override { return value; }

    ValueFinder::Found Find(const std::string& wanted) { return ValueFinder(*this, 0, *info).Find(wanted); }

    TextFunction text;
    boost::intrusive_ptr<Info> info;
    float value = 0.125F;
    int changes = 0;
};

TEST(ValueFinderTest, PluginThatOnlyKnowsItsCurrentTextIsSetAndSetBack)
{
    const auto display = [](double value)
    {
        return value == 0 ? "off" : Decimal(value * 60 - 60, 2) + " dB";
    };
    const boost::intrusive_ptr<CurrentTextFilter> filter(new CurrentTextFilter(display));
    EXPECT_NEAR(filter->Find("-6 dB").value, 0.9F, 1e-4F);
    EXPECT_EQ(filter->value, 0.125F);
    EXPECT_EQ(filter->Find("off").value, 0.0F);
    EXPECT_THROW(filter->Find("10 dB"), Failure);
    EXPECT_EQ(filter->value, 0.125F) << "also behind a failure";

    filter->changes = 0;
    EXPECT_EQ(ValueFinder(*filter, 0, *filter->info).Shown(0.125F), "-52.50 dB");
    EXPECT_EQ(filter->changes, 0) << "the current text is there to be read";
    filter->text = [](double)
    {
        return std::string();
    };
    EXPECT_EQ(ValueFinder(*filter, 0, *filter->info).Text(0.5F), "0.5") << "the number where there is no text";
}

TEST(ValueFinderTest, WidthOfAStepGivesTheNumberOfSteps)
{
    struct Case
    {
        int told;
        float range;
        int steps;
    };
    for (const Case& each : {Case{0, 10, 0}, Case{1, 1, 1}, Case{1, 10, 10}, Case{5, 10, 2}, Case{1, -10, 10},
                             Case{4, 1, 4}, Case{1, 1e9F, 0}, Case{-1, 10, 0}})
    {
        const auto display = [&each](double value)
        {
            return Decimal(value * static_cast<double>(each.range), 0);
        };
        const boost::intrusive_ptr<CurrentTextFilter> filter(new CurrentTextFilter(display, each.told, each.range));
        EXPECT_EQ(ValueFinder(*filter, 0, *filter->info).StepCount(), each.steps) << each.told << " " << each.range;
    }
    const boost::intrusive_ptr<CurrentTextFilter> tens(
        new CurrentTextFilter([](double value) { return Decimal(value * 10, 0); }, 1, 10));
    EXPECT_NEAR(tens->Find("7").value, 0.7F, 1e-6F);
    EXPECT_THROW(tens->Find("11"), Failure);
}

TEST(ValueFinderTest, LabelThatIsNoUnitIsALongName)
{
    struct Case
    {
        const char16_t* label;
        const char* shown;
        const char* longName;
    };
    for (const Case& each : {Case{u"dB", "1 dB", ""}, Case{u"Input gain", "1", "Input gain"}, Case{u"test", "1", ""}})
    {
        const boost::intrusive_ptr<CurrentTextFilter> filter(
            new CurrentTextFilter([](double) { return std::string("1"); }));
        filter->info = new CurrentTextFilter::Info(*filter, 0, 1, each.label);
        const ValueFinder finder(*filter, 0, *filter->info);
        EXPECT_EQ(finder.Shown(0), each.shown);
        EXPECT_EQ(finder.LongName(), each.longName);
    }
    EXPECT_EQ(ValueFinder(*Make([](double) { return std::string("1"); }, u"semitones")).Shown(0), "1 semitones");
}

} // namespace

} // namespace zebhost
