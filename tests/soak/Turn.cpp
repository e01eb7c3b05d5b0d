#include "Turn.h"

#include "MainLoop.h"
#include "utility/EffectUtils.h"

#include <algorithm>
#include <numeric>

namespace soak
{

namespace
{

constexpr std::size_t kMostAtATime = 5;
constexpr unsigned int kGoodbyeMs = 50; // two ticks: then nothing that was posted holds a filter

} // namespace

std::unique_ptr<Specimen> CreateSpecimen(const Subject& subject)
{
    const Specimen::FilterPointer filter = zebaudiofilterhost::utility::CreateAudioFilter(subject.id);
    if (filter == nullptr)
    {
        throw Fault("can't be made");
    }
    return std::make_unique<Specimen>(subject, filter);
}

Turn::Turn(std::vector<const Subject*> cast, Dice& dice, Operations& operations, CrashNote& note, Score& score)
    : mCast(std::move(cast)), mDice(dice), mOperations(operations), mNote(note), mScore(score)
{
}

void Turn::Run(int steps, bool withEditors)
{
    for (int step = 0; step < steps; ++step)
    {
        Step(withEditors);
    }
    while (!mSpecimens.empty())
    {
        Destroy(mDice.Below(mSpecimens.size()));
    }
    mOperations.ForgetStates();
    SayGoodbye();
}

// A filter that is still posted to gets it now, and may throw at each.
void Turn::SayGoodbye()
{
    constexpr int kMostTries = 100;
    bool quiet = mUsed.empty();
    for (int tries = 0; tries < kMostTries && !quiet; ++tries)
    {
        quiet = mScore.throws.Try(*mUsed.back(), "after the last filter", mUsed, [] { Settle(kGoodbyeMs); });
    }
}

void Turn::Step(bool withEditors)
{
    constexpr std::size_t kCreateOneIn = 6;
    constexpr std::size_t kDestroyOneIn = 8;
    constexpr std::size_t kEditorOneIn = 12;
    constexpr std::array kUsual = {Operation::Configure, Operation::Process,   Operation::Process,
                                   Operation::Process,   Operation::Process,   Operation::Parameters,
                                   Operation::SaveState, Operation::LoadState, Operation::StateFile,
                                   Operation::Preset,    Operation::Preset,    Operation::Clone};
    if (mSpecimens.empty() || (mSpecimens.size() < kMostAtATime && mDice.OneIn(kCreateOneIn)))
    {
        return Create();
    }
    const std::size_t index = mDice.Below(mSpecimens.size());
    const Specimen& specimen = *mSpecimens[index];
    if (mDice.OneIn(kDestroyOneIn))
    {
        return Destroy(index);
    }
    const bool editor = mDice.OneIn(kEditorOneIn) && withEditors && specimen.GetSubject().withEditor;
    if (editor)
    {
        const bool closes = specimen.HasOpenEditor();
        mEditors += Do(closes ? Operation::CloseEditor : Operation::OpenEditor, index) && !closes ? 1 : 0;
        return;
    }
    Do(mDice.Pick(kUsual), index);
}

void Turn::Create()
{
    const Subject& subject = *mDice.Pick(mCast);
    if (std::find(mUsed.begin(), mUsed.end(), &subject) == mUsed.end())
    {
        mUsed.push_back(&subject);
    }
    ++mLives;
    if (Try(Operation::Create, subject, [&] { mSpecimens.push_back(CreateSpecimen(subject)); }))
    {
        Do(Operation::Configure, mSpecimens.size() - 1);
    }
}

void Turn::Destroy(std::size_t index)
{
    Specimen& specimen = *mSpecimens[index];
    Try(Operation::Destroy, specimen.GetSubject(), [&specimen] { specimen.Close(); });
    Remove(index);
}

void Turn::Remove(std::size_t index)
{
    mSpecimens.erase(mSpecimens.begin() + static_cast<std::ptrdiff_t>(index));
}

bool Turn::Do(Operation operation, std::size_t index)
{
    Specimen& specimen = *mSpecimens[index];
    mLives += operation == Operation::Clone ? 1 : 0;
    const bool done = Try(operation, specimen.GetSubject(), [&] { mOperations.Run(operation, specimen); });
    if (!done)
    {
        Remove(index);
    }
    return done;
}

bool Turn::Try(Operation operation, const Subject& subject, const std::function<void()>& work)
{
    ++mScore.tally[static_cast<std::size_t>(operation)];
    mNote.Step(subject.name, NameOf(operation), std::accumulate(mScore.tally.begin(), mScore.tally.end(), 0UL));
    return mScore.throws.Try(subject, NameOf(operation), mUsed, work);
}

} // namespace soak
