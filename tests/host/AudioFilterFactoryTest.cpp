#include "host/AudioFilterFactory.h"

#include "audiofilter/AudioFilter.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterRegistrar.h"
#include "host/PluginModuleInfoManager.h"
#include "module/Module.h"
#include "tests/host/CatalogueFixture.h"
#include "utility/EffectUtils.h"

#include <boost/function/function_base.hpp>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;
using FilterPtr = boost::intrusive_ptr<AudioFilter>;

class AudioFilterFactoryTest : public CatalogueFixture
{
protected:
    /// A descriptor whose filters are made by this test's function.
    DescriptorPtr Add(const PluginLocator& locator, const UTF16String& id)
    {
        const DescriptorPtr descriptor = MakeExternal(locator, id, mGuid);
        mManager.AddAudioFilterDescriptor(descriptor);
        return descriptor;
    }

    AudioFilterFactory::FactoryFunction RecordingFunction()
    {
        return [this](const UTF16String& id)
        {
            mMade.push_back(Text(id));
            return FilterPtr(new AudioFilter(id, u"Made"));
        };
    }

    AudioFilterFactoryTest() { mFactory.RegisterFactoryFunction(mGuid, RecordingFunction()); }

    AudioFilterDescriptorManager& mManager = AudioFilterDescriptorManager::GetInstance();
    AudioFilterFactory& mFactory = AudioFilterFactory::GetInstance();
    const Guid mGuid = Guid::CreateUnique(); // registrations last to the end of the process
    Strings mMade;                           // the IDs that the factory function was given
};

} // namespace

TEST_F(AudioFilterFactoryTest, FactoryPassesTheCallersFormOfTheID)
{
    Add(VST2(u"/v"), u"2:123 Name");
    EXPECT_TRUE(mFactory.CreateAudioFilter(u"123 Name"));
    EXPECT_TRUE(utility::CreateAudioFilter(u"123 Name"));
    EXPECT_EQ(mMade, (Strings{"123 Name", "2:123 Name"}));
}

TEST_F(AudioFilterFactoryTest, IDWithoutDigitPrefersAudioUnitOverVST)
{
    Add(VST2(u"/v"), u"2:x");
    Add(AudioUnit(u"c"), u"4:x");
    const DescriptorPtr plain = MakeExternal(VST2(u"/v"), u"y", mGuid);
    mManager.AddAudioFilterDescriptor(plain);
    Add(AudioUnit(u"c"), u"4:y");
    utility::CreateAudioFilter(u"x");
    utility::CreateAudioFilter(u"y");
    EXPECT_EQ(mMade, (Strings{"4:x", "y"}));
}

TEST_F(AudioFilterFactoryTest, RenamedVSTPluginIsFoundByItsNumber)
{
    Add(VST2(u"/v"), u"2:1234");
    Add(VST2(u"/v"), u"2:12345 Long");
    Add(VST2(u"/v"), u"2:1234 New name");
    Add(VST2(u"/v"), u"2:1234 Newer");
    Add(VST3(u"/w"), u"3:77 New");
    struct Case
    {
        UTF16String id;
        Strings made;
    };
    const std::vector<Case> cases = {
        {u"2:1234 Old name", {"2:1234 New name"}},
        {u"2:1234 ", {"2:1234 New name"}},
        {u"2:12345 x", {"2:12345 Long"}},
        {u"2:123 Old name", {}},
        {u"2:9999 New name", {}},
        {u"2:12", {}},
        {u"1234 Old name", {}},
        {u"3:77 Old", {}},
        {u"2 ", {}},
    };
    for (const Case& expected : cases)
    {
        SCOPED_TRACE(Text(expected.id));
        mMade.clear();
        EXPECT_EQ(static_cast<bool>(utility::CreateAudioFilter(expected.id)), !expected.made.empty());
        EXPECT_EQ(mMade, expected.made);
    }
}

