// A list of named presets.
#pragma once

#include "audiofilter/PresetData.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <set>

namespace zebaudiofilterhost
{

/// A view of a PropList, kept alive by the caller, whose sub-lists are named presets. [main]
class ZEB_EXPORT PresetList : public virtual zebcore::utility::RefCountedObject, private boost::noncopyable
{
public:
    using PresetListChangedSignal = boost::signals2::signal<void(const PresetList&)>;

    explicit PresetList(PropList& propList);

    /// A view without a PropList: `propList` may be null.
    explicit PresetList(PropList* propList);

    ~PresetList() override;

    /// Removes all presets and signals.
    void Clear();

    /// Replaces the set's content by the names.
    void GetPresetNames(std::set<UTF16String>& names) const;

    /// A view of the preset; null if there is none of that name.
    boost::intrusive_ptr<PresetData> GetPreset(const UTF16String& name) const;

    /// Adds an empty preset, signals and returns it; null without a PropList or if the name is taken.
    boost::intrusive_ptr<PresetData> AppendPreset(const UTF16String& name);

    /// Removes the preset, if there is one, and signals in any case.
    void RemovePreset(const UTF16String& name);

    /// Fires after a change, with this list.
    PresetListChangedSignal& GetPresetListChangedSignal();

private:
    PropList* mPropList; // Not owned; may be null
    PresetListChangedSignal mPresetListChangedSignal;
};

/// Prints the presets of a list as source text, for a plug-in's factory table, to the debug output. Prints nothing
/// for a null list or one without a preset of parameter values. [main]
ZEB_EXPORT void FormatFactoryPresetList(const boost::intrusive_ptr<PresetList>& list);

} // namespace zebaudiofilterhost
