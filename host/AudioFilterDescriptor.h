#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "host/AudioFilterCategory.h"
#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

/// One filter that a plug-in binary, or the application itself, offers. Shared by reference count; the catalogue
/// holds it, and whoever shows a menu of filters may hold it too. All operations: [main]
class ZEB_EXPORT AudioFilterDescriptor : public virtual zebcore::utility::RefCountedObject
{
public:
    /// A filter of a plug-in. Enabled; supports neither mono nor stereo until told so.
    AudioFilterDescriptor(const PluginLocator& locator, const UTF16String& name, const UTF16String& vendor,
                          unsigned int version, AudioFilterCategory category, const UTF16String& id,
                          const Guid& factoryGuid, bool synth);
    /// A built-in filter: technology kTechnologyInternal with an empty path, vendor "Corvane Systems".
    AudioFilterDescriptor(const UTF16String& name, unsigned int version, AudioFilterCategory category,
                          const UTF16String& id, const Guid& factoryGuid, bool synth);
    /// Read from a section that Write made; what is missing there stays empty, enabled stays true.
    explicit AudioFilterDescriptor(const PropList& list);
    ~AudioFilterDescriptor() override;

    AudioFilterDescriptor(const AudioFilterDescriptor&) = delete;
    AudioFilterDescriptor& operator=(const AudioFilterDescriptor&) = delete;

    const PluginLocator& GetLocator() const;
    const UTF16String& GetName() const;
    const UTF16String& GetVendorString() const;
    unsigned int GetVersion() const;
    AudioFilterCategory GetCategory() const;
    /// The filter ID, which is the key of the catalogue.
    const UTF16String& GetUniqueID() const;
    /// Names the function of AudioFilterFactory that makes the filter.
    const Guid& GetFactoryGuid() const;
    bool IsEnabled() const;
    bool IsSynth() const;
    bool GetSupportsMono() const;
    bool GetSupportsStereo() const;
    /// True for kTechnologyInternal and nothing else: kTechnologyNone counts as external.
    bool IsInternal() const;
    /// In the user's language. Empty for kCategoryNone, kCategoryNotQueried and unknown numbers.
    UTF16String GetCategoryName() const;

    void SetEnabled(bool enabled);
    void SetSupportsMono(bool supports);
    void SetSupportsStereo(bool supports);

    /// A missing key keeps the field, but locator, category and factory GUID are always replaced, by empty ones at
    /// need. Reports no error.
    void Read(const PropList& list);
    void Write(PropList& list) const;

private:
    PluginLocator mLocator;
    UTF16String mName;
    UTF16String mVendor;
    unsigned int mVersion = 0;
    AudioFilterCategory mCategory = kCategoryNone;
    UTF16String mUniqueID;
    Guid mFactoryGuid;
    bool mEnabled = true;
    bool mSynth = false;
    bool mSupportsMono = false;
    bool mSupportsStereo = false;
};

/// What boost::intrusive_ptr calls where AudioFilterDescriptor is declared but not defined. [any]
ZEB_EXPORT void intrusive_ptr_add_ref(AudioFilterDescriptor* descriptor);
ZEB_EXPORT void intrusive_ptr_release(AudioFilterDescriptor* descriptor);

} // namespace zebaudiofilterhost
