#include "foundation/zebcore/RefCountedObject.h"
#include "foundation/zebcore/SharedRefPtr.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

using zebcore::utility::RefCountedInterface;
using zebcore::utility::RefCountedObject;
using zebcore::utility::SharedRefPtr;

namespace
{

class Counted : public virtual RefCountedObject
{
public:
    explicit Counted(int& deaths) : mDeaths(deaths) {}
    ~Counted() override { ++mDeaths; }

    using RefCountedObject::SetExemptFromDeletion;

private:
    int& mDeaths;
};

TEST(RefCountedObject, LivesAsLongAsItIsHeld)
{
    int deaths = 0;
    auto* object = new Counted(deaths);
    EXPECT_EQ(0, object->GetRefCount());
    {
        SharedRefPtr<Counted> first(object);
        EXPECT_EQ(1, object->GetRefCount());
        const boost::intrusive_ptr<const RefCountedInterface> second(first);
        EXPECT_EQ(2, object->GetRefCount());
        first.reset();
        EXPECT_EQ(0, deaths);
    }
    EXPECT_EQ(1, deaths);
}

TEST(RefCountedObject, IsNotDeletedByTheCountIfNeverHeld)
{
    int deaths = 0;
    {
        const Counted onTheStack(deaths);
        EXPECT_EQ(0, onTheStack.GetRefCount());
    }
    EXPECT_EQ(1, deaths);
}

TEST(RefCountedObject, AReferenceTakenDuringDestructionDeletesNothing)
{
    class Resurrecting : public Counted
    {
    public:
        using Counted::Counted;
        ~Resurrecting() override { const boost::intrusive_ptr<Counted> again(this); }
    };

    int deaths = 0;
    boost::intrusive_ptr<Resurrecting>(new Resurrecting(deaths)).reset();
    EXPECT_EQ(1, deaths);
}

TEST(RefCountedObject, AnExemptObjectOutlivesItsReferences)
{
    int deaths = 0;
    Counted object(deaths);
    object.SetExemptFromDeletion(true);
    boost::intrusive_ptr<Counted>(&object).reset();
    boost::intrusive_ptr<Counted>(&object).reset();
    EXPECT_EQ(0, deaths);
    EXPECT_EQ(0, object.GetRefCount());
}

TEST(RefCountedObject, ACopyHasACountOfItsOwn)
{
    int deaths = 0;
    const boost::intrusive_ptr<Counted> original(new Counted(deaths));
    const Counted copy(*original);
    EXPECT_EQ(0, copy.GetRefCount());
    EXPECT_EQ(1, original->GetRefCount());
}

TEST(RefCountedObject, SeveralInterfacesShareOneCount)
{
    class First : public virtual RefCountedInterface
    {
    };
    class Second : public virtual RefCountedInterface
    {
    };
    class Both : public First, public Second, public virtual RefCountedObject
    {
    };

    const boost::intrusive_ptr<First> first(new Both);
    const boost::intrusive_ptr<Second> second(dynamic_cast<Second*>(first.get()));
    ASSERT_TRUE(second);
    EXPECT_EQ(2, dynamic_cast<Both&>(*second).GetRefCount());
}

TEST(RefCountedObject, ManyThreadsShareOneObject)
{
    // Each owner writes a word of its own, which the destructor reads: a missing order would be a race.
    class Ledger : public RefCountedObject
    {
    public:
        Ledger(std::size_t owners, std::atomic<int>& sum) : mEntries(owners), mSum(sum) {}
        ~Ledger() override
        {
            for (const int entry : mEntries)
                mSum += entry;
        }

        std::vector<int> mEntries;

    private:
        std::atomic<int>& mSum;
    };

    constexpr std::size_t kOwners = 4;
    constexpr int kRounds = 10000;
    std::atomic<int> sum{0};
    boost::intrusive_ptr<Ledger> ledger(new Ledger(kOwners, sum));
    std::vector<std::thread> threads;
    for (std::size_t owner = 0; owner < kOwners; ++owner)
        threads.emplace_back(
            [mine = ledger, owner]() mutable
            {
                for (int i = 0; i < kRounds; ++i)
                {
                    boost::intrusive_ptr<Ledger> another;
                    another = mine;
                    ++another->mEntries[owner];
                }
                mine.reset();
            });
    ledger.reset();
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(static_cast<int>(kOwners) * kRounds, sum.load());
}

} // namespace
