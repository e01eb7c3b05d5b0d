#pragma once

#include "Console.h"
#include "CrashNote.h"
#include "Ledger.h"
#include "Options.h"
#include "Record.h"
#include "Turn.h"

#include <chrono>
#include <filesystem>

namespace soak
{

/// What a run has found.
struct Findings
{
    std::vector<Subject> subjects;
    Score score;
    std::vector<std::string> leftOut; // effects that were there and did not take part, as asked for
    double seconds = 0.0;
    std::vector<Sample> samples;
    std::vector<std::string> varying; // effects that sound different each time in one process, from the start
    std::vector<std::string> changed; // effects whose fixed probe gave another sound at the end
    Ledger firstUse{{}};              // what each has left of the first filters, which may stay for all later ones
    Ledger ledger{{}};
    std::vector<Check> checks;

    bool Passed() const;
};

/// The whole run: every effect once, to have all loaded that stays loaded; then turns of one effect and turns of many
/// until the time is over; then the probes again. [main]
class Soak
{
public:
    /// `folder` is for files that live for a moment.
    Soak(const Options& options, const Console& console, const std::filesystem::path& folder);

    Findings Run();

private:
    std::size_t EffectCount() const;
    std::size_t OwnCount() const;
    void RunAll();
    void WarmUp();
    void WarmUp(std::size_t index);
    void UseOnce(const Subject& subject);
    bool Try(const Subject& subject, const char* step, const std::function<void()>& work);
    std::uint64_t Probe(const Subject& subject, const char* step);
    void RunTurns();
    void RunOneTurn(unsigned long number);
    void CompareProbes();
    void TakeSample();
    bool IsOver() const;
    double Seconds() const;
    void SayProgress();

    const Options& mOptions;
    const Console& mConsole;
    CrashNote mNote;
    Dice mDice;
    ProcessThread mThread;
    Operations mOperations;
    Findings mFindings;
    std::vector<std::uint64_t> mProbes; // 0 for an effect that varies, or threw
    std::vector<std::size_t> mOrder;    // of the effects' own turns
    std::chrono::steady_clock::time_point mStart;
    double mNextLine = 0.0;
};

} // namespace soak
