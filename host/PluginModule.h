#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/OSModule.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

/// One plug-in binary in memory: the bundle at a path, loaded or not. Each technology derives its own from it and
/// resolves its entry points there. Also keeps what every plug-in may ask the host for: language and theme. All
/// operations: [main]
class ZEB_EXPORT PluginModule : public virtual zebcore::utility::RefCountedObject
{
public:
    /// Does not touch the disk. Without `ownsModule` the OS module is never released here.
    PluginModule(const UTF16String& path, bool ownsModule);
    ~PluginModule() override;

    PluginModule(const PluginModule&) = delete;
    PluginModule& operator=(const PluginModule&) = delete;

    /// True when the OS module is there, here also from an earlier call; what a technology needs beside it may still
    /// be missing, and its Load is then false. Does not throw here; what a plug-in's entry throws passes through a
    /// technology's.
    virtual bool Load();
    virtual void Unload();

    UTF16String GetPath() const;
    /// Null while not loaded.
    zebcore::utility::OSModuleRef GetOSModule() const;

    /// The language that plug-ins are told, "en_US" until set. To be set before plug-ins load.
    static void SetLocaleIdentifier(const UTF16String& locale);
    /// Valid until the next SetLocaleIdentifier. [any]
    static const char* GetLocaleIdentifier();
    /// The user interface theme that plug-ins are told, empty until set.
    static void SetThemeXML(const UTF8String& theme);
    static const UTF8String& GetThemeXML();

    /// Why the last attempt to load the plug-in at this path failed: a sentence for the user that names the file.
    /// Empty if it succeeded or there was none.
    static UTF16String GetLoadProblem(const UTF16String& path);
    /// What a technology's Load tells of its result; an empty text forgets the path.
    static void SetLoadProblem(const UTF16String& path, const UTF16String& problem);

private:
    UTF16String mPath;
    zebcore::utility::OSModuleRef mOSModule = nullptr;
    bool mOwnsModule;
};

} // namespace zebaudiofilterhost
