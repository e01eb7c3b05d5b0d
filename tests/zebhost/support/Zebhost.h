#pragma once

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace zebtest
{

// What came of a run of a program.
struct RunResult
{
    int code = -1; // -1 after a signal
    std::string out;
    std::string err;

    // What a user reads last.
    std::string LastLine() const;
    nlohmann::json Json() const;
};

// Runs a program to its end. Variables are added to the environment; those with an empty value are taken out of it.
RunResult RunProgram(const std::vector<std::string>& arguments, const std::map<std::string, std::string>& variables,
                     const std::filesystem::path& scratch);

// A test with a folder of its own for settings and files, in which the standard plug-in folder is that of the example
// effects.
class ZebhostTest : public testing::Test
{
protected:
    ZebhostTest();
    ~ZebhostTest() override;

    // With --settings of this test in front.
    RunResult Run(const std::vector<std::string>& arguments) const;
    // As a user does who stands in the test's folder.
    RunResult RunInFolder(const std::vector<std::string>& arguments) const;
    // Runs it, and fails the test unless it succeeds.
    RunResult Succeed(const std::vector<std::string>& arguments) const;
    // Makes `folder` the standard plug-in folder.
    void SearchIn(const std::filesystem::path& folder);

    std::string Path(const std::string& name) const { return (mFolder / name).string(); }
    std::filesystem::path Settings() const { return mFolder / "settings"; }
    std::filesystem::path CatalogueFile() const { return Settings() / "AudioPluginManagerSettings.xml"; }
    // The names of what lies in the test's folder but for the settings.
    std::vector<std::string> Files() const;

    std::filesystem::path mFolder;
    std::map<std::string, std::string> mVariables;
};

std::string ReadText(const std::filesystem::path& file);
void WriteText(const std::filesystem::path& file, const std::string& text);

} // namespace zebtest
