// Plug-ins that report parameters to their host from the very call in which it sets one.

#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

#include <stdexcept>
#include <thread>

using namespace fakeeffect;
using testing::ElementsAre;

namespace
{

using Change = std::pair<int, float>;

class Automation : public FilterTest
{
protected:
    void SetUp() override
    {
        fake.effect.numParams = kParameters;
        Make();
        filter->ConnectAutomatedParameterChange([this](int index, float value) { told.emplace_back(index, value); });
        fake.ClearCalls();
    }

    // Keeps a host that goes round in circles from using the stack up: the plug-in falls silent.
    void Report(FakeEffect& plugin, int index, float value)
    {
        if (++reports <= kMostReports)
            plugin.CallHost(audioMasterAutomate, index, 0, nullptr, value);
    }

    static std::vector<Change> SetIn(const FakeEffect& plugin)
    {
        std::vector<Change> changes;
        for (const Call& call : plugin.CallsTo("setParameter"))
            changes.emplace_back(call.index, call.opt);
        return changes;
    }
    std::vector<Change> Set() const { return SetIn(fake); }

    static constexpr int kParameters = 3;
    static constexpr int kMostReports = 8;
    std::vector<Change> told; // what the application hears
    int reports = 0;
};

} // namespace

TEST_F(Automation, OfTheParameterThatIsBeingSetIsOnlyPassedOn)
{
    fake.onSet = [this](int index, float value)
    {
        Report(fake, index, value);
    };
    filter->SetParameter(0, 0.25F);
    EXPECT_THAT(Set(), ElementsAre(Change(0, 0.25F)));
    EXPECT_THAT(told, ElementsAre(Change(0, 0.25F)));
    EXPECT_EQ(filter->GetParameterDirtyCount(), 2U);
    EXPECT_EQ(reports, 1);
}

TEST_F(Automation, MayCorrectTheValueThatIsBeingSet)
{
    fake.onSet = [this](int index, float)
    {
        fake.parameters[0] = 0.5F;
        Report(fake, index, 0.5F);
    };
    filter->SetParameter(0, 0.4F);
    EXPECT_EQ(filter->GetParameter(0), 0.5F);
    EXPECT_THAT(told, ElementsAre(Change(0, 0.5F)));
}

TEST_F(Automation, OfCoupledParametersEnds)
{
    fake.onSet = [this](int index, float value)
    {
        Report(fake, (index + 1) % kParameters, value);
    };
    filter->SetParameter(1, 0.25F);
    EXPECT_THAT(Set(), ElementsAre(Change(1, 0.25F), Change(2, 0.25F), Change(0, 0.25F)));
    EXPECT_THAT(told, ElementsAre(Change(1, 0.25F), Change(0, 0.25F), Change(2, 0.25F)));
    EXPECT_EQ(filter->GetParameterDirtyCount(), 4U);
}

// What the view of a plug-in does that reports everything: the report sets, and setting reports.
TEST_F(Automation, FromOutsideOfACallReachesThePlugInOnce)
{
    fake.onSet = [this](int index, float value)
    {
        Report(fake, index, value);
    };
    for (const float value : {0.25F, 0.75F})
    {
        fake.ClearCalls();
        told.clear();
        fake.CallHost(audioMasterAutomate, 2, 0, nullptr, value);
        EXPECT_THAT(Set(), ElementsAre(Change(2, value)));
        EXPECT_THAT(told, ElementsAre(Change(2, value), Change(2, value)));
    }
}

TEST_F(Automation, OfAnotherPlugInSetsItAndEndsAtTheFirst)
{
    FakeEffect other;
    other.effect.numParams = 1;
    const auto otherFilter = MakeFilter(other);
    fake.onSet = [&](int, float value)
    {
        Report(other, 0, value);
    };
    other.onSet = [&](int, float value)
    {
        Report(fake, 0, value);
    };
    filter->SetParameter(0, 0.25F);
    EXPECT_THAT(Set(), ElementsAre(Change(0, 0.25F)));
    EXPECT_THAT(SetIn(other), ElementsAre(Change(0, 0.25F)));
}

TEST_F(Automation, FromAnotherThreadSetsInTheMiddleOfACall)
{
    fake.onSet = [this](int index, float)
    {
        if (++reports == 1)
            std::thread([&] { fake.CallHost(audioMasterAutomate, index, 0, nullptr, 0.75F); }).join();
    };
    filter->SetParameter(0, 0.25F);
    EXPECT_THAT(Set(), ElementsAre(Change(0, 0.25F), Change(0, 0.75F)));
}

TEST_F(Automation, SetsAgainAfterAPlugInThatThrew)
{
    fake.onSet = [](int, float)
    {
        throw std::runtime_error("set");
    };
    EXPECT_THROW(filter->SetParameter(0, 0.25F), std::runtime_error);
    fake.onSet = {};
    fake.ClearCalls();
    fake.CallHost(audioMasterAutomate, 0, 0, nullptr, 0.75F);
    EXPECT_THAT(Set(), ElementsAre(Change(0, 0.75F)));
}

// Whoever hears of a report may set what it likes, the parameter that is being set too.
TEST_F(Automation, AListenerSetsWhatItLikes)
{
    filter->ConnectAutomatedParameterChange(
        [this](int index, float value)
        {
            if (value != 1.0F)
                filter->SetParameter(index, 1.0F);
        });
    fake.onSet = [this](int index, float value)
    {
        if (value != 1.0F)
            Report(fake, index, value);
    };
    filter->SetParameter(0, 0.25F);
    EXPECT_THAT(Set(), ElementsAre(Change(0, 0.25F), Change(0, 1.0F)));
}
