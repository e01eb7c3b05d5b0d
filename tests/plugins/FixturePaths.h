#pragma once

#include <filesystem>
#include <string_view>

namespace zebtest
{

// Folder of the bundles that misbehave without doing harm: a scan of the whole folder in this process survives.
std::filesystem::path FixtureFolder();

// Folder of the bundles that crash, abort, leave, hang or chatter when loaded: for a process of their own.
std::filesystem::path HazardFolder();

// Folder of the example effects.
std::filesystem::path EffectFolder();

std::filesystem::path FixtureBundle(std::string_view name); // "NullFactory" gives .../NullFactory.vst3
std::filesystem::path HazardBundle(std::string_view name);
std::filesystem::path EffectBundle(std::string_view name);

// The same for VST 2, whose plug-ins are bundles or plain files: "Normal" gives .../Normal.vst if there is one, else
// .../Normal.so.
std::filesystem::path VST2FixtureFolder();
std::filesystem::path VST2HazardFolder();
std::filesystem::path VST2EffectFolder();
std::filesystem::path VST2Fixture(std::string_view name);
std::filesystem::path VST2Hazard(std::string_view name);
std::filesystem::path VST2Effect(std::string_view name);

// The binary inside a bundle, also of the older forms that VST 2 has; a plain file is its own.
std::filesystem::path BinaryOf(const std::filesystem::path& bundle);

} // namespace zebtest
