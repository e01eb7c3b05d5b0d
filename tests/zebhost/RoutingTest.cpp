#include "render/Routing.h"

#include "cli/Failure.h"

#include <audiofilter/AudioFilter.h>
#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gmock/gmock.h>

namespace zebhost
{

namespace
{

using testing::ElementsAre;
using zebaudiofilterhost::AudioFilterBusDescription;
using zebmediatypes::AudioChannelLabel;
using zebmediatypes::ChannelLayout;

// One bus a side, whatever is asked for.
class OneBusFilter : public zebaudiofilterhost::AudioFilter
{
public:
    OneBusFilter(std::size_t inputs, std::size_t outputs, bool sideChain)
        : AudioFilter(u"id", u"name"), mSideChain(sideChain)
    {
        AddInputBus({u"In", ChannelLayout(inputs), AudioFilterBusDescription::kBusType_Main});
        AddOutputBus({u"Out", ChannelLayout(outputs), AudioFilterBusDescription::kBusType_Main});
    }
    bool CanUseSideChaining() const override { return mSideChain; }

private:
    bool mSideChain;
};

// The slot of the row that feeds each input of the plug-in, -1 for none.
std::vector<int> Feeds(const Routing& routing, int inputs)
{
    std::vector<int> slots(static_cast<std::size_t>(inputs), -1);
    for (int slot = 0; slot < routing.inputMap.GetNumberOfChannels(); ++slot)
    {
        for (const auto& channel : routing.inputMap.GetChannelLayout(slot))
        {
            int& place = slots.at(channel.GetLabel());
            EXPECT_EQ(place, -1) << "fed twice";
            place = slot;
        }
    }
    return slots;
}

Routing Route(OneBusFilter& filter, std::size_t file, std::size_t sideChain)
{
    RoutingRequest request;
    request.file = ChannelLayout(file);
    request.sideChain = ChannelLayout(sideChain);
    return RouteFilter(filter, request);
}

} // namespace

TEST(RoutingTest, SideChainOfASingleBusLiesBehindItsMainInputs)
{
    struct Case
    {
        std::size_t file;
        std::size_t inputs;
        std::size_t outputs;
        std::vector<int> feeds;
    };
    for (const Case& each :
         {Case{2, 4, 2, {0, 1, 4, 5}}, Case{2, 3, 2, {0, 1, 3}}, Case{1, 2, 1, {0, 2}}, Case{4, 4, 2, {0, 1, 4, 5}}})
    {
        const boost::intrusive_ptr<OneBusFilter> filter(new OneBusFilter(each.inputs, each.outputs, true));
        const Routing routing = Route(*filter, each.file, 1);
        EXPECT_EQ(Feeds(routing, static_cast<int>(each.inputs)), each.feeds) << each.inputs << " " << each.file;
        EXPECT_EQ(routing.sideChannels, static_cast<int>(each.inputs - each.outputs));
    }
}

TEST(RoutingTest, SideChainNeedsAPluginThatHasOne)
{
    const boost::intrusive_ptr<OneBusFilter> none(new OneBusFilter(4, 2, false));
    EXPECT_THROW(Route(*none, 2, 1), Failure);
    const boost::intrusive_ptr<OneBusFilter> narrow(new OneBusFilter(2, 2, true));
    EXPECT_THROW(Route(*narrow, 2, 1), Failure);
    EXPECT_THAT(Feeds(Route(*none, 2, 0), 4), ElementsAre(0, 1, -1, -1));
}

} // namespace zebhost
