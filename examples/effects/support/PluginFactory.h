#pragma once

#include "examples/effects/support/Vst3.h"

#include <string>
#include <vector>

namespace effects
{

// How much a factory tells about its classes. A host asks for the richest interface first.
enum class FactoryLevel
{
    kNamesOnly,     // IPluginFactory: category and name
    kSubCategories, // IPluginFactory2: also vendor, version, sub-categories, in 8-bit text
    kUnicode        // IPluginFactory3: the same in UTF-16
};

// A new object of a class made with Implements<...>.
template <class Class>
FUnknown* Make()
{
    return (new Class)->AsUnknown();
}

struct ClassDescription
{
    FUID id;
    std::string category; // kVstAudioEffectClass or kVstComponentControllerClass
    std::u16string name;
    std::string subCategories;  // such as "Fx|Delay"
    FUnknown* (*create)();      // a new object with one reference
    std::u16string vendor = {}; // empty: the bundle's
};

struct PluginDescription
{
    std::u16string vendor;
    std::string url;
    std::string email;
    std::u16string version;
    FactoryLevel level;
    std::vector<ClassDescription> classes;
};

// Written by each bundle.
PluginDescription DescribePlugin();

// The one object that a host gets from a bundle; everything else is made through it.
class PluginFactory : public IPluginFactory3
{
public:
    explicit PluginFactory(PluginDescription description) : mDescription(std::move(description)) {}
    virtual ~PluginFactory() = default;

    tresult PLUGIN_API queryInterface(const TUID id, void** object) override;
    uint32 PLUGIN_API addRef() override { return 1; } // lives as long as the bundle is loaded
    uint32 PLUGIN_API release() override { return 1; }

    tresult PLUGIN_API getFactoryInfo(PFactoryInfo* info) override;
    int32 PLUGIN_API countClasses() override { return static_cast<int32>(mDescription.classes.size()); }
    tresult PLUGIN_API getClassInfo(int32 index, PClassInfo* info) override;
    tresult PLUGIN_API getClassInfo2(int32 index, PClassInfo2* info) override;
    tresult PLUGIN_API getClassInfoUnicode(int32 index, PClassInfoW* info) override;
    tresult PLUGIN_API setHostContext(FUnknown*) override { return kNotImplemented; }
    tresult PLUGIN_API createInstance(FIDString classID, FIDString interfaceID, void** object) override;

    const PluginDescription& Description() const { return mDescription; }

private:
    const ClassDescription* At(int32 index) const;
    const std::u16string& VendorOf(const ClassDescription& description) const;

    PluginDescription mDescription;
};

} // namespace effects
