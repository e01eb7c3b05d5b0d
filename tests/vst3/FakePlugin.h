// A plug-in inside the test: it answers as its fields say and writes down what the host calls, in order.
#pragma once

#include "host/src/VST3/src/PluginPtr.h"
#include "host/src/VST3/src/VST3AudioFilter.h"

#include <pluginterfaces/base/ipluginbase.h>
#include <pluginterfaces/gui/iplugview.h>
#include <pluginterfaces/vst/ivstaudioprocessor.h>
#include <pluginterfaces/vst/ivstcomponent.h>
#include <pluginterfaces/vst/ivsteditcontroller.h>
#include <pluginterfaces/vst/ivstunits.h>

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <vector>

namespace fakeplugin
{

using namespace Steinberg;
using namespace Steinberg::Vst;

enum class FactoryLevel
{
    kOne = 1,
    kTwo,
    kThree
};

enum class ControllerKind
{
    kNone,
    kSame, // the component itself
    kSeparate
};

struct FakeBus
{
    SpeakerArrangement arrangement;
    std::u16string name = {};
    BusType type = kMain;
    tresult infoResult = kResultOk;
    tresult arrangementResult = kResultOk;
};

struct FakeParameter
{
    ParamID id;
    int32 flags = ParameterInfo::kCanAutomate;
    std::u16string title = {};
    std::u16string units = {};
    int32 stepCount = 0;
    UnitID unit = kRootUnitId;
};

struct FakeProgramList
{
    ProgramListID id;
    int32 count;
    std::u16string prefix; // a program is called by it and its number, from 0
};

// The script and the log. Outlives every object made from it. Makes the test's thread the main thread.
class FakePlugin
{
public:
    FakePlugin();
    ~FakePlugin();
    FakePlugin(const FakePlugin&) = delete;
    FakePlugin& operator=(const FakePlugin&) = delete;

    // A suspended filter of this plug-in.
    boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> MakeFilter();

    // With a reference that the caller gives back.
    IPluginFactory* MakeFactory();

    int livingObjects = 0; // components, controllers, views and factories

    // Factory
    tresult factoryInfoResult = kResultOk;
    FactoryLevel level = FactoryLevel::kTwo;
    PClassInfo classInfo;
    PFactoryInfo factoryInfo;
    PClassInfo2 classInfo2;
    PClassInfoW classInfoW;
    int32 classCount = 1;
    bool createsComponent = true;
    bool createsController = true;

    // Component and processor
    tresult initializeResult = kResultOk;
    bool hasProcessor = true;
    bool hasConnections = true;
    std::string vendorName;      // by the vendor-specific interface, empty for none
    int32 vendorNameLength = -1; // what is told instead of the real one
    std::vector<FakeBus> inputs{{SpeakerArr::kStereo}};
    std::vector<FakeBus> outputs{{SpeakerArr::kStereo}};
    int32 audioBusCount = -1; // what is told instead of the real one
    int32 eventInputs = 0;
    int32 eventOutputs = 0;
    tresult setArrangementsResult = kResultOk;
    uint32 latency = 0;
    uint32 tail = 0;
    std::function<tresult(ProcessData&)> process; // empty: kResultOk

    // State
    std::string state;
    tresult getStateResult = kResultOk;
    std::string controllerState;
    tresult getControllerStateResult = kResultOk;

    // Controller
    ControllerKind controllerKind = ControllerKind::kSeparate;
    tresult controllerInitializeResult = kResultOk;
    std::vector<FakeParameter> parameters;
    int32 parameterCount = -1; // what is told instead of the real one
    std::map<ParamID, double> values;
    bool hasUnits = false;
    std::vector<UnitInfo> units;
    std::vector<FakeProgramList> programLists;
    bool hasVendorEffect = false;
    bool dirty = false;

    // View
    bool hasView = false;
    std::vector<std::string> viewTypes;
    tresult attachedResult = kResultOk;
    ViewRect viewSize{0, 0, 400, 300};

    // Run at their time, and may throw.
    std::function<void(const std::string&)> called; // with the text of each call that is written down
    std::function<void()> countingParameters;

    // What the host gave; not owned.
    FUnknown* hostContext = nullptr;
    IComponentHandler* handler = nullptr;
    IPlugFrame* frame = nullptr;

    void Call(const std::string& text);
    std::vector<std::string> Calls() const;
    std::vector<std::string> CallsTo(const std::string& prefix) const;
    void ClearCalls();
    bool recording = true;

private:
    mutable std::mutex mMutex;
    std::vector<std::string> mCalls;
};

} // namespace fakeplugin
