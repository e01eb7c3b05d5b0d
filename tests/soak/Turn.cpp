#include "Turn.h"

#include "utility/EffectUtils.h"

#include <numeric>
#include <stdexcept>

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
        throw std::runtime_error(subject.name + " can't be made");
    }
    return std::make_unique<Specimen>(subject, filter);
}

Turn::Turn(std::vector<const Subject*> cast, Dice& dice, Operations& operations, CrashNote& note, Tally& tally)
    : mCast(std::move(cast)), mDice(dice), mOperations(operations), mNote(note), mTally(tally)
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
    Settle(kGoodbyeMs);
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
    Specimen& specimen = *mSpecimens[index];
    if (mDice.OneIn(kDestroyOneIn))
    {
        return Destroy(index);
    }
    const bool editor = mDice.OneIn(kEditorOneIn) && withEditors && specimen.GetSubject().withEditor;
    if (editor)
    {
        return Do(specimen.HasOpenEditor() ? Operation::CloseEditor : Operation::OpenEditor, specimen);
    }
    Do(mDice.Pick(kUsual), specimen);
}

void Turn::Create()
{
    const Subject& subject = *mDice.Pick(mCast);
    Begin(Operation::Create, subject);
    mSpecimens.push_back(CreateSpecimen(subject));
    ++mLives;
    Do(Operation::Configure, *mSpecimens.back());
}

void Turn::Destroy(std::size_t index)
{
    Begin(Operation::Destroy, mSpecimens[index]->GetSubject());
    mSpecimens.erase(mSpecimens.begin() + static_cast<std::ptrdiff_t>(index));
}

void Turn::Do(Operation operation, Specimen& specimen)
{
    Begin(operation, specimen.GetSubject());
    try
    {
        mOperations.Run(operation, specimen);
    }
    catch (const std::exception& fault)
    {
        throw std::runtime_error(specimen.GetSubject().name + ", " + NameOf(operation) + ": " + fault.what());
    }
    mEditors += operation == Operation::OpenEditor && specimen.HasOpenEditor() ? 1 : 0;
    mLives += operation == Operation::Clone ? 1 : 0;
}

void Turn::Begin(Operation operation, const Subject& subject)
{
    ++mTally[static_cast<std::size_t>(operation)];
    mNote.Step(subject.name, NameOf(operation), std::accumulate(mTally.begin(), mTally.end(), 0UL));
}

} // namespace soak
