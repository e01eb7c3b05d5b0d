#include "tests/plugins/support/Behaviour.h"

#include "tests/plugins/support/Bytes.h"
#include "tests/plugins/support/VendorInterfaces.h"

namespace fixture
{

std::vector<Parameter> Behaviour::CommonParameters()
{
    const auto make = [](ParamID id, const char16_t* title, int32 flags, int32 steps = 0)
    {
        return Parameter{.id = id,
                         .title = title,
                         .units = u"%",
                         .minimum = 0.0,
                         .maximum = steps > 0 ? static_cast<double>(steps) : 100.0,
                         .initial = 0.0,
                         .stepCount = steps,
                         .flags = flags};
    };
    return {make(kAmount, u"Amount", ParameterInfo::kCanAutomate), make(kMeter, u"Meter", ParameterInfo::kIsReadOnly),
            make(kBypass, u"Bypass", ParameterInfo::kCanAutomate | ParameterInfo::kIsBypass, 1),
            make(kProgram, u"Program", ParameterInfo::kIsProgramChange | ParameterInfo::kIsList, 4),
            make(kUnautomated, u"Unautomated", ParameterInfo::kNoFlags)};
}

std::vector<FUID> Behaviour::VendorInterfaces()
{
    return {VendorSpecificComponent::iid, VendorSpecificEffect::iid};
}

const Behaviour& TheBehaviour()
{
    static const Behaviour sBehaviour = []
    {
        Behaviour behaviour;
        Vary(behaviour);
        for (ClassShape& shape : behaviour.classes)
            if (shape.name.empty())
                for (const char letter : std::string_view(kBundleName))
                    shape.name += static_cast<char16_t>(letter);
        return behaviour;
    }();
    return sBehaviour;
}

FUID ComponentID(std::size_t index)
{
    return {0x5A656246, 0x69787475, Hash(kBundleName), static_cast<uint32>(2 * index + 1)};
}

FUID ControllerID(std::size_t index)
{
    return {0x5A656246, 0x69787475, Hash(kBundleName), static_cast<uint32>(2 * index + 2)};
}

} // namespace fixture
