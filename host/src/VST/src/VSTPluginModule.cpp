#include "host/src/VST/src/VSTPluginModule.h"

#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleManager.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTEntryPoints.h"
#include "host/src/VST/src/VSTFilterID.h"
#include "host/src/VST/src/VSTPluginFiles.h"

#include <algorithm>
#include <vector>

namespace zebaudiofilterhost::vst
{

using zebcore::utility::UTF16to8;

namespace
{

using Modules = PluginModuleManager<boost::intrusive_ptr<VSTPluginModule>>;

Modules& GetModules()
{
    static Modules sVSTPluginModuleManager;
    return sVSTPluginModuleManager;
}

} // namespace

VSTPluginModule::VSTPluginModule(const UTF16String& path) : PluginModule(path, true)
{
}
VSTPluginModule::~VSTPluginModule() = default;

bool VSTPluginModule::Load()
{
    if (GetOSModule())
        return false;
    UTF16String problem = FindPluginProblem(GetPath());
    if (problem.empty() && !PluginModule::Load())
        problem = zebcore::utility::GetLastOSModuleError();
    SetLoadProblem(GetPath(), problem);
    if (!problem.empty())
        return false;
    if (FindEntryPoint())
        return true;
    PluginModule::Unload();
    SetProblem(kNoEntryPoint);
    return false;
}

void VSTPluginModule::SetProblem(const UTF16String& ending) const
{
    SetLoadProblem(GetPath(), ending.empty() ? UTF16String() : u"\"" + GetPath() + u"\"" + ending);
}

bool VSTPluginModule::FindEntryPoint()
{
    const std::vector<const char*> names = FindEntryPoints(GetPath());
    return std::any_of(names.begin(), names.end(),
                       [this](const char* name)
                       {
                           mEntryPoint = reinterpret_cast<VSTPluginMainProc>(
                               zebcore::utility::GetFunctionPointerFromModuleImpl(GetOSModule(), name));
                           return mEntryPoint != nullptr;
                       });
}

void VSTPluginModule::Unload()
{
    if (GetOSModule())
        PluginModule::Unload();
}

AEffect* VSTPluginModule::MakeEffect(unsigned int uniqueID) const
{
    VSTAudioFilter::SetCurrentFilterID(static_cast<int>(uniqueID));
    // Holds if the entry function throws, which passes through.
    SetProblem(u" refuses to work: its entry function throws.");
    AEffect* effect = mEntryPoint(VSTAudioFilter::StaticAudioMasterCallback);
    SetProblem(effect ? u"" : u" refuses to work: its entry function gives no plug-in.");
    return effect;
}

boost::intrusive_ptr<AudioFilter> VSTPluginModule::CreateAudioFilter(const UTF16String& filterID)
{
    if (!mEntryPoint)
        return nullptr;
    unsigned int uniqueID = 0;
    DecodeFilterID(filterID, uniqueID);
    AEffect* effect = MakeEffect(uniqueID);
    if (!effect)
        return nullptr;
    // The members of a shell have names of their own; any other effect is called like its file.
    return new VSTAudioFilter(EncodeFilterID(uniqueID, GetPath()), GetPath(), effect, true, !mIsShell);
}

boost::intrusive_ptr<VSTPluginModule> GetVSTPlugin(const UTF16String& path)
{
    if (const auto known = GetModules().Find(path))
        return known->GetOSModule() || known->Load() ? known : nullptr;
    boost::intrusive_ptr<VSTPluginModule> module(new VSTPluginModule(path));
    if (!module->Load())
        return nullptr;
    GetModules().AddPluginModule(module);
    return module;
}

boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID)
{
    const AudioFilterDescriptorManager& catalogue = AudioFilterDescriptorManager::GetInstance();
    auto descriptor = catalogue.GetComponentDescriptorForID(filterID);
    if (!descriptor)
        descriptor = catalogue.GetComponentDescriptorForID(u"2:" + filterID);
    if (!descriptor)
        return nullptr;
    const UTF16String path = descriptor->GetLocator().GetPath();
    ZEB_TRACE("VST", "CreateAudioFilter(), path:" << UTF16to8(path));
    const auto module = GetVSTPlugin(path);
    if (!module)
        return nullptr;
    const boost::intrusive_ptr<AudioFilter> filter = module->CreateAudioFilter(filterID);
    if (filter)
        filter->SetDisplayName(descriptor->GetName());
    return filter;
}

} // namespace zebaudiofilterhost::vst
