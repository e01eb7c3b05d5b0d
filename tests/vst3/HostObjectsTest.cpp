#include "host/src/VST3/src/HostMessage.h"
#include "host/src/VST3/src/PluginPtr.h"
#include "host/src/VST3/src/VST3EventList.h"
#include "host/src/VST3/src/VST3VendorInterfaces.h"

#include <pluginterfaces/gui/iplugview.h>
#include <pluginterfaces/gui/iplugviewcontentscalesupport.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <limits>
#include <string>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::int32;
using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::Vst::Event;

PluginPtr<VST3EventList> MakeEvents(int32 size)
{
    return PluginPtr<VST3EventList>::Adopt(new VST3EventList(size));
}

Event EventAt(int32 offset)
{
    Event event = {};
    event.sampleOffset = offset;
    return event;
}

TEST(VST3EventList, IsFullAtItsCapacityAndEmptyAfterClear)
{
    const auto events = MakeEvents(2);
    for (const int32 offset : {10, 11})
    {
        Event event = EventAt(offset);
        EXPECT_EQ(events->addEvent(event), kResultOk);
    }
    Event event = EventAt(12);
    EXPECT_EQ(events->addEvent(event), kResultFalse);
    EXPECT_EQ(events->getEventCount(), 2);
    EXPECT_EQ(events->getEvent(1, event), kResultOk);
    EXPECT_EQ(event.sampleOffset, 11);
    events->Clear();
    EXPECT_EQ(events->getEventCount(), 0);
    EXPECT_EQ(events->getEvent(0, event), kResultFalse);
    EXPECT_EQ(event.sampleOffset, 11) << "nothing was written";
    EXPECT_EQ(events->addEvent(event), kResultOk);
}

TEST(VST3EventList, IndicesOutOfRange)
{
    const auto events = MakeEvents(4);
    for (const int32 offset : {10, 11})
    {
        Event event = EventAt(offset);
        events->addEvent(event);
    }
    Event event = {};
    for (const int32 index : {-1, 2, 4, std::numeric_limits<int32>::min(), std::numeric_limits<int32>::max()})
    {
        EXPECT_EQ(events->getEvent(index, event), kResultFalse) << index;
        EXPECT_EQ(events->GetEventByIndex(index), nullptr) << index;
    }
    EXPECT_EQ(events->GetEventByIndex(1)->sampleOffset, 11);
    events->SetMaxSize(1);
    EXPECT_EQ(events->getEventCount(), 2) << "the count is left alone";
    EXPECT_EQ(events->getEvent(1, event), kResultFalse) << "but the store is smaller";
    EXPECT_EQ(events->addEvent(event), kResultFalse);
}

TEST(HostMessage, KeepsIDAndAttributes)
{
    const auto message = PluginPtr<HostMessage>::Adopt(new HostMessage);
    EXPECT_STREQ(message->getMessageID(), "");
    message->setMessageID("hello");
    EXPECT_STREQ(message->getMessageID(), "hello");
    message->setMessageID(nullptr);
    EXPECT_STREQ(message->getMessageID(), "");
    Steinberg::Vst::IAttributeList* attributes = message->getAttributes();
    ASSERT_NE(attributes, nullptr);
    attributes->setInt("a", 1);
    EXPECT_EQ(message->getAttributes(), attributes);
    EXPECT_EQ(attributes->addRef(), 2U) << "getAttributes adds no reference";
    attributes->release();
}

class HostAttributeListTest : public testing::Test
{
protected:
    PluginPtr<HostAttributeList> mList = PluginPtr<HostAttributeList>::Adopt(new HostAttributeList);
};

TEST_F(HostAttributeListTest, NumbersComeBack)
{
    EXPECT_EQ(mList->setInt("i", std::numeric_limits<Steinberg::int64>::min()), kResultOk);
    EXPECT_EQ(mList->setFloat("f", 1. / 3.), kResultOk);
    Steinberg::int64 integer = 0;
    double number = 0;
    EXPECT_EQ(mList->getInt("i", integer), kResultOk);
    EXPECT_EQ(integer, std::numeric_limits<Steinberg::int64>::min());
    EXPECT_EQ(mList->getFloat("f", number), kResultOk);
    EXPECT_EQ(number, 1. / 3.);
    EXPECT_EQ(mList->getInt("f", integer), kResultOk) << "the kind is not looked at";
    EXPECT_EQ(integer, 0x3fd5555555555555);
}

TEST_F(HostAttributeListTest, KeysAreCaseSensitiveAndReplaced)
{
    mList->setInt("a", 1);
    Steinberg::int64 value = 7;
    EXPECT_EQ(mList->getInt("A", value), kResultFalse);
    EXPECT_EQ(value, 7);
    EXPECT_EQ(mList->setString("a", u"text"), kResultOk);
    EXPECT_EQ(mList->getInt("a", value), kResultOk);
    EXPECT_EQ(value, 0) << "the attribute was replaced as a whole";
}

