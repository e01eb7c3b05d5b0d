#include "host/src/XAU/linux/src/ComponentBundle.h"
#include "tests/persistence/TempFolder.h"
#include "tests/support/VariableGuard.h"
#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TraceText.h"

#include <gmock/gmock.h>

#include <cstdlib>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr OSType kTestMaker = 0x74736574; // of the bundles of this file alone

std::string Entry(const std::string& subType, const std::string& name, const std::string& more = {})
{
    return "<dict><key>type</key><string>aufx</string><key>subtype</key><string>" + subType +
           "</string><key>manufacturer</key><string>tset</string><key>name</key><string>" + name + "</string>" +
           more + "</dict>";
}

std::string WithFactory(const std::string& name, const std::string& version = "<integer>65538</integer>")
{
    return "<key>factoryFunction</key><string>" + name + "</string><key>version</key>" + version;
}

class ComponentRegistryTest : public testing::Test
{
protected:
    void WriteBundle(const std::string& path, const std::string& entries) const
    {
        WriteInfo(path, "<plist version=\"1.0\"><dict><key>AudioComponents</key><array>" + entries +
                            "</array></dict></plist>");
    }
    void WriteInfo(const std::string& path, const std::string& content) const
    {
        std::filesystem::create_directories(mFolder.Path(path + "/Contents"));
        mFolder.Write(path + "/Contents/Info.plist", content);
    }

    static std::vector<std::string> Names()
    {
        std::vector<std::string> names;
        const AudioComponentDescription description = {0, 0, kTestMaker, 0, 0};
        AudioComponent found = AudioComponentFindNext(nullptr, &description);
        for (; found; found = AudioComponentFindNext(found, &description))
        {
            CFStringRef name = nullptr;
            EXPECT_EQ(AudioComponentCopyName(found, &name), noErr);
            const CFOwner owner(name);
            const UTF16String text = MACtoZEB(name);
            names.emplace_back(text.begin(), text.end());
        }
        return names;
    }
    static AudioComponent Find(OSType subType)
    {
        const AudioComponentDescription description = {kAudioUnitType_Effect, subType, kTestMaker, 0, 0};
        return AudioComponentFindNext(nullptr, &description);
    }

    TempFolder mFolder;
    zebtest::VariableGuard mPath{"AUDIO_COMPONENT_PATH", mFolder.Path().string()};
};

// One test, since what the registry has once read it never forgets.
TEST_F(ComponentRegistryTest, ListsWhatBundlesSayInFullAndOpensNone)
{
    WriteBundle("Good.component", Entry("goo1", "Maker: One", WithFactory("F")) +
                                      Entry("goo2", "Maker: Two", WithFactory("G", "<string>x</string>")));
    WriteBundle("deeper/still/Nested.component", Entry("nest", "Maker: Nested", WithFactory("F")));
    WriteBundle("NoFactory.component", Entry("nofa", "Maker: Without factory"));
    WriteBundle("EmptyFactory.component", Entry("emfa", "Maker: Empty factory", WithFactory("")));
    WriteBundle("LongCode.component", Entry("toolong", "Maker: Long code", WithFactory("F")));
    WriteBundle("NoEntries.component", "");
    WriteBundle("Strange.component",
                "<string>x</string><dict/><integer>1</integer>" + Entry("stra", "Maker: Strange", WithFactory("F")));
    WriteBundle("Copy.component", Entry("goo1", "Maker: Second one", WithFactory("F")));
    WriteInfo("Broken.component", "<plist><dict><key>Audio");
    WriteInfo("Other.component", "<plist version=\"1.0\"><array/></plist>");
    WriteInfo("Text.component",
              "<plist version=\"1.0\"><dict><key>AudioComponents</key><string>x</string></dict></plist>");
    std::filesystem::create_directories(mFolder.Path("Empty.component"));
    WriteBundle("Other.folder", Entry("fold", "Maker: No component", WithFactory("F")));

    const std::vector<std::string> names = Names();
    EXPECT_THAT(names, testing::UnorderedElementsAre(testing::AnyOf("Maker: One", "Maker: Second one"), "Maker: Two",
                                                     "Maker: Nested", "Maker: Strange"));
    EXPECT_EQ(Names(), names) << "another order";
    UInt32 version = 1;
    EXPECT_EQ(AudioComponentGetVersion(Find(0x676F6F31), &version), noErr);
    EXPECT_TRUE(version == 65538);
    EXPECT_EQ(AudioComponentGetVersion(Find(0x676F6F32), &version), noErr);
    EXPECT_EQ(version, 0U) << "a text is no version";

    // There are no binaries: nobody has looked for them yet.
    AudioComponentInstance instance = nullptr;
    EXPECT_NE(AudioComponentInstanceNew(Find(0x6E657374), &instance), noErr);
    EXPECT_EQ(instance, nullptr);

    WriteBundle("Late.component", Entry("late", "Maker: Late", WithFactory("F")));
    EXPECT_EQ(Names().size(), names.size() + 1);
    EXPECT_EQ(Names().back(), "Maker: Late");
}

