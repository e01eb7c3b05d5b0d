#pragma once

#include <cstddef>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace zebtest
{

// The test's side of a fixture bundle: what the host called, in order, and switches for what the fixture does next.
// It opens the binary that the host opens too, so both see the same log. Throws std::runtime_error if it can't be
// opened or is no fixture.
//
// A call is one line: who was called, the operation, its salient arguments. For instance
//   "component.initialize", "component.setActive 1", "component.activateBus audio in 0 1", "processor.setupProcessing
//   mode=0 block=512 rate=44100", "processor.process 512", "controller.setParamNormalized 7 0.5", "view.attached
//   X11EmbedWindowID". tests/plugins/README.md lists them all.
class FixtureRecorder
{
public:
    explicit FixtureRecorder(const std::filesystem::path& bundle);

    std::vector<std::string> Calls() const;
    std::vector<std::string> CallsTo(std::string_view prefix) const; // those lines that begin with it
    std::size_t Count(std::string_view prefix) const;

    // Forgets the log. Live objects and switches stay.
    void Clear() const;

    // Objects of the plug-in (components, controllers, views) that exist now.
    int LiveObjects() const;

    // Recording allocates and locks; switched off, a fixture's process does neither. On at first.
    void SetRecording(bool on) const;

    // Sets a number that the fixture acts by from now on, such as "latency" or "processResult"; back to what the
    // bundle is built for with Reset. Throws std::invalid_argument for an unknown name.
    void Set(const std::string& name, double value) const;
    double Get(const std::string& name) const;
    void Reset() const;

    // Lets the newest living controller, component or view call its host, on this thread: "performEdit 7 0.5",
    // "restartComponent 8", "resizeView 300 200". Returns what the host answered, such as "0".
    std::string Do(const std::string& command) const;

private:
    template <class Function>
    Function* Symbol(const char* name) const;

    void* mHandle;
};

FixtureRecorder RecorderOf(const std::filesystem::path& bundle);

} // namespace zebtest