TEST_F(AudioFilterFactoryTest, OnlyTheApplicationsRoadHonoursDisabling)
{
    const DescriptorPtr descriptor = Add(VST3(u"/a"), u"3:a");
    descriptor->SetEnabled(false);
    EXPECT_FALSE(utility::CreateAudioFilter(u"3:a"));
    EXPECT_TRUE(mFactory.CreateAudioFilter(u"3:a"));

    descriptor->SetEnabled(true);
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    EXPECT_TRUE(utility::CreateAudioFilter(u"3:a")) << "a plug-in without a record counts as enabled";
    infos.AddPluginModuleInfo(MakeInfo(VST3(u"/a"), false));
    EXPECT_FALSE(utility::CreateAudioFilter(u"3:a"));
    infos.SetPluginEnabled(VST3(u"/a"), true);
    EXPECT_TRUE(utility::CreateAudioFilter(u"3:a"));

    const DescriptorPtr internal = MakeInternal(u"gain", mGuid);
    mManager.AddAudioFilterDescriptor(internal);
    infos.AddPluginModuleInfo(MakeInfo(internal->GetLocator(), false));
    EXPECT_TRUE(utility::CreateAudioFilter(u"gain")) << "a built-in filter has no plug-in to disable";
}

TEST_F(AudioFilterFactoryTest, UnknownAndBrokenRegistrations)
{
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"", mGuid));
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:no function", Guid::CreateUnique()));
    EXPECT_FALSE(utility::CreateAudioFilter(u""));
    EXPECT_FALSE(utility::CreateAudioFilter(u"3:nobody"));
    EXPECT_FALSE(utility::CreateAudioFilter(u"3:no function"));
    EXPECT_FALSE(mFactory.CreateAudioFilter(u"3:no function"));
    EXPECT_TRUE(mMade.empty());

    const Guid empty = Guid::CreateUnique();
    mFactory.RegisterFactoryFunction(empty, AudioFilterFactory::FactoryFunction());
    mFactory.RegisterFactoryFunction(empty, RecordingFunction());
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:empty", empty));
    EXPECT_THROW(mFactory.CreateAudioFilter(u"3:empty"), boost::bad_function_call);

    const Guid throwing = Guid::CreateUnique();
    mFactory.RegisterFactoryFunction(throwing,
                                     [](const UTF16String&) -> FilterPtr { throw std::runtime_error("plug-in"); });
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:throwing", throwing));
    EXPECT_THROW(utility::CreateAudioFilter(u"3:throwing"), std::runtime_error);
}

TEST_F(AudioFilterFactoryTest, InitializeEntersWhatWasDeferredOnceForEachFirstCall)
{
    int nested = 0;
    const AudioFilterRegistrar first(
        [this, &nested]
        {
            if (++nested == 1)
            {
                AudioFilterRegistrar([this] { return MakeInternal(u"late", mGuid); }, RecordingFunction());
            }
            return MakeInternal(u"gain", mGuid);
        },
        [](const UTF16String&) { return FilterPtr(); });
    AudioFilterRegistrar([] { return DescriptorPtr(); }, RecordingFunction());
    EXPECT_TRUE(CatalogueIDs().empty());

    EXPECT_TRUE(Initialize());
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "late"}));
    EXPECT_TRUE(utility::CreateAudioFilter(u"gain")) << "the first function of a GUID stays";
    const DescriptorPtr gain = mManager.GetComponentDescriptorForID(u"gain");

    EXPECT_TRUE(Initialize());
    Terminate();
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "late"}));
    Terminate();
    EXPECT_TRUE(Initialize());
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "late", "gain", "late"}));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"gain"), gain);
    Terminate();
}

TEST_F(AudioFilterFactoryTest, EmptyDescriptorFunctionThrows)
{
    AudioFilterRegistrar(AudioFilterRegistrar::DescriptorFunction(), RecordingFunction());
    EXPECT_THROW(AudioFilterRegistrar::RegisterDeferredDescriptors(), boost::bad_function_call);
}

} // namespace zebaudiofilterhost::testing
