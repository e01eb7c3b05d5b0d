#pragma once

#include "examples/effects/support/Implements.h"

#include <map>
#include <string>
#include <vector>

namespace zebtest
{

using namespace Steinberg;
using namespace Steinberg::Vst;
using effects::Implements;

// The few host objects that a plug-in needs in order to run without our library.

class DirectAttributes : public Implements<IAttributeList>
{
public:
    tresult PLUGIN_API setInt(AttrID id, int64 value) override;
    tresult PLUGIN_API getInt(AttrID id, int64& value) override;
    tresult PLUGIN_API setFloat(AttrID, double) override { return kNotImplemented; }
    tresult PLUGIN_API getFloat(AttrID, double&) override { return kNotImplemented; }
    tresult PLUGIN_API setString(AttrID, const TChar*) override { return kNotImplemented; }
    tresult PLUGIN_API getString(AttrID, TChar*, uint32) override { return kNotImplemented; }
    tresult PLUGIN_API setBinary(AttrID, const void*, uint32) override { return kNotImplemented; }
    tresult PLUGIN_API getBinary(AttrID, const void*&, uint32&) override { return kNotImplemented; }

private:
    std::map<std::string, int64> mIntegers;
};

class DirectMessage : public Implements<IMessage>
{
public:
    FIDString PLUGIN_API getMessageID() override { return mID.c_str(); }
    void PLUGIN_API setMessageID(FIDString id) override { mID = id; }
    IAttributeList* PLUGIN_API getAttributes() override { return &mAttributes; }

private:
    std::string mID;
    DirectAttributes mAttributes;
};

// Application, component handler, plug frame and run loop in one. It writes down what it is told.
class DirectHost : public Implements<IHostApplication, IComponentHandler, IPlugFrame, Linux::IRunLoop>
{
public:
    tresult PLUGIN_API getName(String128 name) override;
    tresult PLUGIN_API createInstance(TUID classID, TUID interfaceID, void** object) override;
    tresult PLUGIN_API beginEdit(ParamID id) override;
    tresult PLUGIN_API performEdit(ParamID id, ParamValue value) override;
    tresult PLUGIN_API endEdit(ParamID id) override;
    tresult PLUGIN_API restartComponent(int32 flags) override;
    tresult PLUGIN_API resizeView(IPlugView* view, ViewRect* newSize) override;
    tresult PLUGIN_API registerEventHandler(Linux::IEventHandler* handler, Linux::FileDescriptor fd) override;
    tresult PLUGIN_API unregisterEventHandler(Linux::IEventHandler* handler) override;
    tresult PLUGIN_API registerTimer(Linux::ITimerHandler* handler, Linux::TimerInterval milliseconds) override;
    tresult PLUGIN_API unregisterTimer(Linux::ITimerHandler* handler) override;

    std::vector<std::string> told; // "begin 0", "perform 0", "end 0", "restart 8", "resize 480 180"
    double lastValue = -1.0;       // of performEdit
    Linux::IEventHandler* eventHandler = nullptr;
    Linux::ITimerHandler* timerHandler = nullptr;
    Linux::FileDescriptor descriptor = -1;
};

class DirectStream : public Implements<IBStream>
{
public:
    tresult PLUGIN_API read(void* buffer, int32 count, int32* done) override;
    tresult PLUGIN_API write(void* buffer, int32 count, int32* done) override;
    tresult PLUGIN_API seek(int64 position, int32 mode, int64* result) override;
    tresult PLUGIN_API tell(int64* position) override;

    std::string bytes;

private:
    std::size_t mPosition = 0;
};

struct Point
{
    ParamID id;
    int32 offset;
    ParamValue value;
};

class DirectQueue : public Implements<IParamValueQueue>
{
public:
    explicit DirectQueue(ParamID id) : mID(id) {}

    ParamID PLUGIN_API getParameterId() override { return mID; }
    int32 PLUGIN_API getPointCount() override { return static_cast<int32>(points.size()); }
    tresult PLUGIN_API getPoint(int32 index, int32& offset, ParamValue& value) override;
    tresult PLUGIN_API addPoint(int32 offset, ParamValue value, int32& index) override;

    std::vector<Point> points;

private:
    ParamID mID;
};

class DirectChanges : public Implements<IParameterChanges>
{
public:
    int32 PLUGIN_API getParameterCount() override { return static_cast<int32>(mQueues.size()); }
    IParamValueQueue* PLUGIN_API getParameterData(int32 index) override;
    IParamValueQueue* PLUGIN_API addParameterData(const ParamID& id, int32& index) override;

    void Add(const Point& point);
    std::vector<Point> Points() const; // of all parameters

private:
    std::vector<IPtr<DirectQueue>> mQueues;
};

} // namespace zebtest
