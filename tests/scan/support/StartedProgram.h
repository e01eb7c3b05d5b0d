#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include <sys/types.h>

namespace zebtest
{

// A program that runs beside the test, in a process group of its own. Its output goes to files of `scratch`.
class StartedProgram
{
public:
    StartedProgram(const std::vector<std::string>& arguments, const std::map<std::string, std::string>& variables,
                   const std::filesystem::path& scratch);
    // Kills it if it is still there.
    ~StartedProgram();
    StartedProgram(const StartedProgram&) = delete;
    StartedProgram& operator=(const StartedProgram&) = delete;

    pid_t Process() const { return mProcess; }
    void Signal(int signal) const;
    void SignalGroup(int signal) const;
    // The exit code, or the negative number of the signal that ended it.
    int Wait();
    std::string Out() const;
    std::string Err() const;

private:
    pid_t mProcess = -1;
    std::filesystem::path mScratch;
};

// Asks every millisecond; false after a minute.
bool Eventually(const std::function<bool()>& condition);

// A process that is there and no zombie.
bool IsAlive(pid_t process);

} // namespace zebtest
