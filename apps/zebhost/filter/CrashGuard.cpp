#include "filter/CrashGuard.h"

#include "cli/ExitCode.h"
#include "output/JsonDocument.h"

#include <array>
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include <unistd.h>

namespace zebhost
{

namespace
{

// A signal handler can use nothing but memory that is there already, so every text is made ahead.
struct Texts
{
    std::string crashed;
    std::string timedOut;
    std::string crashedDocument;
    std::string timedOutDocument;
};

constexpr std::array<int, 6> kCrashSignals = {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGTRAP};
constexpr int kDeepest = 4;

std::array<Texts, kDeepest> sTexts;
pid_t sProcess = 0; // whose end is told of: plug-ins make copies of it to start programs
std::atomic<bool> sIsConcluding{false};
std::atomic<int> sDepth{0};
std::atomic<int> sEndCode{-1};
std::string sCommand;
int sDocumentDescriptor = -1;
std::string sRemovedFile;
std::array<char, 65536> sSignalStack;

void WriteAll(int descriptor, std::string_view text)
{
    while (!text.empty())
    {
        const ssize_t written = write(descriptor, text.data(), text.size());
        if (written <= 0)
        {
            return;
        }
        text.remove_prefix(static_cast<std::size_t>(written));
    }
}

// Tells what happened, cleans up and ends the process.
[[noreturn]] void Conclude(bool timedOut)
{
    if (getpid() != sProcess)
    {
        _exit(static_cast<int>(ExitCode::Crashed));
    }
    const int depth = sDepth.load();
    if (sEndCode.load() >= 0)
    {
        CrashGuard::End(sEndCode.load());
    }
    if (depth > 0)
    {
        const Texts& texts = sTexts[static_cast<std::size_t>(depth - 1)];
        WriteAll(sDocumentDescriptor, timedOut ? texts.timedOutDocument : texts.crashedDocument);
        WriteAll(STDERR_FILENO, timedOut ? texts.timedOut : texts.crashed);
    }
    else
    {
        WriteAll(STDERR_FILENO, "zebhost: crashed while no plug-in was at hand: please report this\n");
    }
    if (!sRemovedFile.empty())
    {
        unlink(sRemovedFile.c_str());
    }
    CrashGuard::End(static_cast<int>(ExitCode::Crashed));
}

void OnSignal(int signal)
{
    Conclude(signal == SIGALRM);
}

// A plug-in that calls exit ends the process as much as one that crashes.
void OnExit()
{
    if (sDepth.load() > 0)
    {
        CrashGuard::NoteEnd();
    }
}

void Install()
{
    static const bool sInstalled = []
    {
        sProcess = getpid();
        stack_t stack{};
        stack.ss_sp = sSignalStack.data();
        stack.ss_size = sSignalStack.size();
        sigaltstack(&stack, nullptr);
        struct sigaction action
        {
        };
        action.sa_handler = OnSignal;
        action.sa_flags = SA_ONSTACK;
        sigfillset(&action.sa_mask);
        for (const int signal : kCrashSignals)
        {
            sigaction(signal, &action, nullptr);
        }
        sigaction(SIGALRM, &action, nullptr);
        std::atexit(OnExit);
        return true;
    }();
    static_cast<void>(sInstalled);
}

std::string Document(const std::string& message)
{
    if (sDocumentDescriptor < 0)
    {
        return {};
    }
    return ToLine(FailureDocument(sCommand, Failure(ExitCode::Crashed, message)));
}

} // namespace

CrashGuard::CrashGuard(const std::string& what, const std::string& advice, unsigned int seconds)
    : mPreviousDepth(sDepth.load()), mSeconds(seconds)
{
    if (mPreviousDepth >= kDeepest)
    {
        return;
    }
    Texts& texts = sTexts[static_cast<std::size_t>(mPreviousDepth)];
    const std::string crashed = what + " crashed: " + advice;
    const std::string timedOut = what + " did not answer for " + std::to_string(seconds) + " seconds: " + advice;
    texts = {"zebhost: " + crashed + "\n", "zebhost: " + timedOut + "\n", Document(crashed), Document(timedOut)};
    sDepth.store(mPreviousDepth + 1);
    Install();
    NoteProgress();
}

void CrashGuard::NoteProgress() const
{
    if (mSeconds > 0)
    {
        alarm(mSeconds);
    }
}

CrashGuard::~CrashGuard()
{
    alarm(0);
    sDepth.store(mPreviousDepth);
}

void CrashGuard::WriteDocuments(const std::string& command, int descriptor)
{
    sCommand = command;
    sDocumentDescriptor = descriptor;
}

void CrashGuard::ExpectEnd(int code)
{
    constexpr unsigned int kLongestSeconds = 5;
    sEndCode.store(code);
    alarm(kLongestSeconds);
}

void CrashGuard::End(int code)
{
    sIsConcluding.store(true);
    _exit(code);
}

void CrashGuard::NoteEnd()
{
    const bool isGuarded = sDepth.load() > 0 || sEndCode.load() >= 0;
    if (isGuarded && getpid() == sProcess && !sIsConcluding.load())
    {
        Conclude(false);
    }
}

void CrashGuard::RemoveOnCrash(const std::string& path)
{
    sRemovedFile = path;
}

} // namespace zebhost
