// What a VST 2 filter writes into the catalogue.

#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/VST/VSTTechnology.h"
#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

using namespace fakeeffect;
using namespace zebaudiofilterhost;
using testing::HasSubstr;

namespace
{

class Descriptor : public FilterTest
{
protected:
    boost::intrusive_ptr<AudioFilterDescriptor> Describe(bool skipCategory = false)
    {
        Make();
        return filter->CreateFilterDescriptor(PluginLocator(kTechnologyVST, u"/plug-ins/Located.vst"), skipCategory);
    }
};

} // namespace

TEST_F(Descriptor, TellsWhoThePlugInIs)
{
    fake.effect.uniqueID = -2;
    fake.Text(effGetVendorString, "Maker");
    const auto descriptor = Describe();
    EXPECT_EQ(descriptor->GetLocator(), PluginLocator(kTechnologyVST, u"/plug-ins/Located.vst"));
    EXPECT_EQ(descriptor->GetName(), u"Title.of.file");
    EXPECT_EQ(descriptor->GetVendorString(), u"Maker");
    EXPECT_EQ(descriptor->GetVersion(), 2400U);
    EXPECT_EQ(descriptor->GetUniqueID(), u"2:4294967294 Located");
    EXPECT_EQ(descriptor->GetFactoryGuid(), GetVSTFactoryGuid());
    EXPECT_TRUE(descriptor->IsEnabled());
    EXPECT_FALSE(descriptor->IsSynth());
    fake.effect.flags |= effFlagsIsSynth;
    EXPECT_TRUE(Describe()->IsSynth());
}

TEST_F(Descriptor, MapsTheCategory)
{
    struct
    {
        int version;
        int plugCategory;
        AudioFilterCategory category;
    } const rows[] = {
        {2400, kPlugCategEffect, kCategoryEffect},
        {2400, kPlugCategRestoration, kCategoryRestoration},
        {2400, kPlugCategOfflineProcess, kCategoryOfflineProcess},
        {2400, kPlugCategShell, kCategoryNone},
        {2400, kPlugCategGenerator, kCategoryGenerator},
        {2400, kPlugCategUnknown, kCategoryNone},
        {2400, 12, kCategoryNone},
        {2400, -1, kCategoryNone},
        {2, kPlugCategMastering, kCategoryMastering},
        {1, kPlugCategMastering, kCategoryNone},
        {0, kPlugCategMastering, kCategoryNone},
    };
    for (const auto& row : rows)
    {
        fake.Return(effGetVstVersion, row.version);
        fake.Return(effGetPlugCategory, row.plugCategory);
        EXPECT_EQ(Describe()->GetCategory(), row.category) << row.version << ", " << row.plugCategory;
    }
}

TEST_F(Descriptor, DoesNotAskForTheCategoryInAQuickScan)
{
    fake.Return(effGetPlugCategory, kPlugCategEffect);
    EXPECT_EQ(Describe(true)->GetCategory(), kCategoryNotQueried);
    EXPECT_EQ(fake.Count("effGetPlugCategory"), 0U);
}

// By the pins, since the fake refuses arrangements.
TEST_F(Descriptor, TriesMonoAndStereo)
{
    struct
    {
        int inputs;
        int outputs;
        int flags;
        bool mono;
        bool stereo;
    } const rows[] = {
        {1, 1, 0, true, false},  {2, 2, 0, false, true},  {2, 2, effFlagsCanMono, true, true},
        {0, 2, 0, false, false}, {6, 6, 0, false, false}, {1, 2, 0, false, true},
    };
    for (const auto& row : rows)
    {
        fake.effect.numInputs = row.inputs;
        fake.effect.numOutputs = row.outputs;
        fake.effect.flags = effFlagsCanReplacing | row.flags;
        const auto descriptor = Describe();
        EXPECT_EQ(descriptor->GetSupportsMono(), row.mono) << row.inputs << " to " << row.outputs;
        EXPECT_EQ(descriptor->GetSupportsStereo(), row.stereo) << row.inputs << " to " << row.outputs;
    }
}

TEST_F(Descriptor, TracesTheName)
{
    std::string trace;
    zebcore::debug::SetTraceSink([&trace](std::string_view line) { trace += line; });
    zebcore::debug::SetTraceCategoryEnabled("VST", true);
    Describe();
    zebcore::debug::SetTraceCategoryEnabled("VST", false);
    zebcore::debug::SetTraceSink({});
    EXPECT_THAT(trace, HasSubstr("CreateFilterDescriptor, Effectname: Title.of.file\n"));
}
