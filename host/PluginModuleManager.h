#pragma once

#include "utility/CommonTypes.h"

#include <map>
#include <utility>

namespace zebaudiofilterhost
{

/// Gives a technology at most one module object for each path. T is a boost::intrusive_ptr to the technology's module
/// class. The key is the path as it stands: unlike PluginLocator it never ignores case. Its references go at process
/// exit. All operations: [main]
template <class T>
class PluginModuleManager
{
public:
    /// The first module of a path stays.
    void AddPluginModule(T module)
    {
        UTF16String path = module->GetPath();
        mModules.emplace(std::move(path), std::move(module));
    }

    /// The module of the path, loaded or not; null if there is none.
    T Find(const UTF16String& path) const
    {
        const auto found = mModules.find(path);
        return found == mModules.end() ? T() : found->second;
    }

private:
    std::map<UTF16String, T> mModules;
};

} // namespace zebaudiofilterhost
