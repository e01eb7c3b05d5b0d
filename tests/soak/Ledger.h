#pragma once

#include "Resources.h"

#include <cstddef>
#include <string>
#include <vector>

namespace soak
{

/// Who has made the process grow. Only what is measured while nothing else lives can be put down to one effect.
/// [main]
class Ledger
{
public:
    struct Account
    {
        std::string name;
        int turns = 0;
        int lives = 0;               // filters in these
        int editors = 0;             // openings in these
        std::ptrdiff_t growth = 0;   // of the heap, in bytes; less than 0 where something from before was given back
        std::ptrdiff_t resident = 0; // growth of resident memory, in bytes: what the heap has no part in too
        int descriptors = 0;         // that were left open in these
        int threads = 0;             // that were left running in these

        double PerLife() const { return lives == 0 ? 0.0 : static_cast<double>(growth) / lives; }
        bool HasLeft() const { return growth > 0 || resident > 0 || descriptors > 0 || threads > 0; }
    };

    /// The accounts stand in the order of the names.
    explicit Ledger(const std::vector<std::string>& names);

    /// A turn in which this effect alone lived, and what was held ahead of it and after.
    void AddTurn(std::size_t index, int lives, int editors, const Resources& before, const Resources& after);

    const std::vector<Account>& Accounts() const { return mAccounts; }
    /// The `most` accounts whose `kind` of memory has grown by most, worst first; those that have left nothing are
    /// left out.
    std::vector<Account> Worst(std::size_t most, std::ptrdiff_t Account::*kind) const;

private:
    std::vector<Account> mAccounts;
};

} // namespace soak
