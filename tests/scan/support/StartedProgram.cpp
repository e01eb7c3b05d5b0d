#include "tests/scan/support/StartedProgram.h"

#include "tests/zebhost/support/Zebhost.h"

#include <chrono>
#include <csignal>
#include <thread>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace zebtest
{

namespace
{

constexpr const char* kOut = ".started-out";
constexpr const char* kErr = ".started-err";

void Redirect(const std::filesystem::path& file, int descriptor)
{
    const int opened = open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
    dup2(opened, descriptor);
    close(opened);
}

[[noreturn]] void Become(std::vector<std::string> words, const std::map<std::string, std::string>& variables,
                         const std::filesystem::path& scratch)
{
    setpgid(0, 0);
    Redirect(scratch / kOut, STDOUT_FILENO);
    Redirect(scratch / kErr, STDERR_FILENO);
    for (const auto& [name, value] : variables)
    {
        value.empty() ? unsetenv(name.c_str()) : setenv(name.c_str(), value.c_str(), 1);
    }
    std::vector<char*> pointers;
    for (std::string& word : words)
    {
        pointers.push_back(word.data());
    }
    pointers.push_back(nullptr);
    execv(pointers.front(), pointers.data());
    _exit(127);
}

} // namespace

StartedProgram::StartedProgram(const std::vector<std::string>& arguments,
                               const std::map<std::string, std::string>& variables,
                               const std::filesystem::path& scratch)
    : mProcess(fork()), mScratch(scratch)
{
    if (mProcess == 0)
    {
        Become(arguments, variables, scratch);
    }
    setpgid(mProcess, mProcess);
}

StartedProgram::~StartedProgram()
{
    if (mProcess > 0)
    {
        SignalGroup(SIGKILL);
        Wait();
    }
}

void StartedProgram::Signal(int signal) const
{
    kill(mProcess, signal);
}

void StartedProgram::SignalGroup(int signal) const
{
    kill(-mProcess, signal);
}

int StartedProgram::Wait()
{
    int status = 0;
    waitpid(mProcess, &status, 0);
    mProcess = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

std::string StartedProgram::Out() const
{
    return ReadText(mScratch / kOut);
}

std::string StartedProgram::Err() const
{
    return ReadText(mScratch / kErr);
}

bool Eventually(const std::function<bool()>& condition)
{
    const auto end = std::chrono::steady_clock::now() + std::chrono::minutes(1);
    while (!condition())
    {
        if (std::chrono::steady_clock::now() > end)
        {
            return false;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
}

bool IsAlive(pid_t process)
{
    const std::string status = ReadText("/proc/" + std::to_string(process) + "/stat");
    const std::size_t end = status.rfind(')');
    return end != std::string::npos && status.size() > end + 2 && status[end + 2] != 'Z';
}

} // namespace zebtest
