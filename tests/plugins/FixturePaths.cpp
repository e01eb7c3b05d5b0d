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

std::filesystem::path BinaryOf(const std::filesystem::path& bundle)
{
    return bundle / "Contents" / ZEB_BINARY_FOLDER / (bundle.stem().string() + ".so");
}

} // namespace zebtest
