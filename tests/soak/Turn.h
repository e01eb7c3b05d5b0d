#pragma once

#include "CrashNote.h"
#include "Operations.h"
#include "Throws.h"

#include <array>
#include <memory>

namespace soak
{

/// How often each operation was begun.
using Tally = std::array<unsigned long, kOperations>;

/// What a run counts.
struct Score
{
    Tally tally{};
    Throws throws;
};

/// A while in which filters come, are used and go, until none is left. [main]
class Turn
{
public:
    /// `cast` are the effects that may come; not empty.
    Turn(std::vector<const Subject*> cast, Dice& dice, Operations& operations, CrashNote& note, Score& score);

    /// A filter that has thrown goes at once, as an application would have it. Throws Fault, with the effect's name,
    /// for what must not be.
    void Run(int steps, bool withEditors);

    int Lives() const { return mLives; }
    int Editors() const { return mEditors; }

private:
    void Step(bool withEditors);
    void Create();
    void Destroy(std::size_t index);
    void Remove(std::size_t index);
    bool Do(Operation operation, std::size_t index);
    bool Try(Operation operation, const Subject& subject, const std::function<void()>& work);
    void SayGoodbye();

    std::vector<const Subject*> mCast;
    Dice& mDice;
    Operations& mOperations;
    CrashNote& mNote;
    Score& mScore;
    std::vector<std::unique_ptr<Specimen>> mSpecimens;
    std::vector<const Subject*> mUsed; // since the loop had nothing left of earlier turns
    int mLives = 0;
    int mEditors = 0;
};

/// A new filter of the effect; throws Fault if there is none. [main]
std::unique_ptr<Specimen> CreateSpecimen(const Subject& subject);

} // namespace soak
