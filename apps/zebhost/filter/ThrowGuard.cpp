#include "filter/ThrowGuard.h"

#include <exception>
#include <utility>

namespace zebhost
{

namespace
{

struct Blame
{
    std::string what;
    std::string advice;
};

Blame sBlame;

} // namespace

ThrowGuard::ThrowGuard(std::string what, std::string advice)
    : mWhat(std::move(what)), mAdvice(std::move(advice)), mExceptions(std::uncaught_exceptions())
{
    sBlame = {};
}

ThrowGuard::~ThrowGuard()
{
    if (std::uncaught_exceptions() > mExceptions)
    {
        sBlame = {std::move(mWhat), std::move(mAdvice)};
    }
}

std::string ThrowGuard::Sentence(const std::string& error)
{
    if (sBlame.what.empty())
    {
        return {};
    }
    return sBlame.what + " threw an exception" + (error.empty() ? "" : ", \"" + error + "\"") + ": " + sBlame.advice;
}

} // namespace zebhost
