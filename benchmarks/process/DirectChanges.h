#pragma once

#include <pluginterfaces/vst/ivsteditcontroller.h>
#include <pluginterfaces/vst/ivstparameterchanges.h>

#include <array>

namespace zebaudiofilterhost::benchmarks
{

/// Parameter changes with next to no host behind them: as many queues as were added, of one point each. It is also
/// the handler that such a host gives the plug-in, which adds what is edited. Lives longer than the plug-in.
class DirectChanges final : public Steinberg::Vst::IParameterChanges, public Steinberg::Vst::IComponentHandler
{
public:
    DirectChanges() = default;
    ~DirectChanges() = default;
    DirectChanges(const DirectChanges&) = delete;
    DirectChanges& operator=(const DirectChanges&) = delete;

    /// As many as fit into the array.
    void Add(Steinberg::Vst::ParamID id, double value);
    void Clear() { mCount = 0; }

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override { return 1; }
    Steinberg::uint32 PLUGIN_API release() override { return 1; }

    Steinberg::int32 PLUGIN_API getParameterCount() override { return mCount; }
    Steinberg::Vst::IParamValueQueue* PLUGIN_API getParameterData(Steinberg::int32 index) override;
    Steinberg::Vst::IParamValueQueue* PLUGIN_API addParameterData(const Steinberg::Vst::ParamID&,
                                                                  Steinberg::int32&) override
    {
        return nullptr;
    }

    Steinberg::tresult PLUGIN_API beginEdit(Steinberg::Vst::ParamID) override { return Steinberg::kResultOk; }
    Steinberg::tresult PLUGIN_API performEdit(Steinberg::Vst::ParamID id, Steinberg::Vst::ParamValue value) override;
    Steinberg::tresult PLUGIN_API endEdit(Steinberg::Vst::ParamID) override { return Steinberg::kResultOk; }
    Steinberg::tresult PLUGIN_API restartComponent(Steinberg::int32) override { return Steinberg::kResultFalse; }

private:
    class Point final : public Steinberg::Vst::IParamValueQueue
    {
    public:
        ~Point() = default;

        Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID, void** object) override;
        Steinberg::uint32 PLUGIN_API addRef() override { return 1; }
        Steinberg::uint32 PLUGIN_API release() override { return 1; }

        Steinberg::Vst::ParamID PLUGIN_API getParameterId() override { return mID; }
        Steinberg::int32 PLUGIN_API getPointCount() override { return 1; }
        Steinberg::tresult PLUGIN_API getPoint(Steinberg::int32 index, Steinberg::int32& offset,
                                               Steinberg::Vst::ParamValue& value) override;
        Steinberg::tresult PLUGIN_API addPoint(Steinberg::int32, Steinberg::Vst::ParamValue,
                                               Steinberg::int32&) override
        {
            return Steinberg::kResultFalse;
        }

        Steinberg::Vst::ParamID mID = 0;
        double mValue = 0.0;
    };

    std::array<Point, 64> mPoints;
    Steinberg::int32 mCount = 0;
};

} // namespace zebaudiofilterhost::benchmarks
