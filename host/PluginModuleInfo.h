#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "host/PluginLocator.h"
#include "host/TechnologyType.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

/// The catalogue's record of one plug-in binary: that it was scanned, how it is called, whether the user has it
/// enabled. Shared by reference count. All operations: [main]
class ZEB_EXPORT PluginModuleInfo : public virtual zebcore::utility::RefCountedObject
{
public:
    /// HasAnyNonSynthEffect starts false; the scan sets it.
    PluginModuleInfo(const PluginLocator& locator, const UTF16String& name, const UTF16String& vendor,
                     unsigned int version, TechnologyType type, bool enabled, bool isShell);
    /// Read from a section that Write made. Without a key, enabled is false and HasAnyNonSynthEffect true.
    explicit PluginModuleInfo(const PropList& list);
    ~PluginModuleInfo() override;

    PluginModuleInfo(const PluginModuleInfo&) = delete;
    PluginModuleInfo& operator=(const PluginModuleInfo&) = delete;

    /// The key of the record.
    const PluginLocator& GetLocator() const;
    const UTF16String& GetName() const;
    const UTF16String& GetVendor() const;
    unsigned int GetVersion() const;
    TechnologyType GetType() const;
    bool IsEnabled() const;
    /// A VST 2 shell, or a VST 3 module of more than one class.
    bool IsShell() const;
    /// At least one filter of the binary is an effect.
    bool HasAnyNonSynthEffect() const;

    void SetEnabled(bool enabled);
    void SetHasAnyNonSynthEffect(bool hasAny);

    /// A missing key keeps the field, but locator and type are always replaced, by empty ones at need.
    void Read(const PropList& list);
    void Write(PropList& list) const;

private:
    PluginLocator mLocator;
    UTF16String mName;
    UTF16String mVendor;
    unsigned int mVersion = 0;
    TechnologyType mType = kTechnologyNone;
    bool mEnabled = false;
    bool mIsShell = false;
    bool mHasAnyNonSynthEffect = true; // settings written before this flag existed count as effects
};

} // namespace zebaudiofilterhost