TEST_F(ComponentRegistryTest, TracesTheFirstFaultOfAnEntryThatItLeavesOut)
{
    WriteBundle("Faults.component",
                Entry("ab", "Maker: Short code", WithFactory("F")) +
                    Entry("full", "Maker: Complete", WithFactory("F")) + "<string>x</string><dict/>" +
                    Entry("nofa", "Maker: No function") +
                    "<dict><key>type</key><string>aufx</string><key>subtype</key><string>code</string>"
                    "<key>manufacturer</key><integer>5</integer></dict>");
    const TraceText trace("ComponentBundle");
    const std::filesystem::path bundle = mFolder.Path("Faults.component");
    EXPECT_EQ(ReadComponentBundle(bundle.u16string()).size(), 1U);
    std::vector<testing::Matcher<std::string>> faults;
    for (const char* fault : {"0: subtype", "2: no dictionary", "3: type", "4: factoryFunction", "5: manufacturer"})
    {
        const std::string text = fault;
        faults.emplace_back(testing::AllOf(testing::HasSubstr(bundle.string() + ": entry " + text.substr(0, 1) + " "),
                                           testing::EndsWith(text.substr(3) + "\n")));
    }
    EXPECT_THAT(trace.mLines, testing::ElementsAreArray(faults));
}

TEST_F(ComponentRegistryTest, ARegisteredDescriptionStays)
{
    const FakeUnit unit(kAudioUnitType_Panner, "Maker: First");
    const auto none = [](const AudioComponentDescription*) -> AudioComponentPlugInInterface*
    {
        return nullptr;
    };
    const AudioComponentDescription description = unit.GetDescription();
    EXPECT_EQ(AudioComponentRegister(&description, CFSTR("Maker: Second"), 1, none), unit.GetComponent());
    EXPECT_EQ(AudioComponentRegister(&description, CFSTR("x"), 1, nullptr), nullptr);
    EXPECT_EQ(AudioComponentFindNext(nullptr, &description), unit.GetComponent());
    EXPECT_EQ(AudioComponentCount(&description), 1U);
}

TEST_F(ComponentRegistryTest, InstancesComeFromTheFactoryAndGoByClose)
{
    FakeUnit unit;
    AudioComponentInstance instance = nullptr;
    ASSERT_EQ(AudioComponentInstanceNew(unit.GetComponent(), &instance), noErr);
    EXPECT_EQ(unit.GetInstance(), instance);
    EXPECT_EQ(AudioComponentInstanceGetComponent(instance), unit.GetComponent());
    EXPECT_EQ(AudioUnitAddRenderNotify(instance, nullptr, nullptr), kAudio_UnimplementedError);
    UInt32 size = 0;
    EXPECT_EQ(
        AudioUnitGetProperty(instance, kAudioUnitProperty_ElementCount, kAudioUnitScope_Input, 0, nullptr, &size),
        noErr);
    EXPECT_EQ(size, sizeof(UInt32));
    EXPECT_EQ(AudioComponentInstanceDispose(instance), noErr);
    EXPECT_EQ(unit.mCalls, (std::vector<std::string>{"create", "close"}));
    unit.mGivesInstance = false;
    EXPECT_NE(AudioComponentInstanceNew(unit.GetComponent(), &instance), noErr);
    EXPECT_EQ(instance, nullptr);
}

// An instance whose Open fails has deleted itself: a call of it then would be one of freed memory.
TEST_F(ComponentRegistryTest, AnInstanceThatDoesNotOpenIsNotClosed)
{
    FakeUnit unit;
    AudioComponentInstance instance = nullptr;
    unit.mOpenResult = kAudioUnitErr_FailedInitialization;
    EXPECT_EQ(AudioComponentInstanceNew(unit.GetComponent(), &instance), kAudioUnitErr_FailedInitialization);
    EXPECT_EQ(instance, nullptr);
    EXPECT_EQ(unit.CountCalls("close"), 0U);
}

TEST_F(ComponentRegistryTest, WhatAFactoryThrowsIsAnError)
{
    FakeUnit unit;
    AudioComponentInstance instance = nullptr;
    unit.mThrowsIn = {"create"};
    EXPECT_NE(AudioComponentInstanceNew(unit.GetComponent(), &instance), noErr);
    EXPECT_EQ(instance, nullptr);
}

TEST_F(ComponentRegistryTest, NullArgumentsAreErrors)
{
    AudioComponentInstance instance = nullptr;
    Float32 value = 0.0F;
    EXPECT_EQ(AudioComponentInstanceNew(nullptr, &instance), kAudio_ParamError);
    EXPECT_EQ(AudioComponentInstanceDispose(nullptr), kAudio_ParamError);
    EXPECT_EQ(AudioUnitInitialize(nullptr), kAudio_ParamError);
    EXPECT_EQ(AudioUnitGetParameter(nullptr, 0, 0, 0, &value), kAudio_ParamError);
    EXPECT_EQ(AudioComponentFindNext(nullptr, nullptr), nullptr);
}

} // namespace
} // namespace zebaudiofilterhost::xau
