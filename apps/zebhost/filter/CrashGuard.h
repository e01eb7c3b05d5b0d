#pragma once

#include <string>

namespace zebhost
{

// While one lives, a crash of the process, in a plug-in that runs inside it, ends with a sentence and
// ExitCode::Crashed instead of a bare signal. Guards nest: the innermost speaks.
class CrashGuard
{
public:
    // `what` begins the sentence, such as a bundle's path, and `advice` ends it. With a time of more than 0 seconds
    // the process ends in the same way when there is no progress for so long.
    CrashGuard(const std::string& what, const std::string& advice, unsigned int seconds = 0);
    ~CrashGuard();
    CrashGuard(const CrashGuard&) = delete;
    CrashGuard& operator=(const CrashGuard&) = delete;

    // The time begins anew.
    void NoteProgress() const;

    // Where the failure document of --json goes; without it none is written.
    static void WriteDocuments(const std::string& command, int descriptor);
    // A file that must not stay behind; empty for none.
    static void RemoveOnCrash(const std::string& path);
    // To be called when all is done and the process is about to end with `code`: what plug-ins do while they are
    // taken down, be it a crash or a hang, changes that no more.
    static void ExpectEnd(int code);
    // Ends the process at once, with no word about a crash. [any]
    [[noreturn]] static void End(int code);
    // To be called when somebody ends the process without its last steps. Returns if nothing is guarded, or if it is
    // not this process but a copy of it that a plug-in made. [any]
    static void NoteEnd();

private:
    int mPreviousDepth;
    unsigned int mSeconds;
};

} // namespace zebhost