TEST_F(HostAttributeListTest, GetStringCopiesUnitsWithoutTerminator)
{
    EXPECT_EQ(mList->setString("t", u"0123456789"), kResultOk);
    std::array<char16_t, 12> buffer{};
    buffer.fill(u'#');
    EXPECT_EQ(mList->getString("t", buffer.data(), 4), kResultOk);
    EXPECT_TRUE(std::u16string(buffer.begin(), buffer.end()) == u"0123########");
    EXPECT_EQ(mList->getString("t", buffer.data(), 12), kResultOk);
    EXPECT_TRUE(std::u16string(buffer.begin(), buffer.end()) == u"0123456789##");
    EXPECT_EQ(mList->getString("none", buffer.data(), 12), kResultFalse);
    EXPECT_EQ(mList->getString("t", nullptr, 12), kResultOk);
}

TEST_F(HostAttributeListTest, BinaryComesBackAlthoughItIsReportedAsFailed)
{
    const std::string bytes("a\0b", 3);
    EXPECT_EQ(mList->setBinary("b", bytes.data(), 3), kResultFalse);
    const void* data = nullptr;
    Steinberg::uint32 size = 99;
    EXPECT_EQ(mList->getBinary("b", data, size), kResultOk);
    ASSERT_EQ(size, 3U);
    EXPECT_EQ(std::memcmp(data, bytes.data(), 3), 0);
    EXPECT_EQ(mList->getBinary("none", data, size), kResultFalse);
    EXPECT_EQ(size, 0U);
}

TEST_F(HostAttributeListTest, NullIDsAndDataDoNoHarm)
{
    Steinberg::int64 value = 0;
    EXPECT_EQ(mList->getInt(nullptr, value), kResultFalse);
    EXPECT_EQ(mList->setInt(nullptr, 3), kResultOk);
    EXPECT_EQ(mList->getInt("", value), kResultOk);
    EXPECT_EQ(value, 3);
    EXPECT_EQ(mList->setString("t", nullptr), kResultOk);
    EXPECT_EQ(mList->setBinary("b", nullptr, std::numeric_limits<Steinberg::uint32>::max()), kResultFalse);
    const void* data = nullptr;
    Steinberg::uint32 size = 99;
    EXPECT_EQ(mList->getBinary("b", data, size), kResultOk);
    EXPECT_EQ(size, 0U);
}

TEST(PluginPtr, OwnsOneReference)
{
    auto* raw = new HostMessage;
    {
        const auto owner = PluginPtr<HostMessage>::Adopt(raw);
        auto copy = owner;
        EXPECT_EQ(raw->addRef(), 3U);
        raw->release();
        copy = std::move(copy);
        copy = nullptr;
        const auto face = PluginPtr<Steinberg::Vst::IMessage>::Query(owner);
        EXPECT_EQ(face.Get(), raw);
        EXPECT_FALSE(PluginPtr<Steinberg::Vst::IAttributeList>::Query(owner));
        EXPECT_EQ(raw->addRef(), 3U);
        raw->release();
        raw->addRef();
    }
    EXPECT_EQ(raw->release(), 0U) << "all owners have gone, only the reference of this test was left";
    EXPECT_FALSE(PluginPtr<Steinberg::Vst::IMessage>::Query(nullptr));
}

TEST(InterfaceIDs, HaveThePublishedBytes)
{
    struct Case
    {
        const char* mName;
        const Steinberg::FUID& mID;
        const char* mBytes;
    };
    const Case cases[] = {
        {"vendor component", IVST3CorvaneVendorSpecificComponent::iid,
         "\x87\x2e\xe7\x90\x61\xb2\x43\xa2\x8d\xba\x33\xc1\xd9\x26\x2d\x3e"},
        {"vendor host", IVST3CorvaneVendorSpecificHost::iid,
         "\x7f\xcb\xcf\xce\x28\x62\x47\x6a\xbf\xf2\x21\x9b\xca\x70\x78\x9d"},
        {"vendor effect", IVST3CorvaneVendorSpecificEffect::iid,
         "\x3c\x8a\x2f\x25\x14\x11\x4b\xf7\x85\x1b\x13\xcb\x9c\x55\xac\x92"},
        {"plug frame", Steinberg::IPlugFrame::iid,
         "\x36\x7f\xaf\x01\xaf\xa9\x46\x93\x8d\x4d\xa2\xa0\xed\x08\x82\xa3"},
        {"plug view", Steinberg::IPlugView::iid, "\x5b\xc3\x25\x07\xd0\x60\x49\xea\xa6\x15\x1b\x52\x2b\x75\x5b\x29"},
        {"run loop", Steinberg::Linux::IRunLoop::iid,
         "\x18\xc3\x53\x66\x97\x76\x4f\x1a\x9c\x5b\x83\x85\x7a\x87\x13\x89"},
    };
    for (const Case& test : cases)
        EXPECT_EQ(std::memcmp(test.mID.toTUID(), test.mBytes, 16), 0) << test.mName;
    EXPECT_TRUE(Steinberg::IPlugViewContentScaleSupport::iid.isValid());
    EXPECT_TRUE(Steinberg::Linux::IEventHandler::iid.isValid());
    EXPECT_TRUE(Steinberg::Linux::ITimerHandler::iid.isValid());
}

} // namespace

} // namespace zebaudiofilterhost::vst3
