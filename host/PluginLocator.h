#pragma once

#include "foundation/zebcore/Export.h"
#include "host/TechnologyType.h"
#include "utility/CommonTypes.h"

#include <cstddef>

namespace zebaudiofilterhost
{

class PluginModuleRecords;

/// Where one plug-in binary lives: which technology, which path. A value; settings files hold it as text. All
/// operations: [any]
class ZEB_EXPORT PluginLocator
{
public:
    /// Type kTechnologyNone, empty path.
    PluginLocator();
    /// `path` is the plug-in's bundle for VST 2 and VST 3, a component's encoded ID for Audio Unit, and empty for a
    /// built-in filter.
    PluginLocator(TechnologyType type, const UTF16String& path);
    PluginLocator(const PluginLocator& other);
    /// Leaves the target as it was when copying throws.
    PluginLocator& operator=(const PluginLocator& other);
    ~PluginLocator();

    void Swap(PluginLocator& other) noexcept;

    /// By technology number, then by the file system's rule for names: where case is ignored, two paths that differ
    /// in case only are one locator.
    bool operator<(const PluginLocator& other) const;
    bool operator==(const PluginLocator& other) const;
    bool operator!=(const PluginLocator& other) const;

    TechnologyType GetTechnologyType() const;
    UTF16String GetPath() const;

    /// The technology number, ":", the path.
    UTF16String ToString() const;
    /// Overwrites the object. Without a colon in the text it becomes a default locator; a number that is none, or
    /// does not fit 32 bits, gives kTechnologyNone and keeps the path. Any other number is taken as it stands.
    void FromString(const UTF16String& text);

    /// Equal for equal locators. [any]
    friend ZEB_EXPORT std::size_t hash_value(const PluginLocator& locator);

private:
    friend class PluginModuleRecords; // compares the path where it lies, for a copy costs more than the look-up

    TechnologyType mType = kTechnologyNone;
    UTF16String mPath;
};

} // namespace zebaudiofilterhost
