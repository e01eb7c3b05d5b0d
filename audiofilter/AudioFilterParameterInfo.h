// What a parameter is called and what its values mean.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "utility/CommonTypes.h"

#include <boost/core/noncopyable.hpp>

namespace zebaudiofilterhost
{

/// The unit of a parameter; the values are the application's own. GenericParameterInfo prints 0, 1, 2, 4 and 5 as
/// decimal numbers, 3 as on or off, 6 as an integer and all others as nothing.
enum AudioFilterParameterInfoUnit : int
{
};

/// Describes one parameter of a filter: names, and the way between the normalised value (0 to 1) that travels through
/// AudioFilter::SetParameter and the value that a user reads. Held by boost::intrusive_ptr. [main]
class ZEB_EXPORT AudioFilterParameterInfo : public virtual zebcore::utility::RefCountedObject,
                                            private boost::noncopyable
{
public:
    /// No name, no label, unit 0.
    AudioFilterParameterInfo();

    /// label: the text of the unit, such as "dB".
    AudioFilterParameterInfo(const UTF16String& name, const UTF16String& label, AudioFilterParameterInfoUnit unit);

    ~AudioFilterParameterInfo() override;

    /// From the value that a user reads to the normalised one.
    virtual float ToNormalized(float value) const = 0;

    /// From the normalised value to the one that a user reads.
    virtual float FromNormalized(float normalized) const = 0;

    /// Whether the value may glide between two points; false here.
    virtual bool CanRamp() const;

    /// True here.
    virtual bool CanBeAutomated() const;

    /// Whether GetParameterString prints any value, not the current one alone; true here.
    virtual bool SupportsStringForArbitraryValues() const;

    /// The text of a normalised value, without the label.
    virtual UTF16String GetParameterString(float normalized) const = 0;

    /// Number of steps between the two ends; 0, as here, for a continuous parameter.
    virtual int GetStepCount() const;

    void SetName(const UTF16String& name);
    UTF16String GetName() const;

    void SetLabel(const UTF16String& label);
    UTF16String GetLabel() const;

    /// Whether the application shows the parameter; true at first.
    bool IsExposed() const;
    void SetExposed(bool exposed);

    void SetUnit(AudioFilterParameterInfoUnit unit);
    AudioFilterParameterInfoUnit GetUnit() const;

private:
    UTF16String mName;
    UTF16String mLabel;
    AudioFilterParameterInfoUnit mUnit;
    bool mExposed = true;
};

} // namespace zebaudiofilterhost
