#include "host/src/VST3/src/VST3PluginModule.h"

#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleManager.h"
#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3ClassList.h"
#include "host/src/VST3/src/VST3EntryPoints.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <string>
#include <utility>

namespace zebaudiofilterhost::vst3
{

using zebcore::utility::GetFunctionPointerFromModuleImpl;
using zebcore::utility::OSModuleRef;
using zebcore::utility::UTF16to8;

namespace
{

using EntryFunction = bool(PLUGIN_API*)(void* handle);
using ExitFunction = bool(PLUGIN_API*)();
using FactoryFunction = Steinberg::IPluginFactory*(PLUGIN_API*)();

using Modules = PluginModuleManager<boost::intrusive_ptr<VST3PluginModule>>;

Modules& GetModules()
{
    static Modules sVST3PluginManager;
    return sVST3PluginManager;
}

// The bundle's answer, which the load itself ignores; true if it has no entry function.
bool EnterModule(OSModuleRef module)
{
    for (const VST3EntryPoints& names : GetVST3EntryPoints())
    {
        const auto entry = reinterpret_cast<EntryFunction>(GetFunctionPointerFromModuleImpl(module, names.mEntry));
        if (!entry)
            continue;
        ZEB_TRACE("InitPluginModule", "Calling " << names.mEntry);
        return entry(zebcore::utility::GetOSModuleHandle(module));
    }
    return true;
}

void LeaveModule(OSModuleRef module)
{
    for (const VST3EntryPoints& names : GetVST3EntryPoints())
    {
        const auto exit = reinterpret_cast<ExitFunction>(GetFunctionPointerFromModuleImpl(module, names.mExit));
        if (!exit)
            continue;
        ZEB_TRACE("TerminatePluginModule", "Calling " << names.mExit);
        exit();
        return;
    }
}

UTF16String Quoted(const UTF16String& path)
{
    return u"\"" + path + u"\"";
}

UTF16String WithoutDoubledSlashes(UTF16String path)
{
    for (std::size_t place = path.find(u"//"); place != UTF16String::npos; place = path.find(u"//"))
        path.erase(place, 1);
    return path;
}

} // namespace

VST3PluginModule::VST3PluginModule(const UTF16String& path) : PluginModule(path, true)
{
}
VST3PluginModule::~VST3PluginModule() = default;

bool VST3PluginModule::Load()
{
    ZEB_TRACE("VST3PluginModule::Load", "Path:" << UTF16to8(GetPath()));
    if (GetOSModule())
        return false;
    if (!PluginModule::Load())
    {
        SetLoadProblem(GetPath(), zebcore::utility::GetLastOSModuleError());
        return false;
    }
    const bool accepted = EnterModule(GetOSModule());
    const char16_t* problem = TakeFactory();
    if (!problem)
    {
        SetLoadProblem(GetPath(), {});
        return true;
    }
    ZEB_TRACE("VST3PluginModule::Load", "Unloading due to error");
    // The exit function is not called on this road, although the entry function was.
    PluginModule::Unload();
    SetLoadProblem(GetPath(), Quoted(GetPath()) + (accepted ? problem : u" refused to start."));
    return false;
}

// Null, or what is wrong, as the end of a sentence that the path begins.
const char16_t* VST3PluginModule::TakeFactory()
{
    const auto getFactory =
        reinterpret_cast<FactoryFunction>(GetFunctionPointerFromModuleImpl(GetOSModule(), "GetPluginFactory"));
    if (!getFactory)
        return u" is not a VST 3 plug-in: it does not export GetPluginFactory.";
    Steinberg::IPluginFactory* factory = getFactory();
    if (!factory)
        return u" does not work: its GetPluginFactory gives no factory.";
    mFactory = factory;
    return nullptr;
}

void VST3PluginModule::Unload()
{
    ZEB_TRACE("VST3PluginModule::Unload", "Path:" << UTF16to8(GetPath()));
    if (!GetOSModule())
        return;
    // The pointer stays as it is; what uses it asks for the OS module first.
    if (mFactory)
        mFactory->release();
    LeaveModule(GetOSModule());
    PluginModule::Unload();
}

boost::intrusive_ptr<AudioFilter> VST3PluginModule::CreateAudioFilter(const UTF16String& filterID)
{
    return CreateVST3AudioFilter(filterID);
}

Steinberg::IPluginFactory* VST3PluginModule::GetFactory() const
{
    return GetOSModule() ? mFactory : nullptr;
}

boost::intrusive_ptr<VST3AudioFilter> VST3PluginModule::CreateVST3AudioFilter(const UTF16String& filterID)
{
    ZEB_TRACE("VST3PluginModule::CreateAudioFilter",
              "ID: " << UTF16to8(filterID) << ", Path:" << UTF16to8(GetPath()));
    if (!GetFactory())
        return nullptr;
    Steinberg::TUID classID = {};
    DecodeFilterID(filterID, classID);
    Steinberg::PClassInfo info = {};
    if (!FindClass(*GetFactory(), classID, info))
        return nullptr;
    ZEB_TRACE("VST3PluginModule::CreateAudioFilter", "got class info, creating instance");
    boost::intrusive_ptr<VST3AudioFilter> filter(new VST3AudioFilter(GetFactory(), info));
    ZEB_TRACE("VST3PluginModule::CreateAudioFilter", "instance created");
    return filter;
}

boost::intrusive_ptr<VST3PluginModule> GetVST3Plugin(const UTF16String& path)
{
    if (const auto known = GetModules().Find(path))
        return known->GetOSModule() || known->Load() ? known : nullptr;
    const UTF16String cleaned = WithoutDoubledSlashes(path);
    if (!Dir(cleaned).Exists())
    {
        const bool isFile = File(cleaned).Exists();
        PluginModule::SetLoadProblem(
            path, Quoted(path) + (isFile ? u" is a file; a VST 3 plug-in is a folder." : u" does not exist."));
        return nullptr;
    }
    boost::intrusive_ptr<VST3PluginModule> module(new VST3PluginModule(cleaned));
    if (!module->Load())
    {
        PluginModule::SetLoadProblem(path, PluginModule::GetLoadProblem(cleaned));
        return nullptr;
    }
    GetModules().AddPluginModule(module);
    PluginModule::SetLoadProblem(path, {});
    return module;
}

boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID)
{
    const auto descriptor = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(filterID);
    if (!descriptor)
        return nullptr;
    const UTF16String path = descriptor->GetLocator().GetPath();
    ZEB_TRACE("VST3", "CreateAudioFilter(), path:" << UTF16to8(path));
    const auto module = GetVST3Plugin(path);
    return module ? module->CreateAudioFilter(filterID) : nullptr;
}

} // namespace zebaudiofilterhost::vst3
