#pragma once

#include "CrashNote.h"
#include "Operations.h"

#include <array>
#include <memory>

namespace soak
{

/// How often each operation was done.
using Tally = std::array<unsigned long, kOperations>;

/// A while in which filters come, are used and go, until none is left. [main]
class Turn
{
public:
    /// `cast` are the effects that may come; not empty.
    Turn(std::vector<const Subject*> cast, Dice& dice, Operations& operations, CrashNote& note, Tally& tally);

    /// Throws std::runtime_error, with the effect's name, for what must not be.
    void Run(int steps, bool withEditors);

    int Lives() const { return mLives; }
    int Editors() const { return mEditors; }

private:
    void Step(bool withEditors);
    void Create();
    void Destroy(std::size_t index);
    void Do(Operation operation, Specimen& specimen);
    void Begin(Operation operation, const Subject& subject);

    std::vector<const Subject*> mCast;
    Dice& mDice;
    Operations& mOperations;
    CrashNote& mNote;
    Tally& mTally;
    std::vector<std::unique_ptr<Specimen>> mSpecimens;
    int mLives = 0;
    int mEditors = 0;
};

/// A new filter of the effect; throws std::runtime_error if there is none. [main]
std::unique_ptr<Specimen> CreateSpecimen(const Subject& subject);

} // namespace soak
