#pragma once

#include <string>

namespace zebhost
{

// While one lives, an exception that leaves its scope is taken for that of a plug-in, as a crash is by CrashGuard.
// [main]
class ThrowGuard
{
public:
    // `what` begins the sentence, such as a bundle's path, and `advice` ends it.
    ThrowGuard(std::string what, std::string advice);
    ~ThrowGuard();
    ThrowGuard(const ThrowGuard&) = delete;
    ThrowGuard& operator=(const ThrowGuard&) = delete;

    // The sentence for an exception that was caught, by what it says of itself, if anything. Empty if it came through
    // no guard.
    static std::string Sentence(const std::string& error);

private:
    std::string mWhat;
    std::string mAdvice;
    int mExceptions; // under way before
};

} // namespace zebhost
