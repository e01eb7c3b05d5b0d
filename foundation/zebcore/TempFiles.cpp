#include "foundation/zebcore/internal/TempFiles.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/FileDescriptor.h"
#include "foundation/zebcore/internal/FileStatus.h"

#include <dirent.h>
#include <fcntl.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <charconv>
#include <csignal>
#include <ctime>
#include <memory>
#include <string>
#include <string_view>

namespace zebcore::filesupport
{

namespace
{

constexpr std::size_t kMaxBaseLength = 200; // in bytes; a name may have 255
constexpr int kMaxAttempts = 1000;
constexpr mode_t kAnyNewFile = 0666; // less what the user masks
constexpr mode_t kForUserAlone = 0600;
constexpr std::time_t kAbandonedAfterSeconds = 60;

// NAME.tmp-PID-COUNT
std::string TempPrefix(const File& target)
{
    return ToNativePath(target.GetName()).substr(0, kMaxBaseLength) + ".tmp-";
}

File InSameDir(const File& target, std::string_view nativeName)
{
    return {target.GetDir(), FromNativePath(nativeName)};
}

// The process that made the file, from its name; 0 if it is no temporary file of the prefix.
pid_t MakerOf(std::string_view name, std::string_view prefix)
{
    if (name.substr(0, prefix.size()) != prefix)
        return 0;
    name.remove_prefix(prefix.size());
    pid_t pid = 0;
    const auto [end, error] = std::from_chars(name.data(), name.data() + name.size(), pid);
    name.remove_prefix(static_cast<std::size_t>(end - name.data()));
    const bool hasCount =
        name.size() > 1 && name.front() == '-' && name.find_first_not_of("0123456789", 1) == std::string_view::npos;
    return error == std::errc() && pid > 0 && hasCount ? pid : 0;
}

// A process of the number may be missing here and run on another machine that shares the folder, so age counts, too.
bool IsAbandoned(const File& file, pid_t maker)
{
    if (kill(maker, 0) == 0 || errno != ESRCH)
        return false;
    const FileStatus status = GetFileStatus(file.FullPath());
    return status.mError == 0 && S_ISREG(status.mStat.st_mode) &&
           status.mStat.st_mtime < std::time(nullptr) - kAbandonedAfterSeconds;
}

void RemoveAbandoned(const File& target)
{
    const std::string prefix = TempPrefix(target);
    const UTF16String folder = target.GetDir().FullPath();
    struct CloseDirectory
    {
        void operator()(DIR* open) const { closedir(open); }
    };
    const std::unique_ptr<DIR, CloseDirectory> open(opendir(folder.empty() ? "." : ToNativePath(folder).c_str()));
    while (const dirent* const entry = open ? readdir(open.get()) : nullptr)
    {
        const pid_t maker = MakerOf(entry->d_name, prefix);
        const File file = InSameDir(target, entry->d_name);
        if (maker != 0 && IsAbandoned(file, maker))
            unlink(ToNativePath(file.FullPath()).c_str());
    }
}

} // namespace

File MakeTempFile(const File& target, bool forUserAlone)
{
    static std::atomic<unsigned int> sCount{0};
    for (int attempt = 0;; ++attempt)
    {
        const std::string name = TempPrefix(target) + std::to_string(getpid()) + '-' + std::to_string(++sCount);
        const File file = InSameDir(target, name);
        try
        {
            const FileDescriptor made(file.FullPath(), O_WRONLY | O_CREAT | O_EXCL,
                                      forUserAlone ? kForUserAlone : kAnyNewFile, "cannot write");
            return file;
        }
        catch (const file_exception& failure)
        {
            // A process of this number that was killed may have left one.
            if (failure.Error() != EEXIST || attempt == kMaxAttempts)
                throw file_exception("cannot save", target.FullPath(), failure.Error());
        }
    }
}

void RemoveAbandonedTempFiles(const File& target) noexcept
{
    try
    {
        RemoveAbandoned(target);
    }
    catch (...)
    {
        // Tidying up must not keep anything from being saved.
    }
}

} // namespace zebcore::filesupport
