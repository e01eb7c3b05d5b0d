#pragma once

#include "tests/plugins/direct/HostSide.h"

#include <filesystem>

namespace zebtest
{

using Channels = std::vector<std::vector<float>>;

IPluginFactory* OpenBundle(const std::filesystem::path& bundle); // null if it has none; stays loaded

// One class of a bundle, called as the VST 3 interfaces say and without anything of ours in between: tests learn from
// it what the plug-in itself does.
class DirectPlugin
{
public:
    // The class is called by its name; the first audio class for an empty one. Throws std::runtime_error on failure.
    explicit DirectPlugin(const std::filesystem::path& bundle, const std::string& className = {});
    ~DirectPlugin();
    DirectPlugin(const DirectPlugin&) = delete;
    DirectPlugin& operator=(const DirectPlugin&) = delete;

    bool Arrange(std::vector<SpeakerArrangement> inputs, std::vector<SpeakerArrangement> outputs);
    void Activate(double sampleRate, int32 blockSize);
    void Deactivate();

    // One process call. `input` has the channels of all input buses in a row, all of one length; so has the result.
    Channels Process(const Channels& input, const std::vector<Point>& points = {}, uint64 silence = 0);

    std::u16string Text(ParamID id, double normalized);
    double Value(ParamID id, std::u16string text); // -1 if the plug-in can't read it
    std::string State();
    tresult SetState(const std::string& bytes);

    IPtr<DirectHost> host;
    IPtr<IComponent> component;
    IPtr<IAudioProcessor> processor;
    IPtr<IEditController> controller; // null if there is none
    std::vector<Point> outputPoints;  // of the last process call
    uint64 outputSilence = 0;         // flags of output bus 0 after the last process call

private:
    void MakeController(IPluginFactory& factory);
    void Connect(bool on);
    std::vector<AudioBusBuffers> Buffers(BusDirection direction, Channels& channels, std::vector<float*>& pointers);

    bool mSeparate = false;
    bool mActive = false;
};

} // namespace zebtest
