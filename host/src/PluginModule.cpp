#include "host/PluginModule.h"

#include "foundation/zebcore/StringConversion.h"

#include <map>
#include <string>

namespace zebaudiofilterhost
{

namespace
{

// Function-local, so that a static initializer of the application may set them.
std::string& Locale()
{
    static std::string sLocale = "en_US";
    return sLocale;
}

UTF8String& ThemeXML()
{
    static UTF8String sThemeXML;
    return sThemeXML;
}

std::map<UTF16String, UTF16String>& LoadProblems()
{
    static std::map<UTF16String, UTF16String> sLoadProblems;
    return sLoadProblems;
}

} // namespace

PluginModule::PluginModule(const UTF16String& path, bool ownsModule) : mPath(path), mOwnsModule(ownsModule)
{
}

PluginModule::~PluginModule()
{
    // The derived layer is gone: only the OS module is released, no exit point of the plug-in runs.
    PluginModule::Unload();
}

bool PluginModule::Load()
{
    if (mOSModule == nullptr)
    {
        mOSModule = zebcore::utility::LoadOSModule(mPath);
    }
    return mOSModule != nullptr;
}

void PluginModule::Unload()
{
    if (mOwnsModule && mOSModule != nullptr)
    {
        zebcore::utility::ReleaseOSModule(mOSModule);
        mOSModule = nullptr;
    }
}

UTF16String PluginModule::GetPath() const
{
    return mPath;
}

zebcore::utility::OSModuleRef PluginModule::GetOSModule() const
{
    return mOSModule;
}

void PluginModule::SetLocaleIdentifier(const UTF16String& locale)
{
    Locale() = zebcore::utility::NarrowFromUTF16(locale);
}

const char* PluginModule::GetLocaleIdentifier()
{
    return Locale().c_str();
}

void PluginModule::SetThemeXML(const UTF8String& theme)
{
    ThemeXML() = theme;
}

const UTF8String& PluginModule::GetThemeXML()
{
    return ThemeXML();
}

UTF16String PluginModule::GetLoadProblem(const UTF16String& path)
{
    const auto found = LoadProblems().find(path);
    return found == LoadProblems().end() ? UTF16String() : found->second;
}

void PluginModule::SetLoadProblem(const UTF16String& path, const UTF16String& problem)
{
    if (problem.empty())
    {
        LoadProblems().erase(path);
    }
    else
    {
        LoadProblems().insert_or_assign(path, problem);
    }
}

} // namespace zebaudiofilterhost
