// A VST 3 filter as the host that its plug-in sees.

#include "host/PluginModule.h"
#include "tests/vst3/FakePlugin.h"

#include <pluginterfaces/vst/ivstmessage.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace fakeplugin;
using zebaudiofilterhost::PluginModule;
using zebaudiofilterhost::vst3::IVST3CorvaneVendorSpecificHost;
using zebaudiofilterhost::vst3::PluginPtr;

namespace
{

class FilterHostServices : public testing::Test
{
protected:
    FilterHostServices() : filter(plugin.MakeFilter()) {}

    IHostApplication& Host() { return *filter; }

    tresult CreateInstance(const FUID& classID, const FUID& interfaceID, void** object)
    {
        TUID first;
        TUID second;
        classID.toTUID(first);
        interfaceID.toTUID(second);
        return Host().createInstance(first, second, object);
    }

    FakePlugin plugin;
    boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> filter;
};

} // namespace

TEST_F(FilterHostServices, EveryFaceIsAnswered)
{
    auto* filterPointer = filter.get();
    const std::pair<FUID, void*> faces[] = {
        {FUnknown::iid, static_cast<IHostApplication*>(filterPointer)},
        {IHostApplication::iid, static_cast<IHostApplication*>(filterPointer)},
        {IComponentHandler::iid, static_cast<IComponentHandler*>(filterPointer)},
        {IUnitHandler::iid, static_cast<IUnitHandler*>(filterPointer)},
        {IVST3CorvaneVendorSpecificHost::iid, static_cast<IVST3CorvaneVendorSpecificHost*>(filterPointer)}};
    for (FUnknown* asked : {plugin.hostContext, static_cast<FUnknown*>(plugin.handler)})
    {
        for (const auto& [iid, face] : faces)
        {
            void* object = nullptr;
            EXPECT_EQ(asked->queryInterface(iid, &object), kResultOk);
            EXPECT_EQ(object, face);
        }
        void* object = this;
        EXPECT_EQ(asked->queryInterface(IPlugView::iid, &object), kNoInterface);
        EXPECT_EQ(object, nullptr);
    }
}

TEST_F(FilterHostServices, ReferencesOfThePluginDoNotCount)
{
    EXPECT_EQ(Host().addRef(), 1U);
    EXPECT_EQ(Host().release(), 1U);
    EXPECT_EQ(Host().release(), 1U);
    EXPECT_EQ(filter->GetRefCount(), 1);
}

TEST_F(FilterHostServices, NameIsWrittenWithoutTerminator)
{
    String128 name;
    std::fill(std::begin(name), std::end(name), u'#');
    EXPECT_EQ(Host().getName(name), kResultOk);
    EXPECT_TRUE(std::u16string(name, 10) == u"Larkspur##");
}

TEST_F(FilterHostServices, MakesMessagesAndAttributeLists)
{
    for (const FUID& iid : {IMessage::iid, IAttributeList::iid})
    {
        void* object = nullptr;
        EXPECT_EQ(CreateInstance(iid, iid, &object), kResultOk);
        ASSERT_NE(object, nullptr);
        EXPECT_EQ(static_cast<FUnknown*>(object)->release(), 0U);
    }
    void* object = this;
    EXPECT_EQ(CreateInstance(IMessage::iid, IAttributeList::iid, &object), kResultFalse);
    EXPECT_EQ(object, nullptr);
    object = this;
    EXPECT_EQ(CreateInstance(IEventList::iid, IEventList::iid, &object), kResultFalse);
    EXPECT_EQ(object, nullptr);
    object = this;
    EXPECT_EQ(Host().createInstance(nullptr, nullptr, &object), kResultFalse);
    EXPECT_EQ(object, nullptr);
}

TEST_F(FilterHostServices, UnitHandlerAgrees)
{
    EXPECT_EQ(filter->notifyUnitSelection(3), kResultOk);
    EXPECT_EQ(filter->notifyProgramListChange(1, -1), kResultOk);
}

TEST_F(FilterHostServices, LanguageIsTheApplications)
{
    const std::string before = PluginModule::GetLocaleIdentifier();
    const std::pair<const char16_t*, int> languages[] = {{u"de_DE", 1}, {u"fr_FR", 2}, {u"ja_JP", 3},
                                                         {u"es_ES", 4}, {u"it_IT", 5}, {u"ko_KR", 6},
                                                         {u"zh_CN", 7}, {u"en_US", 0}, {u"de_AT", 0}};
    for (const auto& [locale, code] : languages)
    {
        PluginModule::SetLocaleIdentifier(locale);
        EXPECT_EQ(filter->GetUILanguage(), code);
        const std::string narrow(filter->GetUILanguageString());
        EXPECT_TRUE(zebaudiofilterhost::UTF16String(narrow.begin(), narrow.end()) == locale);
    }
    PluginModule::SetLocaleIdentifier(zebaudiofilterhost::UTF16String(before.begin(), before.end()));
}

TEST_F(FilterHostServices, ThemeIsKept)
{
    PluginModule::SetThemeXML(u8"<theme/>");
    EXPECT_EQ(filter->GetThemeXMLLength(), 0);
    unsigned char buffer[1] = {'#'};
    filter->GetThemeXML(buffer);
    EXPECT_EQ(buffer[0], '#');
    PluginModule::SetThemeXML(u8"");
}
