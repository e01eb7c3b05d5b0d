#pragma once

#include "EditorWindow.h"
#include "ProcessThread.h"
#include "Subject.h"
#include "audiofilter/AudioFilter.h"

#include <cstdint>
#include <optional>
#include <vector>

namespace soak
{

/// How a filter is set up.
struct Setup
{
    zebaudiofilterhost::AudioFilterBusDescription bus; // of the application, in and out
    float sampleRate = 48000.0F;
    int blockSize = 512;
    bool mapped = true;
};

/// One filter while it lives, running and perhaps with its editor open. [main]
class Specimen
{
public:
    using FilterPointer = boost::intrusive_ptr<zebaudiofilterhost::AudioFilter>;

    /// The filter is suspended, and not null.
    Specimen(const Subject& subject, const FilterPointer& filter);
    ~Specimen();
    Specimen(const Specimen&) = delete;
    Specimen& operator=(const Specimen&) = delete;

    const Subject& GetSubject() const { return mSubject; }
    const FilterPointer& Filter() const { return mFilter; }
    int BlockSize() const { return mSetup.blockSize; }

    /// Closes the editor and suspends. The destructor does it too, and keeps to itself what that throws.
    void Close();

    /// Suspends, sets up and resumes.
    void Configure(const Setup& setup);

    /// Sends noise through the filter, on the process thread, in blocks of these sizes. Returns a hash of all that
    /// comes out.
    std::uint64_t Process(const std::vector<int>& sizes, std::uint32_t noiseStart, ProcessThread& thread);

    /// Both do nothing where there is nothing to do.
    void OpenEditor();
    void CloseEditor();
    bool HasOpenEditor() const { return mEditor.has_value(); }

private:
    void Suspend();

    const Subject& mSubject;
    FilterPointer mFilter;
    Setup mSetup;
    bool mIsRunning = false;
    std::optional<EditorWindow> mEditor; // goes ahead of the filter
};

} // namespace soak
