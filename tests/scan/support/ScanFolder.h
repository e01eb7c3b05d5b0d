#pragma once

#include "tests/zebhost/support/Zebhost.h"

#include <set>

#include <sys/types.h>

namespace zebtest
{

// A test with a folder of bundles that do what their names say: see tests/plugins/hazards/ByName.cpp.
class ScanFolder : public ZebhostTest
{
protected:
    ScanFolder();

    // With a copy of the binary: a second link to it would be the same module to the system's loader.
    void AddBundle(const std::string& name) const;
    std::filesystem::path Bundle(const std::string& name) const;
    std::filesystem::path Binary(const std::string& name) const;

    // One line a load, in the order in which they happened.
    struct Load
    {
        pid_t process;
        std::string name;
    };
    std::vector<Load> Loads() const;
    std::map<std::string, int> CountLoads() const;
    void ForgetLoads() const;

    // The names of the bundles that the catalogue's file has a record of.
    std::set<std::string> Records() const;
    // Reasons by name, as 'zebhost blocks' tells them.
    std::map<std::string, std::string> Blocks() const;
    // States by name, of a scan's document.
    static std::map<std::string, std::string> States(const nlohmann::json& document);
    static std::map<std::string, std::string> Reasons(const nlohmann::json& document);

    std::vector<std::string> CommandLine(const std::vector<std::string>& arguments) const;

    const std::filesystem::path mPlugins;
};

// How much longer things take in this build.
double Slowness();
// So many seconds, and longer where things take longer, as an option has them.
std::string Seconds(double seconds);

} // namespace zebtest
