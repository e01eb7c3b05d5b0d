#include "Subject.h"

#include "ControlFilter.h"
#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"

#include <algorithm>
#include <cctype>

namespace soak
{

using namespace zebaudiofilterhost;

namespace
{

void Scan()
{
    std::vector<PluginLocator> gone;
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    infos.ResetToDefaultFolders();
    const boost::intrusive_ptr<PluginModuleScanner> scanner(
        new PluginModuleScanner(infos.CollectPotentialPlugins(false, gone), false));
    scanner->BeginScan();
    while (scanner->ContinueScan())
    {
        zebcore::threads::PumpMainThread();
    }
    scanner->EndScan();
}

const char* TechnologyName(const AudioFilterDescriptor& descriptor)
{
    switch (descriptor.GetLocator().GetTechnologyType())
    {
    case kTechnologyVST:
        return "VST 2";
    case kTechnologyVST3:
        return "VST 3";
    case kTechnologyAudioUnit:
        return "Audio Unit";
    default:
        return "built in";
    }
}

std::string Lowered(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char letter) { return static_cast<char>(std::tolower(letter)); });
    return text;
}

// Plug-ins' texts come with zero units behind them.
std::string Unpadded(const UTF16String& text)
{
    return zebcore::utility::NarrowFromUTF16(text.substr(0, text.find(u'\0')));
}

// By the vendor, which the example effects of all technologies tell. A unit's locator has no path.
bool IsOwn(const AudioFilterDescriptor& descriptor)
{
    const std::string vendor = Unpadded(descriptor.GetVendorString());
    return descriptor.GetUniqueID() == kControlFilterID || vendor == "Zeb Audio" || vendor == "Zeb";
}

// Whether one of the texts is in the name.
bool HasText(const std::string& name, const std::vector<std::string>& texts)
{
    return std::any_of(texts.begin(), texts.end(),
                       [lowered = Lowered(name)](const std::string& text)
                       { return lowered.find(Lowered(text)) != std::string::npos; });
}

Subject ToSubject(const AudioFilterDescriptor& descriptor, const std::vector<std::string>& withoutEditor)
{
    const std::string name = Unpadded(descriptor.GetName());
    const std::string path = zebcore::filesupport::ToNativePath(descriptor.GetLocator().GetPath());
    const bool withEditor =
        std::none_of(withoutEditor.begin(), withoutEditor.end(),
                     [&path](const std::string& part) { return path.find(part) != std::string::npos; });
    return {descriptor.GetUniqueID(), name + " (" + TechnologyName(descriptor) + ")", withEditor, IsOwn(descriptor)};
}

} // namespace

std::vector<Subject> FindSubjects(const Options& options, std::vector<std::string>& leftOutNames)
{
    Scan();
    std::vector<Subject> subjects;
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    for (auto descriptor = catalogue.InfoBegin(); descriptor != catalogue.InfoEnd(); ++descriptor)
    {
        Subject subject = ToSubject(**descriptor, options.withoutEditorOf);
        if (subject.id == kControlFilterID)
        {
            subjects.push_back(std::move(subject));
        }
        else if (HasText(subject.name, options.leftOut))
        {
            leftOutNames.push_back(subject.name);
        }
        else if (HasText(subject.name, {options.only}))
        {
            subjects.push_back(std::move(subject));
        }
    }
    // The order of a folder's entries must not change what a random start gives.
    std::sort(subjects.begin(), subjects.end(), [](const Subject& a, const Subject& b) { return a.id < b.id; });
    return subjects;
}

} // namespace soak
