#pragma once

#include "Dice.h"
#include "ProcessThread.h"
#include "Specimen.h"

#include <array>
#include <filesystem>
#include <map>
#include <string>

namespace soak
{

enum class Operation
{
    Create,
    Destroy,
    Configure,
    Process,
    Parameters,
    SaveState,
    LoadState,
    StateFile,
    Preset,
    Clone,
    OpenEditor,
    CloseEditor
};

inline constexpr std::size_t kOperations = 12;

const char* NameOf(Operation operation);

/// What is done to a filter that lives, at random within each operation. [main]
class Operations
{
public:
    /// State files lie in `folder` for a moment.
    Operations(Dice& dice, ProcessThread& thread, std::filesystem::path folder);

    /// All but Create and Destroy. Throws Fault for what must not be, and what the effect throws.
    void Run(Operation operation, Specimen& specimen);

    /// Forgets the states that were saved, which would count as growth.
    void ForgetStates() { mStates.clear(); }

private:
    void Configure(Specimen& specimen);
    void Process(Specimen& specimen);
    void ChangeParameters(zebaudiofilterhost::AudioFilter& filter);
    void SaveState(const Specimen& specimen);
    void LoadState(const Specimen& specimen);
    void PassStateThroughFile(const Specimen& specimen);
    void TakePreset(zebaudiofilterhost::AudioFilter& filter);
    void Clone(const Specimen& specimen);

    Dice& mDice;
    ProcessThread& mThread;
    std::filesystem::path mFolder;
    std::map<zebaudiofilterhost::UTF16String, zebaudiofilterhost::PropList> mStates; // by filter ID
};

} // namespace soak
