#pragma once

#include "Subject.h"

#include <functional>
#include <stdexcept>
#include <string>
#include <vector>

namespace soak
{

/// An exception as it can be told.
struct Thrown
{
    std::string type;
    std::string what; // empty if it is no std::exception

    bool operator==(const Thrown&) const = default;
};

/// The exception that is being handled.
Thrown DescribeCurrentException();

/// What must not be, whoever's effect it is: it ends the run.
class Fault : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// A handler of the main thread's loop threw. Whose that was can't be told while several effects are in use.
class LoopError : public std::runtime_error
{
public:
    explicit LoopError(const Thrown& thrown) : std::runtime_error(thrown.what), mThrown(thrown) {}

    const Thrown& GetThrown() const { return mThrown; }

private:
    Thrown mThrown;
};

/// What effects have thrown out of the library, which passes some of it on. [main]
class Throws
{
public:
    using Cast = std::vector<const Subject*>;

    struct Entry
    {
        std::string effect; // or several that come into question
        std::string step;
        Thrown thrown;
        bool own = false; // an effect of this project
        unsigned long times = 0;
    };

    /// Does a step with the effect, and returns whether it was done to its end. What it throws is written down, that
    /// of the loop for those that have been in use; a Fault passes through, with the effect and the step ahead of it.
    bool Try(const Subject& subject, const std::string& step, const Cast& inUse, const std::function<void()>& work);

    /// In the order of the first time.
    const std::vector<Entry>& Entries() const { return mEntries; }
    /// How many times effects of this project have thrown, or those of others.
    unsigned long Count(bool own) const;

private:
    void Add(const Cast& suspects, const std::string& step, const Thrown& thrown);

    std::vector<Entry> mEntries;
};

} // namespace soak
