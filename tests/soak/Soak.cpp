#include "Soak.h"

#include "ControlFilter.h"
#include "Interrupt.h"
#include "MainLoop.h"
#include "Probe.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <numeric>

namespace soak
{

namespace
{

constexpr int kFirstUses = 4; // two probes, one filter and its clone
constexpr unsigned int kGoodbyeMs = 50;

std::vector<std::string> NamesOf(const std::vector<Subject>& subjects)
{
    std::vector<std::string> names;
    std::transform(subjects.begin(), subjects.end(), std::back_inserter(names),
                   [](const Subject& subject) { return subject.name; });
    return names;
}

unsigned long Sum(const Tally& tally)
{
    return std::accumulate(tally.begin(), tally.end(), 0UL);
}

} // namespace

bool Findings::Passed() const
{
    return AllHold(checks);
}

Soak::Soak(const Options& options, const Console& console, const std::filesystem::path& folder)
    : mOptions(options)
    , mConsole(console)
    , mNote(console.Descriptor(), options.randomStart)
    , mDice(options.randomStart)
    , mOperations(mDice, mThread, folder)
    , mStart(std::chrono::steady_clock::now())
{
}

Findings Soak::Run()
{
    mNote.Step("the plug-ins", "scan", 0);
    mFindings.subjects = FindSubjects(mOptions, mFindings.leftOut);
    mFindings.ledger = Ledger(NamesOf(mFindings.subjects));
    mConsole.Say("soak: random start " + std::to_string(mOptions.randomStart) + ", " +
                 std::to_string(mFindings.subjects.size()) + " effects, " + std::to_string(mOptions.seconds) +
                 " s after each was used once");
    mFindings.checks.push_back(JudgeSubjects(EffectCount()));
    if (mFindings.Passed())
    {
        RunAll();
    }
    mNote.Done();
    return std::move(mFindings);
}

void Soak::RunAll()
{
    try
    {
        WarmUp();
        RunTurns();
        CompareProbes();
        mFindings.checks.push_back(JudgeEnd(interrupt::IsRequested()));
    }
    catch (const Fault& fault)
    {
        mFindings.seconds = Seconds();
        mFindings.checks.push_back({"the whole run", std::string("ended by ") + fault.what(), Check::Outcome::Fails});
    }
    const Throws& throws = mFindings.score.throws;
    mFindings.checks.push_back(JudgeThrows(OwnCount(), throws.Count(true), throws.Count(false)));
}

std::size_t Soak::EffectCount() const
{
    return static_cast<std::size_t>(std::count_if(mFindings.subjects.begin(), mFindings.subjects.end(),
                                                  [](const Subject& subject)
                                                  { return subject.id != kControlFilterID; }));
}

std::size_t Soak::OwnCount() const
{
    return static_cast<std::size_t>(std::count_if(mFindings.subjects.begin(), mFindings.subjects.end(),
                                                  [](const Subject& subject) { return subject.own; }));
}

void Soak::WarmUp()
{
    const std::size_t count = mFindings.subjects.size();
    mProbes.resize(count);
    mFindings.firstUse = Ledger(NamesOf(mFindings.subjects));
    for (std::size_t index = 0; index < count && !interrupt::IsRequested(); ++index)
    {
        const Resources before = MeasureResources();
        WarmUp(index);
        mFindings.firstUse.AddTurn(index, kFirstUses, 1, before, MeasureResources());
    }
    mConsole.Say("soak: each was used once after " + std::to_string(static_cast<int>(Seconds())) + " s");
}

void Soak::WarmUp(std::size_t index)
{
    const Subject& subject = mFindings.subjects[index];
    const std::uint64_t first = Probe(subject, "first probe");
    Try(subject, "first use", [&] { UseOnce(subject); });
    const std::uint64_t second = Probe(subject, "second probe");
    if (first != 0 && second != 0 && first != second)
    {
        mFindings.varying.push_back(subject.name);
    }
    mProbes[index] = first == second ? first : 0;
    Try(subject, "after the first use", [] { Settle(kGoodbyeMs); });
}

bool Soak::Try(const Subject& subject, const char* step, const std::function<void()>& work)
{
    mNote.Step(subject.name, step, Sum(mFindings.score.tally));
    return mFindings.score.throws.Try(subject, step, {&subject}, work);
}

// 0 if it threw.
std::uint64_t Soak::Probe(const Subject& subject, const char* step)
{
    std::uint64_t hash = 0;
    Try(subject, step, [&] { hash = ProbeSound(subject, mThread); });
    return hash;
}

void Soak::UseOnce(const Subject& subject)
{
    const std::unique_ptr<Specimen> specimen = CreateSpecimen(subject);
    for (const Operation operation :
         {Operation::Configure, Operation::OpenEditor, Operation::Process, Operation::Parameters,
          Operation::SaveState, Operation::LoadState, Operation::StateFile, Operation::Preset, Operation::Clone})
    {
        if (operation != Operation::OpenEditor || (mOptions.withEditors && subject.withEditor))
        {
            mOperations.Run(operation, *specimen);
        }
    }
    specimen->Close();
    mOperations.ForgetStates();
}

void Soak::RunTurns()
{
    mOrder.resize(mFindings.subjects.size());
    std::iota(mOrder.begin(), mOrder.end(), std::size_t{0});
    std::shuffle(mOrder.begin(), mOrder.end(), mDice.Engine());
    constexpr unsigned int kRestMs = 500;
    Settle(kRestMs);
    mStart = std::chrono::steady_clock::now();
    TakeSample();
    for (unsigned long number = 0; !IsOver(); ++number)
    {
        RunOneTurn(number);
        TakeSample();
        SayProgress();
    }
    Settle(kRestMs);
    TakeSample();
    mFindings.seconds = Seconds();
    for (Check& check : JudgeResources(mFindings.samples))
    {
        mFindings.checks.push_back(std::move(check));
    }
}

// Two turns of one effect alone, then one of all together.
void Soak::RunOneTurn(unsigned long number)
{
    constexpr int kStepsAlone = 24;
    constexpr int kStepsTogether = 48;
    constexpr unsigned long kRound = 3;
    std::vector<const Subject*> cast;
    if (number % kRound == kRound - 1)
    {
        std::transform(mFindings.subjects.begin(), mFindings.subjects.end(), std::back_inserter(cast),
                       [](const Subject& subject) { return &subject; });
        Turn(cast, mDice, mOperations, mNote, mFindings.score).Run(kStepsTogether, mOptions.withEditors);
        return;
    }
    const unsigned long alone = number / kRound * (kRound - 1) + number % kRound;
    const std::size_t index = mOrder[alone % mOrder.size()];
    Turn turn({&mFindings.subjects[index]}, mDice, mOperations, mNote, mFindings.score);
    turn.Run(kStepsAlone, mOptions.withEditors);
    mFindings.ledger.AddTurn(index, turn.Lives(), turn.Editors(), mFindings.samples.back().resources,
                             MeasureResources());
}

void Soak::CompareProbes()
{
    std::size_t compared = 0;
    for (std::size_t index = 0; index < mProbes.size() && !interrupt::IsRequested(); ++index)
    {
        const Subject& subject = mFindings.subjects[index];
        const std::uint64_t last = mProbes[index] == 0 ? 0 : Probe(subject, "last probe");
        if (last == 0)
        {
            continue;
        }
        ++compared;
        if (last != mProbes[index])
        {
            mFindings.changed.push_back(subject.name);
        }
    }
    mFindings.checks.push_back(JudgeProbes(compared, mFindings.changed.size()));
}

void Soak::TakeSample()
{
    mFindings.samples.push_back({Seconds(), MeasureResources()});
}

bool Soak::IsOver() const
{
    return Seconds() >= mOptions.seconds || interrupt::IsRequested() ||
           (mOptions.operations > 0 && Sum(mFindings.score.tally) >= mOptions.operations);
}

double Soak::Seconds() const
{
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - mStart).count();
}

void Soak::SayProgress()
{
    const double seconds = Seconds();
    if (seconds < mNextLine)
    {
        return;
    }
    mNextLine = seconds + mOptions.everySeconds;
    const Resources& now = mFindings.samples.back().resources;
    std::array<char, 32> time{};
    const int whole = static_cast<int>(seconds);
    std::snprintf(time.data(), time.size(), "%02d:%02d", whole / 60, whole % 60);
    std::string line = std::string(time.data()) + "  resident " + Megabytes(static_cast<double>(now.resident)) +
                       ", in use " + Megabytes(static_cast<double>(now.inUse)) + ", descriptors " +
                       std::to_string(now.descriptors) + ", threads " + std::to_string(now.threads) + "; " +
                       std::to_string(Sum(mFindings.score.tally)) + " operations:";
    for (std::size_t kind = 0; kind < kOperations; ++kind)
    {
        line += std::string(kind == 0 ? " " : ", ") + NameOf(static_cast<Operation>(kind)) + " " +
                std::to_string(mFindings.score.tally[kind]);
    }
    const Throws& throws = mFindings.score.throws;
    mConsole.Say(line + ", throws " + std::to_string(throws.Count(true) + throws.Count(false)));
}

} // namespace soak
