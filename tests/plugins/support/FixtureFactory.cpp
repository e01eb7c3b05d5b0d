#include "tests/plugins/support/FixtureFactory.h"

#include "tests/plugins/support/FixtureClasses.h"

#include <cstring>

namespace fixture
{

namespace
{

FUnknown* MakeObject(ClassKind kind, bool controller, std::size_t index)
{
    if (controller)
        return (new FixtureController)->AsUnknown();
    return kind == ClassKind::kEffect ? (new FixtureComponent(index))->AsUnknown() : (new FixtureSingle)->AsUnknown();
}

} // namespace

FixtureFactory::FixtureFactory() : PluginFactory(Describe())
{
}

PluginDescription FixtureFactory::Describe()
{
    const Behaviour& behaviour = TheBehaviour();
    PluginDescription description{behaviour.vendor, "", "", u"1.0.0", behaviour.level, {}};
    for (std::size_t i = 0; i < behaviour.classes.size(); ++i)
    {
        const ClassShape& shape = behaviour.classes[i];
        if (shape.kind != ClassKind::kControllerOnly)
            description.classes.push_back({ComponentID(i), kVstAudioEffectClass, shape.name, shape.subCategories,
                                           nullptr, behaviour.classVendor});
        if (shape.kind == ClassKind::kEffect || shape.kind == ClassKind::kControllerOnly)
            description.classes.push_back(
                {ControllerID(i), kVstComponentControllerClass, shape.name, "", nullptr, behaviour.classVendor});
    }
    return description;
}

uint32 PLUGIN_API FixtureFactory::addRef()
{
    if (IsOn(Knob::kRecordFactoryReferences))
        Record("factory.addRef");
    return ++mReferences;
}

uint32 PLUGIN_API FixtureFactory::release()
{
    if (IsOn(Knob::kRecordFactoryReferences))
        Record("factory.release");
    return --mReferences;
}

tresult PLUGIN_API FixtureFactory::getFactoryInfo(PFactoryInfo* info)
{
    Record("factory.getFactoryInfo");
    return IsOn(Knob::kFactoryInfoResult) ? GetInt(Knob::kFactoryInfoResult) : PluginFactory::getFactoryInfo(info);
}

int32 PLUGIN_API FixtureFactory::countClasses()
{
    return GetInt(Knob::kClassCount, PluginFactory::countClasses());
}

tresult PLUGIN_API FixtureFactory::getClassInfo(int32 index, PClassInfo* info)
{
    return index == GetInt(Knob::kFailingClassInfo) ? static_cast<tresult>(kInternalError)
                                                    : PluginFactory::getClassInfo(index, info);
}

tresult PLUGIN_API FixtureFactory::createInstance(FIDString classID, FIDString interfaceID, void** object)
{
    *object = nullptr;
    const auto& classes = TheBehaviour().classes;
    for (std::size_t i = 0; i < classes.size(); ++i)
    {
        const bool controller = std::memcmp(ControllerID(i).toTUID(), classID, sizeof(TUID)) == 0;
        if (!controller && std::memcmp(ComponentID(i).toTUID(), classID, sizeof(TUID)) != 0)
            continue;
        Record("factory.createInstance", controller ? "controller" : "component");
        Happen(TheBehaviour().atCreate);
        if (!controller && IsOn(Knob::kCreateComponentNull))
            return kResultOk;
        const Knob result = controller ? Knob::kCreateControllerResult : Knob::kCreateComponentResult;
        if (IsOn(result))
            return GetInt(result);
        const IPtr<FUnknown> made(MakeObject(classes[i].kind, controller, i), false);
        return made->queryInterface(interfaceID, object);
    }
    return kInvalidArgument;
}

} // namespace fixture
