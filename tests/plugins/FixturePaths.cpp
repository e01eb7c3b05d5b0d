#include "tests/plugins/FixturePaths.h"

#include <string>

namespace zebtest
{

namespace
{

std::filesystem::path BundleIn(const std::filesystem::path& folder, std::string_view name)
{
    return folder / (std::string(name) + ".vst3");
}

std::filesystem::path VST2In(const std::filesystem::path& folder, std::string_view name)
{
    const std::filesystem::path bundle = folder / (std::string(name) + ".vst");
    return std::filesystem::exists(bundle) ? bundle : folder / (std::string(name) + ".so");
}

} // namespace

std::filesystem::path FixtureFolder()
{
    return ZEB_FIXTURE_FOLDER;
}

std::filesystem::path HazardFolder()
{
    return ZEB_HAZARD_FOLDER;
}

std::filesystem::path EffectFolder()
{
    return ZEB_EFFECT_FOLDER;
}

std::filesystem::path FixtureBundle(std::string_view name)
{
    return BundleIn(FixtureFolder(), name);
}

std::filesystem::path HazardBundle(std::string_view name)
{
    return BundleIn(HazardFolder(), name);
}

std::filesystem::path EffectBundle(std::string_view name)
{
    return BundleIn(EffectFolder(), name);
}

std::filesystem::path VST2FixtureFolder()
{
    return ZEB_VST2_FIXTURE_FOLDER;
}

std::filesystem::path VST2HazardFolder()
{
    return ZEB_VST2_HAZARD_FOLDER;
}

std::filesystem::path VST2EffectFolder()
{
    return ZEB_VST2_EFFECT_FOLDER;
}

std::filesystem::path VST2Fixture(std::string_view name)
{
    return VST2In(VST2FixtureFolder(), name);
}

std::filesystem::path VST2Hazard(std::string_view name)
{
    return VST2In(VST2HazardFolder(), name);
}

std::filesystem::path VST2Effect(std::string_view name)
{
    return VST2In(VST2EffectFolder(), name);
}

std::filesystem::path BinaryOf(const std::filesystem::path& bundle)
{
    if (!std::filesystem::is_directory(bundle))
        return bundle;
    const std::string title = bundle.stem().string();
    for (const std::string& name : {title + ".so", title + "-vst.so"})
        if (std::filesystem::exists(bundle / name))
            return bundle / name;
    return bundle / "Contents" / ZEB_BINARY_FOLDER / (title + ".so");
}

} // namespace zebtest
