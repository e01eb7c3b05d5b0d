#include "Ledger.h"

#include <algorithm>

namespace soak
{

namespace
{

std::ptrdiff_t Difference(std::size_t after, std::size_t before)
{
    return static_cast<std::ptrdiff_t>(after) - static_cast<std::ptrdiff_t>(before);
}

} // namespace

Ledger::Ledger(const std::vector<std::string>& names)
{
    for (const std::string& name : names)
    {
        mAccounts.push_back({name});
    }
}

void Ledger::AddTurn(std::size_t index, int lives, int editors, const Resources& before, const Resources& after)
{
    Account& account = mAccounts[index];
    ++account.turns;
    account.lives += lives;
    account.editors += editors;
    account.growth += Difference(after.inUse, before.inUse);
    account.resident += Difference(after.resident, before.resident);
    account.descriptors += after.descriptors - before.descriptors;
    account.threads += after.threads - before.threads;
}

std::vector<Ledger::Account> Ledger::Worst(std::size_t most, std::ptrdiff_t Account::*kind) const
{
    std::vector<Account> worst;
    std::copy_if(mAccounts.begin(), mAccounts.end(), std::back_inserter(worst),
                 [](const Account& account) { return account.HasLeft(); });
    std::sort(worst.begin(), worst.end(), [kind](const Account& a, const Account& b) { return a.*kind > b.*kind; });
    worst.resize(std::min(worst.size(), most));
    return worst;
}

} // namespace soak
