// Does what the name of its file says: behind the last dash stands one of the words below, and without one, or with
// the variable ZEB_TEST_CALM set, it behaves. So one binary, copied under many names, makes a folder of
// plug-ins, each with class IDs of its own. When it is loaded it appends its process and its path to the file that
// ZEB_TEST_LOG names.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>

#include <dlfcn.h>
#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <unistd.h>

namespace fixture
{

namespace
{

std::string OwnPath()
{
    Dl_info info{};
    static const char sInside = 0;
    return dladdr(&sInside, &info) != 0 ? info.dli_fname : "";
}

std::string Stem(const std::string& path)
{
    const std::string name = path.substr(path.rfind('/') + 1);
    return name.substr(0, name.rfind('.'));
}

void Chatter(long lines)
{
    for (long line = 0; lines < 0 || line < lines; ++line)
    {
        std::fputs("chatter on the output\n", stdout);
        std::fputs("chatter on the error output\n", stderr);
    }
}

[[noreturn]] void Hang()
{
    for (;;)
        pause();
}

// Leaves a process behind that would live on.
void SpawnAndHang()
{
    const pid_t child = fork();
    if (child == 0)
        Hang();
    std::fprintf(stderr, "child %d\n", static_cast<int>(child));
    if (const char* log = std::getenv("ZEB_TEST_LOG"))
    {
        std::FILE* file = std::fopen(log, "a");
        std::fprintf(file, "%d child\n", static_cast<int>(child));
        std::fclose(file);
    }
    Hang();
}

// What is sent to its process group does not reach it any more.
void LeaveAndHang()
{
    if (setpgid(0, getpgid(getppid())) == 0)
        Hang();
}

// The scanner's own descriptor.
constexpr int kChannel = 200;

// The process ends when it waits for more to do.
void GoDeaf()
{
    shutdown(kChannel, SHUT_RD);
}

void CloseAll()
{
    for (int descriptor = 3; descriptor < 256; ++descriptor)
        close(descriptor);
}

// Closes what it did not open, and has files of its own there from then on.
void ReuseAll()
{
    CloseAll();
    const std::string path = std::string(std::getenv("ZEB_TEST_LOG")) + ".reused";
    for (int descriptor = 0; descriptor < kChannel;)
        descriptor = open(path.c_str(), O_RDWR | O_APPEND | O_CREAT, 0600);
}

// The scan can't start another process, for want of descriptors.
void StarveAndGoDeaf()
{
    constexpr rlimit kFew{16, 16}; // files can be saved with so many
    prlimit(getppid(), RLIMIT_NOFILE, &kFew, nullptr);
    GoDeaf();
}

using Deed = void (*)();

const std::map<std::string, Deed>& Deeds()
{
    static const std::map<std::string, Deed> sDeeds = {
        {"segv",
         []
         {
             raise(SIGSEGV);
         }},
        {"abort",
         []
         {
             std::abort();
         }},
        {"hang",
         []
         {
             Hang();
         }},
        {"chatter",
         []
         {
             Chatter(-1);
         }},
        {"prints",
         []
         {
             Chatter(50000);
         }},
        {"exit",
         []
         {
             std::_Exit(3);
         }},
        {"words",
         []
         {
             std::puts("these are my last words");
             std::abort();
         }},
        {"spawn",
         []
         {
             SpawnAndHang();
         }},
        {"closes",
         []
         {
             CloseAll();
             Hang();
         }},
        {"reuses",
         []
         {
             ReuseAll();
         }},
        {"writes",
         []
         {
             static_cast<void>(!write(kChannel, "nonsense\n", 9));
             Hang();
         }},
        // What a crash of it would write could be read.
        {"dumpable",
         []
         {
             if (prctl(PR_GET_DUMPABLE) != 0)
                 std::abort();
         }},
        {"colours",
         []
         {
             std::fputs("red \x1B[31m and\ttabs\n", stderr);
         }},
        // Ends its process only when that waits for more to do.
        {"deaf",
         []
         {
             GoDeaf();
         }},
        {"starve",
         []
         {
             StarveAndGoDeaf();
         }},
        {"leave",
         []
         {
             LeaveAndHang();
         }},
    };
    return sDeeds;
}

const char* LogAndName()
{
    static const std::string sName = Stem(OwnPath());
    if (const char* log = std::getenv("ZEB_TEST_LOG"))
    {
        const std::string line = std::to_string(getpid()) + " " + OwnPath() + "\n";
        const int file = open(log, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0600);
        static_cast<void>(!write(file, line.data(), line.size()));
        close(file);
    }
    return sName.c_str();
}

} // namespace

extern const char* const kBundleName;
const char* const kBundleName = LogAndName();

void Vary(Behaviour& behaviour)
{
    const std::string name = kBundleName;
    const auto deed = Deeds().find(name.substr(name.rfind('-') + 1));
    if (deed != Deeds().end() && std::getenv("ZEB_TEST_CALM") == nullptr)
        behaviour.atEntry = deed->second;
}

} // namespace fixture
