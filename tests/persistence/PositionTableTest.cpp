#include "foundation/zebcore/internal/PositionTable.h"

#include <gtest/gtest.h>

#include <map>
#include <random>
#include <stdexcept>
#include <vector>

using zebcore::utility::PositionTable;

namespace
{

bool Holds(const PositionTable& table, std::size_t hash, std::size_t position)
{
    return table.Find(hash, [position](std::size_t found) { return found == position; }) == position;
}

// Inserts and removes at random, with as many different hashes as asked for, beside a map that does the
// same.
class Churn
{
public:
    explicit Churn(std::size_t hashes) : mHashes(hashes) {}

    void Step()
    {
        const std::size_t position = mRandom() % 500;
        const auto known = mExpected.find(position);
        if (known == mExpected.end())
            Insert(position);
        else
            Remove(known);
    }

    void Check() const
    {
        EXPECT_EQ(mTable.IsEmpty(), mExpected.empty());
        for (const auto& [position, hash] : mExpected)
            ASSERT_TRUE(Holds(mTable, hash, position)) << position;
        for (std::size_t hash = 0; hash < mHashes; ++hash)
            ExpectOnlyKnown(Spread(hash));
    }

    void RemoveAll()
    {
        while (!mExpected.empty())
            Remove(mExpected.begin());
    }

private:
    using Expected = std::map<std::size_t, std::size_t>; // from position to hash

    // Beside each other, so that rows of used slots run into one another and over the end of the table.
    static std::size_t Spread(std::size_t hash) { return 60 + hash; }

    void Insert(std::size_t position)
    {
        const std::size_t hash = Spread(mRandom() % mHashes);
        mTable.Insert(hash, position);
        mExpected.emplace(position, hash);
    }

    void Remove(Expected::iterator known)
    {
        mTable.Remove(known->second, known->first);
        mExpected.erase(known);
    }

    void ExpectOnlyKnown(std::size_t hash) const
    {
        mTable.Find(hash,
                    [this, hash](std::size_t position)
                    {
                        const auto known = mExpected.find(position);
                        EXPECT_TRUE(known != mExpected.end() && known->second == hash) << position;
                        return false;
                    });
    }

    PositionTable mTable;
    Expected mExpected;
    std::mt19937 mRandom{1};
    std::size_t mHashes;
};

} // namespace

TEST(PositionTable, FindsWhatIsThereAndNothingElseAfterAnyChanges)
{
    for (const std::size_t hashes : {1U, 3U, 40U})
    {
        Churn churn(hashes);
        churn.Check();
        for (int round = 0; round < 20; ++round)
        {
            for (int step = 0; step < 25; ++step)
                churn.Step();
            churn.Check();
        }
        churn.RemoveAll();
        churn.Check();
    }
}

TEST(PositionTable, ShowsEachPositionOfAHashUntilOneIsIt)
{
    PositionTable table;
    for (const std::size_t position : {5U, 7U, 9U})
        table.Insert(1, position);
    table.Insert(2, 6);
    std::vector<std::size_t> shown;
    const std::size_t found = table.Find(1,
                                         [&shown](std::size_t position)
                                         {
                                             shown.push_back(position);
                                             return false;
                                         });
    EXPECT_EQ(found, PositionTable::kNone);
    EXPECT_EQ(shown, (std::vector<std::size_t>{5, 7, 9}));
    table.Clear();
    EXPECT_TRUE(table.IsEmpty());
    EXPECT_FALSE(Holds(table, 1, 5));
}

TEST(PositionTable, TellsHashesApartByTheirUpperHalf)
{
    PositionTable table;
    table.Insert(std::size_t{1} << 40U, 3);
    EXPECT_EQ(table.Find(0, [](std::size_t) { return true; }), PositionTable::kNone);
}

TEST(PositionTable, RefusesAPositionThatItCannotHold)
{
    PositionTable table;
    EXPECT_THROW(table.Insert(1, (std::size_t{1} << 32U) - 1), std::length_error);
    EXPECT_TRUE(table.IsEmpty());
    table.Insert(1, (std::size_t{1} << 32U) - 2);
    EXPECT_TRUE(Holds(table, 1, (std::size_t{1} << 32U) - 2));
}
