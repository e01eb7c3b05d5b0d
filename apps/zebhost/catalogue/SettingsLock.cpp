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

int OpenFolder(const std::filesystem::path& folder)
{
    return open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
}

} // namespace

SettingsLock::SettingsLock(const std::filesystem::path& folder) : mFolder(-1)
{
    std::error_code failsAgainOnSaving;
    std::filesystem::create_directories(folder, failsAgainOnSaving);
    mFolder = OpenFolder(folder);
    if (mFolder >= 0 && !Lock(mFolder))
    {
        close(mFolder);
        throw Failure(ExitCode::JobFailed, "another scan is at work in " + folder.string() +
                                               ": wait for its end, or name another folder with --settings");
    }
}

std::unique_ptr<SettingsLock> SettingsLock::IfFree(const std::filesystem::path& folder)
{
    std::unique_ptr<SettingsLock> lock(new SettingsLock(OpenFolder(folder)));
    const bool isHeld = lock->mFolder >= 0 && flock(lock->mFolder, LOCK_EX | LOCK_NB) == 0;
    return isHeld ? std::move(lock) : nullptr;
}

SettingsLock::~SettingsLock()
{
    if (mFolder >= 0)
    {
        close(mFolder);
    }
}

} // namespace zebhost
