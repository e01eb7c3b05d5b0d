#include "tests/scan/support/ScanFolder.h"

#include "tests/plugins/FixturePaths.h"

#include <fstream>
#include <regex>
#include <sstream>

namespace zebtest
{

namespace fs = std::filesystem;

ScanFolder::ScanFolder() : mPlugins(mFolder / "plugins")
{
    fs::create_directories(mPlugins);
    SearchIn(mPlugins);
    mVariables["ZEB_TEST_LOG"] = Path("loads");
}

fs::path ScanFolder::Bundle(const std::string& name) const
{
    return mPlugins / (name + ".vst3");
}

fs::path ScanFolder::Binary(const std::string& name) const
{
    return Bundle(name) / "Contents" / BinaryOf(HazardBundle("ByName")).parent_path().filename() / (name + ".so");
}

void ScanFolder::AddBundle(const std::string& name) const
{
    fs::create_directories(Binary(name).parent_path());
    fs::copy_file(BinaryOf(HazardBundle("ByName")), Binary(name));
}

std::vector<ScanFolder::Load> ScanFolder::Loads() const
{
    std::vector<Load> loads;
    std::ifstream log(Path("loads"));
    pid_t process = 0;
    for (std::string path; log >> process && std::getline(log >> std::ws, path);)
    {
        loads.push_back({process, fs::path(path).stem().string()});
    }
    return loads;
}

std::map<std::string, int> ScanFolder::CountLoads() const
{
    std::map<std::string, int> counts;
    for (const Load& load : Loads())
    {
        ++counts[load.name];
    }
    return counts;
}

void ScanFolder::ForgetLoads() const
{
    fs::remove(Path("loads"));
}

std::set<std::string> ScanFolder::Records() const
{
    std::set<std::string> names;
    const std::string text = ReadText(CatalogueFile());
    const std::size_t descriptors = text.find("num_descriptors");
    const std::string records = text.substr(0, descriptors);
    const std::regex locator("/([^/<>]*)\\.vst3<");
    for (std::sregex_iterator each(records.begin(), records.end(), locator); each != std::sregex_iterator(); ++each)
    {
        names.insert((*each)[1]);
    }
    return names;
}

std::map<std::string, std::string> ScanFolder::Blocks() const
{
    std::map<std::string, std::string> reasons;
    const RunResult result = Succeed({"blocks", "--json"});
    EXPECT_EQ(result.err.find("damaged"), std::string::npos) << result.err;
    const nlohmann::json document = result.Json();
    for (const nlohmann::json& block : document.at("blocked"))
    {
        EXPECT_EQ(block.at("since").get<std::string>().size(), std::string("2024-05-31T12:00:00Z").size());
        reasons[fs::path(block.at("path").get<std::string>()).stem()] = block.at("reason");
    }
    return reasons;
}

std::map<std::string, std::string> ScanFolder::States(const nlohmann::json& document)
{
    std::map<std::string, std::string> states;
    for (const nlohmann::json& plugin : document.at("plugins"))
    {
        states[fs::path(plugin.at("path").get<std::string>()).stem()] = plugin.at("state");
    }
    return states;
}

std::map<std::string, std::string> ScanFolder::Reasons(const nlohmann::json& document)
{
    std::map<std::string, std::string> reasons;
    for (const nlohmann::json& plugin : document.at("plugins"))
    {
        reasons[fs::path(plugin.at("path").get<std::string>()).stem()] = plugin.at("reason");
    }
    return reasons;
}

std::vector<std::string> ScanFolder::CommandLine(const std::vector<std::string>& arguments) const
{
    std::vector<std::string> words = {ZEBHOST_PROGRAM, "--settings", Settings().string()};
    words.insert(words.end(), arguments.begin(), arguments.end());
    return words;
}

double Slowness()
{
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
    return 5;
#else
    return 1;
#endif
}

std::string Seconds(double seconds)
{
    std::ostringstream text;
    text << seconds * Slowness();
    return text.str();
}

} // namespace zebtest
