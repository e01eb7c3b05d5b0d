#pragma once

#include "utility/CommonTypes.h"

#include <AudioToolbox/AudioToolbox.h>

#include <string>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// A parameter of a unit as a view shows it: a name, a control that fits it, its value as text. [main]
class ParameterRow
{
public:
    enum class Control
    {
        Slider,
        Steps, // one of whole numbers, named by the unit
        Switch,
        Level, // of what is only to be watched
        None   // the same, where the text says all
    };

    ParameterRow(AudioUnit unit, AudioUnitScope scope, AudioUnitParameterID id);

    const std::string& GetName() const { return mName; }
    Control GetControl() const { return mControl; }
    bool IsWritable() const { return mControl != Control::Level && mControl != Control::None; }
    /// Not to be changed while sound is rendered.
    bool IsNonRealTime() const { return mIsNonRealTime; }
    /// Names of the steps; their values where the unit has no names. Empty if there are too many to be named.
    const std::vector<std::string>& GetStepNames() const { return mStepNames; }

    /// The unit's present value, from 0 to 1 of the range.
    double GetPosition() const { return mPosition; }
    /// The step of the present value, from 0.
    std::size_t GetStep() const;
    /// The unit's text for the present value, or the name of its step, with the unit of measure.
    const std::string& GetText() const { return mText; }

    /// Reads value and text. Returns whether something has changed.
    bool Refresh();

    /// Sets the unit's value, rounded to a step where there are any, and tells listeners.
    void SetPosition(double position);
    /// To the value that the unit calls its own.
    void SetDefault();
    void Notify(AudioUnitEventType gesture) const;

    AudioUnitParameter GetParameter() const { return {mUnit, mID, mScope, 0}; }

private:
    void ReadSteps();
    std::string ReadText(AudioUnitParameterValue value) const;
    std::string MakeText(double value) const;
    void SetValue(double value);

    AudioUnit mUnit;
    AudioUnitScope mScope;
    AudioUnitParameterID mID;
    std::string mName;
    std::string mLabel;
    Control mControl = Control::Slider;
    std::vector<std::string> mStepNames;
    bool mIsSwitch = false;
    bool mIsStepped = false;
    bool mIsNonRealTime = false;
    double mMinimum = 0.0;
    double mMaximum = 1.0;
    double mDefault = 0.0;
    double mPosition = 0.0;
    std::string mText;
};

/// A unit's text as it can be drawn: in one line, of some length at most, and without what is no character. [any]
std::string ToShownText(const UTF16String& text);

/// All global parameters, in the unit's order. [main]
std::vector<AudioUnitParameterID> ReadParameterIDs(AudioUnit unit);

} // namespace zebaudiofilterhost::xau
