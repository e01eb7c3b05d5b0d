#include "output/Console.h"

#include "output/Strings.h"

#include <algorithm>
#include <cstdlib>

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

namespace zebhost
{

namespace
{

constexpr std::size_t kDefaultWidth = 100;

bool MayColour(int descriptor)
{
    const char* noColour = std::getenv("NO_COLOR");
    const char* terminal = std::getenv("TERM");
    const bool dumb = terminal == nullptr || std::string_view(terminal) == "dumb";
    return isatty(descriptor) == 1 && !dumb && (noColour == nullptr || *noColour == '\0');
}

std::size_t Width(int descriptor)
{
    winsize size{};
    if (ioctl(descriptor, TIOCGWINSZ, &size) == 0 && size.ws_col >= 40)
    {
        return size.ws_col;
    }
    return kDefaultWidth;
}

// A copy of standard output for the data, which no other program inherits, while descriptor 1 becomes standard error.
std::FILE* TakeOutput()
{
    const int data = fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1);
    std::FILE* stream = data < 0 ? nullptr : fdopen(data, "w");
    if (stream == nullptr)
    {
        return stdout;
    }
    dup2(STDERR_FILENO, STDOUT_FILENO);
    return stream;
}

} // namespace

Console::Console()
    : mOutput(nullptr), mErrorTerminal(isatty(STDERR_FILENO) == 1), mOutputColour(MayColour(STDOUT_FILENO))
{
    mOutput = TakeOutput();
}

Console::~Console()
{
    EraseProgress();
    std::fflush(mOutput);
}

void Console::Print(std::string_view text)
{
    EraseProgress();
    std::fwrite(text.data(), 1, text.size(), mOutput);
    mHasPrinted = true;
}

void Console::Remark(std::string_view text)
{
    if (!mQuiet)
    {
        Warn(text);
    }
}

void Console::Warn(std::string_view text)
{
    EraseProgress();
    std::fflush(mOutput);
    const std::string line = InOneLine(std::string(text)) + "\n";
    std::fwrite(line.data(), 1, line.size(), stderr);
}

void Console::ShowProgress(std::string_view text)
{
    if (mQuiet || !mErrorTerminal)
    {
        return;
    }
    const std::size_t room = ErrorWidth() - 1;
    const std::string line = "\r\x1b[K" + std::string(text.substr(0, std::min(text.size(), room)));
    std::fwrite(line.data(), 1, line.size(), stderr);
    std::fflush(stderr);
    mProgressShown = true;
}

bool Console::Flush()
{
    return std::fflush(mOutput) == 0 && std::ferror(mOutput) == 0;
}

std::size_t Console::OutputWidth() const
{
    return Width(OutputDescriptor());
}

std::size_t Console::ErrorWidth() const
{
    return Width(STDERR_FILENO);
}

int Console::OutputDescriptor() const
{
    return fileno(mOutput);
}

void Console::EraseProgress()
{
    if (mProgressShown)
    {
        std::fwrite("\r\x1b[K", 1, 4, stderr);
        mProgressShown = false;
    }
}

} // namespace zebhost
