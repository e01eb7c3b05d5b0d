#include "catalogue/SettingsLock.h"

#include "cli/Failure.h"

#include <cerrno>
#include <chrono>
#include <thread>

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

namespace zebhost
{

namespace
{

// A program that was killed lets go a while after.
bool Lock(int folder)
{
    constexpr int kTries = 100;
    constexpr std::chrono::milliseconds kPause{10};
    for (int count = 0; flock(folder, LOCK_EX | LOCK_NB) != 0; ++count)
    {
        if (errno != EWOULDBLOCK && errno != EINTR)
        {
            return true;
        }
        if (count == kTries)
        {
            return false;
        }
        std::this_thread::sleep_for(kPause);
    }
    return true;
}

} // namespace

SettingsLock::SettingsLock(const std::filesystem::path& folder) : mFolder(-1)
{
    std::error_code failsAgainOnSaving;
    std::filesystem::create_directories(folder, failsAgainOnSaving);
    mFolder = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (mFolder >= 0 && !Lock(mFolder))
    {
        close(mFolder);
        throw Failure(ExitCode::JobFailed, "another scan is at work in " + folder.string() +
                                               ": wait for its end, or name another folder with --settings");
    }
}

SettingsLock::~SettingsLock()
{
    if (mFolder >= 0)
    {
        close(mFolder);
    }
}

} // namespace zebhost
