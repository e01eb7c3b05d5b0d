#include "fuzz/support/Catalogue.h"

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/Target.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"

#include <algorithm>
#include <iterator>
#include <set>

namespace zebfuzz
{

using namespace zebaudiofilterhost;

const UTF16String kRecordedPath = u"/opt/vst3/Recorded.vst3";
const UTF16String kPrivateFilterID = u"3:5a656247 61696e00 10000000 1";
const UTF16String kPrivatePath = u"/opt/private/Gain.vst3";

namespace
{

bool sIsFilled = false;

PropList PrivateConfiguration()
{
    PropList list;
    list.SetValue(u8"num_descriptors", 1);
    const AudioFilterDescriptor descriptor(PluginLocator(kTechnologyVST3, kPrivatePath), u"Gain", u"Vendor", 1,
                                           kCategoryEffect, kPrivateFilterID, Guid(), false);
    descriptor.Write(list.GetOrCreateSubList(u8"descriptor0"));
    return list;
}

UTF8String TextOf(const PropList& list)
{
    UTF8String text;
    zebcore::proplist::utils::WritePropList(text, list);
    return text;
}

} // namespace

void EmptyCatalogue()
{
    TouchCatalogue();
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    infos.SetPrivatePluginConfiguration(u8"");
    infos.ClearAll(true);
    for (const auto& technology : infos.GetPluginTechnologies())
        technology->RemoveAllPluginDirectories();
    AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    std::vector<PluginLocator> locators;
    std::transform(descriptors.InfoBegin(), descriptors.InfoEnd(), std::back_inserter(locators),
                   [](const auto& descriptor) { return descriptor->GetLocator(); });
    descriptors.ClearInfosForLocators(locators);
    BannedPluginManager::GetInstance().ReadBannedPlugins(PropList());
}

void TouchCatalogue()
{
    sIsFilled = false;
}

std::string CatalogueText()
{
    PropList list;
    PluginModuleInfoManager::GetInstance().BuildConfigurationPropList(list, true);
    return ListText(list);
}

void FillCatalogue()
{
    if (sIsFilled)
        return;
    static const PropList sPrivate = PrivateConfiguration();
    static const UTF8String sPrivateText = TextOf(sPrivate);
    EmptyCatalogue();
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    infos.AddPluginModuleInfo(new PluginModuleInfo(PluginLocator(kTechnologyVST3, kRecordedPath), u"Recorded",
                                                   u"Vendor", 1, kTechnologyVST3, true, false));
    if (const auto technology = infos.GetPluginTechnology(kTechnologyVST3))
        technology->AddPluginDirectories({u"/opt/vst3"});
    infos.SetPrivatePluginConfiguration(sPrivateText);
    AudioFilterDescriptorManager::GetInstance().ClearExternalInfos();
    AudioFilterDescriptorManager::GetInstance().ReadExternalComponentDescriptors(sPrivate, false);
    sIsFilled = true;
}

void ExpectSoundCatalogue()
{
    const PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    std::set<PluginLocator> locators;
    for (auto info = infos.PluginInfoBegin(); info != infos.PluginInfoEnd(); ++info)
    {
        Expect(locators.insert((*info)->GetLocator()).second, "a plug-in has one record");
        Expect(infos.FindPluginInfo((*info)->GetLocator()) == *info, "look-up finds the record");
    }
    Expect(infos.GetPluginLocators().size() == locators.size(), "all records are looked up and walked over");

    const AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    for (auto descriptor = descriptors.InfoBegin(); descriptor != descriptors.InfoEnd(); ++descriptor)
        Expect(descriptors.GetComponentDescriptorForID((*descriptor)->GetUniqueID()) == *descriptor,
               "a filter ID that was read stands for one descriptor");
}

void ExpectRecord()
{
    const auto info =
        PluginModuleInfoManager::GetInstance().FindPluginInfo(PluginLocator(kTechnologyVST3, kRecordedPath));
    Expect(info != nullptr, "a record that was there stays");
}

void ExpectPrivateDescriptor()
{
    const auto descriptor = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(kPrivateFilterID);
    Expect(descriptor && descriptor->GetLocator() == PluginLocator(kTechnologyVST3, kPrivatePath),
           "a private descriptor wins over that of a file");
}

} // namespace zebfuzz
