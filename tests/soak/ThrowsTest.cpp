#include "Throws.h"

#include <gmock/gmock.h>

#include <new>

namespace soak
{
namespace
{

using testing::ElementsAre;

const Subject kStranger{u"1", "Stranger", true, false};
const Subject kOther{u"2", "Other", true, false};
const Subject kOwn{u"3", "Own", true, true};

std::vector<std::string> Told(const Throws& throws)
{
    std::vector<std::string> lines;
    for (const Throws::Entry& entry : throws.Entries())
    {
        lines.push_back(entry.effect + "/" + entry.step + "/" + entry.thrown.type + "/" + entry.thrown.what + "/" +
                        std::to_string(entry.times));
    }
    return lines;
}

TEST(ThrowsTest, CountsWhatIsThrownUnderItsEffect)
{
    Throws throws;
    const auto fail = []
    {
        throw std::bad_alloc();
    };
    EXPECT_TRUE(throws.Try(kOwn, "process", {&kOwn}, [] {}));
    EXPECT_FALSE(throws.Try(kStranger, "process", {&kStranger, &kOwn}, fail));
    EXPECT_FALSE(throws.Try(kStranger, "process", {&kStranger, &kOwn}, fail));
    EXPECT_FALSE(throws.Try(kStranger, "clone", {&kStranger}, fail));
    EXPECT_FALSE(throws.Try(kOwn, "clone", {&kOwn}, [] { throw std::runtime_error("no room"); }));
    EXPECT_FALSE(throws.Try(kOther, "preset", {&kOther}, [] { throw 5; }));
    EXPECT_THAT(Told(throws), ElementsAre("Stranger/process/std::bad_alloc/std::bad_alloc/2",
                                          "Stranger/clone/std::bad_alloc/std::bad_alloc/1",
                                          "Own/clone/std::runtime_error/no room/1", "Other/preset/int//1"));
    EXPECT_EQ(throws.Count(true), 1UL);
    EXPECT_EQ(throws.Count(false), 4UL);
}

TEST(ThrowsTest, PutsTheLoopsDownToAllThatWereInUse)
{
    Throws throws;
    const auto fail = []
    {
        throw LoopError({"std::bad_alloc", "std::bad_alloc"});
    };
    throws.Try(kOwn, "process", {&kStranger, &kOwn}, fail);
    throws.Try(kOwn, "process", {&kOwn, &kStranger}, fail);
    EXPECT_EQ(throws.Count(true), 0UL) << "it may have been the stranger";
    throws.Try(kStranger, "process", {&kOwn}, fail);
    EXPECT_THAT(Told(throws), ElementsAre("one of Own, Stranger/process/std::bad_alloc/std::bad_alloc/2",
                                          "Own/process/std::bad_alloc/std::bad_alloc/1"));
    EXPECT_EQ(throws.Count(true), 1UL);
}

TEST(ThrowsTest, DoesNotForgiveAFault)
{
    Throws throws;
    std::string told;
    try
    {
        throws.Try(kStranger, "load state", {&kStranger}, [] { throw Fault("refuses the state"); });
    }
    catch (const Fault& fault)
    {
        told = fault.what();
    }
    EXPECT_EQ(told, "Stranger, load state: refuses the state");
    EXPECT_TRUE(throws.Entries().empty());
}

} // namespace
} // namespace soak
