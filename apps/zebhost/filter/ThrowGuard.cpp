#include "filter/ThrowGuard.h"

#include <exception>
#include <utility>

namespace zebhost
{

namespace
{

struct Culprit
{
    std::string what;
    std::string advice;
};

Culprit sCulprit;

} // namespace

ThrowGuard::ThrowGuard(std::string what, std::string advice)
    : mWhat(std::move(what)), mAdvice(std::move(advice)), mExceptions(std::uncaught_exceptions())
{
    sCulprit = {};
}

ThrowGuard::~ThrowGuard()
{
    if (std::uncaught_exceptions() > mExceptions)
    {
        sCulprit = {std::move(mWhat), std::move(mAdvice)};
    }
}

std::string ThrowGuard::Sentence(const std::string& error)
{
    if (sCulprit.what.empty())
    {
        return {};
    }
    return sCulprit.what + " threw an exception" + (error.empty() ? "" : ", \"" + error + "\"") + ": " +
           sCulprit.advice;
}

} // namespace zebhost
