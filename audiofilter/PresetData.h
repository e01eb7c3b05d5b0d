// A typed view of a preset's section.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "utility/CommonTypes.h"

#include <boost/core/noncopyable.hpp>
#include <boost/signals2/signal.hpp>

#include <list>
#include <vector>

namespace zebaudiofilterhost
{

/// The complete settings of a filter, in one of four forms, as a view of a PropList that the caller keeps alive.
///
/// Getters on a view without a PropList give the defaults, setters do nothing. Held by boost::intrusive_ptr or on the
/// stack. [main]
class ZEB_EXPORT PresetData : public virtual zebcore::utility::RefCountedObject, private boost::noncopyable
{
public:
    enum PresetType : int
    {
        kPresetType_Params = 0,  ///< All parameter values
        kPresetType_Chunk = 1,   ///< Opaque bytes of the plug-in
        kPresetType_Factory = 2, ///< A reference to a preset built into the plug-in
        kPresetType_Custom = 3   ///< A free-form section of the technology
    };

    using PresetChangedSignal = boost::signals2::signal<void(const PresetData&)>;

    static const UTF8String kVersionKey;
    static const UTF8String kTypeKey;
    static const UTF8String kParamListKey;
    static const UTF8String kChunkDataKey;
    static const UTF8String kCustomDataKey;
    static const UTF8String kFactoryPresetKey;
    static const UTF8String kFactoryIndexKey;

    explicit PresetData(PropList& propList);

    /// A view without a PropList: `propList` may be null.
    explicit PresetData(PropList* propList);

    ~PresetData() override;

    /// True without a PropList or with an empty one.
    bool IsEmpty() const;

    /// Empties the section, without a signal.
    void Clear();

    /// Makes this section a copy of the other and signals. Nothing happens if either has no PropList.
    void SetDataFromExistingPreset(const PresetData& other);

    /// The filter's preset format; 0 if missing.
    float GetVersion() const;
    void SetVersion(float version);

    /// kPresetType_Params if missing.
    PresetType GetPresetType() const;
    void SetPresetType(PresetType type);

    /// Normalised values in index order; empty if missing.
    void GetParamList(std::list<float>& params) const;
    void SetParamList(const std::list<float>& params);

    /// False if there is no chunk, or one that can't be decoded.
    bool GetChunkData(std::vector<unsigned char>& chunk) const;
    /// data may be null if size is 0; null with a size changes nothing.
    void SetChunkData(const unsigned char* data, unsigned long size);

    /// The custom section, which both forms create if it is missing. Owned by the PropList; null only without one.
    PropList* GetCustomDataSection();
    const PropList* GetCustomDataSection() const;

    UTF16String GetFactoryPresetName() const;
    void SetFactoryPresetName(const UTF16String& name);

    /// An optimisation beside the name; -1 if missing. Setting it gives no signal, unlike all other setters.
    int GetFactoryIndex() const;
    void SetFactoryIndex(int index);

    /// Fires after a change, with this preset.
    PresetChangedSignal& GetPresetChangedSignal();

    /// The PropList, not owned; may be null.
    PropList* GetRawData() const;

    /// Version, type and the data of that type. False without a PropList. Comparing custom presets creates their
    /// custom sections.
    bool operator==(const PresetData& other) const;

    bool IsParamDataEqual(const PresetData& other) const;
    bool IsChunkDataEqual(const PresetData& other) const;

    /// Compares the names only, never the index.
    bool IsFactoryDataEqual(const PresetData& other) const;

    /// Custom section, parameters and chunk; creates the custom sections if they are missing.
    bool IsCustomDataEqual(const PresetData& other) const;

private:
    template <typename T>
    void Store(const UTF8String& key, const T& value);
    void Signal() const;

    PropList* mPropList; // Not owned; may be null
    PresetChangedSignal mPresetChangedSignal;
};

} // namespace zebaudiofilterhost
