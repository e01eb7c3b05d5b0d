#include "tests/zebhost/support/Zebhost.h"

#include "tests/plugins/FixturePaths.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <sstream>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace zebtest
{

namespace fs = std::filesystem;

namespace
{

std::vector<std::string> Environment(const std::map<std::string, std::string>& variables)
{
    std::vector<std::string> all;
    for (char** each = environ; *each != nullptr; ++each)
    {
        const std::string entry = *each;
        if (variables.find(entry.substr(0, entry.find('='))) == variables.end())
        {
            all.push_back(entry);
        }
    }
    for (const auto& [name, value] : variables)
    {
        if (!value.empty())
        {
            all.push_back(name + "=" + value);
        }
    }
    return all;
}

std::vector<char*> Pointers(std::vector<std::string>& texts)
{
    std::vector<char*> pointers;
    for (std::string& text : texts)
    {
        pointers.push_back(text.data());
    }
    pointers.push_back(nullptr);
    return pointers;
}

int Wait(pid_t process)
{
    int status = 0;
    waitpid(process, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

} // namespace

std::string RunResult::LastLine() const
{
    const std::string text = err.substr(0, err.find_last_not_of('\n') + 1);
    const std::size_t start = text.find_last_of('\n');
    return start == std::string::npos ? text : text.substr(start + 1);
}

nlohmann::json RunResult::Json() const
{
    nlohmann::json document = nlohmann::json::parse(out, nullptr, false);
    EXPECT_FALSE(document.is_discarded()) << "no JSON: " << out << err;
    return document.is_discarded() ? nlohmann::json::object() : document;
}

RunResult RunProgram(const std::vector<std::string>& arguments, const std::map<std::string, std::string>& variables,
                     const fs::path& scratch)
{
    const std::string outFile = (scratch / ".stdout").string();
    const std::string errFile = (scratch / ".stderr").string();
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, outFile.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, errFile.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
    std::vector<std::string> words = arguments;
    std::vector<std::string> environment = Environment(variables);
    pid_t process = 0;
    RunResult result;
    if (posix_spawnp(&process, words.front().c_str(), &actions, nullptr, Pointers(words).data(),
                     Pointers(environment).data()) == 0)
    {
        result.code = Wait(process);
        result.out = ReadText(outFile);
        result.err = ReadText(errFile);
    }
    posix_spawn_file_actions_destroy(&actions);
    fs::remove(outFile);
    fs::remove(errFile);
    return result;
}

ZebhostTest::ZebhostTest()
{
    std::string name = (fs::temp_directory_path() / "zebhost-test-XXXXXX").string();
    mFolder = mkdtemp(name.data());
    mVariables = {{"HOME", mFolder.string()},
                  {"XDG_CONFIG_HOME", ""},
                  {"NO_COLOR", "1"},
                  {"VST_PATH", (mFolder / "none").string()}};
    SearchIn(EffectFolder());
}

ZebhostTest::~ZebhostTest()
{
    std::error_code error;
    fs::remove_all(mFolder, error);
}

void ZebhostTest::SearchIn(const fs::path& folder)
{
    mVariables["VST3_PATH"] = folder.string();
}

RunResult ZebhostTest::Run(const std::vector<std::string>& arguments) const
{
    std::vector<std::string> words = {ZEBHOST_PROGRAM, "--settings", Settings().string()};
    words.insert(words.end(), arguments.begin(), arguments.end());
    return RunProgram(words, mVariables, mFolder);
}

RunResult ZebhostTest::RunInFolder(const std::vector<std::string>& arguments) const
{
    std::vector<std::string> words = {"sh", "-c", R"(cd "$0" && exec "$@")", mFolder.string(), ZEBHOST_PROGRAM};
    words.insert(words.end(), arguments.begin(), arguments.end());
    return RunProgram(words, mVariables, mFolder);
}

RunResult ZebhostTest::Succeed(const std::vector<std::string>& arguments) const
{
    RunResult result = Run(arguments);
    EXPECT_EQ(result.code, 0) << testing::PrintToString(arguments) << "\n" << result.err;
    return result;
}

std::vector<std::string> ZebhostTest::Files() const
{
    std::vector<std::string> names;
    for (const fs::directory_entry& entry : fs::directory_iterator(mFolder))
    {
        if (entry.path().filename() != "settings")
        {
            names.push_back(entry.path().filename().string());
        }
    }
    std::sort(names.begin(), names.end());
    return names;
}

std::string ReadText(const fs::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    std::ostringstream text;
    text << stream.rdbuf();
    return text.str();
}

void WriteText(const fs::path& file, const std::string& text)
{
    fs::create_directories(file.parent_path());
    std::ofstream(file, std::ios::binary) << text;
}

} // namespace zebtest
