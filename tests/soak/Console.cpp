#include "Console.h"

#include <fcntl.h>
#include <unistd.h>

namespace soak
{

Console::Console(const std::string& log) : mDescriptor(dup(STDOUT_FILENO))
{
    const char* path = log.empty() ? "/dev/null" : log.c_str();
    const int file = open(path, O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    dup2(file, STDOUT_FILENO);
    dup2(file, STDERR_FILENO);
    close(file);
}

Console::~Console()
{
    close(mDescriptor);
}

void Console::Say(const std::string& line) const
{
    const std::string text = line + "\n";
    [[maybe_unused]] const ssize_t written = write(mDescriptor, text.data(), text.size());
}

} // namespace soak
