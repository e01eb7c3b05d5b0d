// Handlers that answer for an instance ahead of it.

#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

#include <array>

using namespace fakeeffect;
using testing::ElementsAre;

namespace
{

class Handlers : public FilterTest
{
protected:
    void SetUp() override { MakeRunning(); }

    // Notes the owner's place, and answers.
    void Add(std::size_t owner, long long answer)
    {
        filter->AddAudioMasterHandler(&owners[owner],
                                      [this, owner, answer](int, int, long long, void*, float)
                                      {
                                          called.push_back(owner);
                                          return answer;
                                      });
    }

    std::array<char, 4> owners = {};
    std::vector<std::size_t> called;
};

} // namespace

TEST_F(Handlers, AreAskedInTheOrderOfTheirOwners)
{
    Add(2, 0);
    Add(0, 0);
    Add(3, 0);
    Add(1, 0);
    EXPECT_EQ(fake.CallHost(audioMasterVersion), 2400);
    EXPECT_THAT(called, ElementsAre(0U, 1U, 2U, 3U));
}

TEST_F(Handlers, TheFirstAnswerEndsTheWalk)
{
    Add(0, 0);
    Add(1, -7);
    Add(2, 8);
    for (const auto opcode : {audioMasterVersion, audioMasterGetTime, audioMasterIdle})
        EXPECT_EQ(fake.CallHost(opcode), -7);
    EXPECT_THAT(called, ElementsAre(0U, 1U, 0U, 1U, 0U, 1U));
}

TEST_F(Handlers, GetTheCallAsItCame)
{
    int seen = 0;
    filter->AddAudioMasterHandler(this,
                                  [&](int opcode, int index, long long value, void* ptr, float opt)
                                  {
                                      EXPECT_EQ(opcode, audioMasterSizeWindow);
                                      EXPECT_EQ(index, -3);
                                      EXPECT_EQ(value, 0x123456789abcdefLL);
                                      EXPECT_EQ(ptr, &seen);
                                      EXPECT_EQ(opt, 0.5F);
                                      ++seen;
                                      return 0x0edcba9876543210LL;
                                  });
    EXPECT_EQ(fake.CallHost(audioMasterSizeWindow, -3, 0x123456789abcdefLL, &seen, 0.5F), 0x0edcba9876543210LL);
    EXPECT_EQ(seen, 1);
}

TEST_F(Handlers, AnOwnerKeepsItsFirstOne)
{
    Add(0, 1);
    Add(0, 2);
    EXPECT_EQ(fake.CallHost(audioMasterIdle), 1);
    filter->RemoveAudioMasterHandler(&owners[1]);
    EXPECT_EQ(fake.CallHost(audioMasterIdle), 1);
    filter->RemoveAudioMasterHandler(&owners[0]);
    EXPECT_EQ(fake.CallHost(audioMasterIdle), 0);
    Add(0, 3);
    EXPECT_EQ(fake.CallHost(audioMasterIdle), 3);
}

TEST_F(Handlers, AnEmptyOneRaisesAtTheCall)
{
    filter->AddAudioMasterHandler(&owners[1], {});
    EXPECT_THROW(fake.CallHost(audioMasterVersion), boost::bad_function_call);
    Add(0, 4);
    EXPECT_EQ(fake.CallHost(audioMasterVersion), 4);
    filter->RemoveAudioMasterHandler(&owners[0]);
    filter->RemoveAudioMasterHandler(&owners[1]);
    EXPECT_EQ(fake.CallHost(audioMasterVersion), 2400);
}

// Views close and open from inside their own calls.
TEST_F(Handlers, MayChangeTheListFromInside)
{
    const auto state = std::make_shared<int>(0);
    filter->AddAudioMasterHandler(&owners[0],
                                  [this, state](int, int, long long, void*, float)
                                  {
                                      filter->RemoveAudioMasterHandler(&owners[0]);
                                      Add(1, 9);
                                      Add(0, 10);
                                      ++*state; // what the removed handler holds is still there
                                      return 0LL;
                                  });
    EXPECT_EQ(fake.CallHost(audioMasterVersion), 2400) << "a call goes on with the handlers that it found";
    EXPECT_EQ(*state, 1);
    EXPECT_EQ(fake.CallHost(audioMasterVersion), 10);
    filter->RemoveAudioMasterHandler(&owners[0]);
    EXPECT_EQ(state.use_count(), 1) << "the removed handler was not freed";
}
