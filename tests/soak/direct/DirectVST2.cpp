// What VST 2 plug-ins leave behind by themselves: each is called as its interface says, without the library.
//   zeb_soak_direct LIVES FILE...   a line for each binary: what one life has left on average, without its editor and
//                                   with it (where there is a display)
#include "../Resources.h"
#include "host/src/VST/interface/VST2Interface.h"

#include <X11/Xlib.h>
#include <dlfcn.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <iostream>
#include <vector>

#include <unistd.h>

using namespace zebaudiofilterhost::vst;

namespace
{

constexpr int kFrames = 512;
constexpr int kWarmLives = 2; // what is loaded by these stays for all later ones

long long AnswerHost(AEffect*, std::int32_t opcode, std::int32_t, long long, void*, float)
{
    constexpr long long kVersion = 2400;
    switch (opcode)
    {
    case audioMasterVersion:
        return kVersion;
    case audioMasterGetSampleRate:
        return 48000;
    case audioMasterGetBlockSize:
        return kFrames;
    default:
        return 0;
    }
}

// The editor in a window, with some time to draw itself.
void ShowEditor(AEffect& effect, Display& display)
{
    constexpr int kIdles = 8;
    constexpr unsigned int kIdleMicroseconds = 20000;
    void* rectangle = nullptr;
    effect.dispatcher(&effect, effEditGetRect, 0, 0, static_cast<void*>(&rectangle), 0.0F);
    const Window window = XCreateSimpleWindow(&display, DefaultRootWindow(&display), 0, 0, 800, 600, 0, 0, 0);
    XMapRaised(&display, window);
    XSync(&display, False);
    void* parent = reinterpret_cast<void*>(static_cast<std::uintptr_t>(window));
    effect.dispatcher(&effect, effEditOpen, 0, 0, parent, 0.0F);
    for (int count = 0; count < kIdles; ++count)
    {
        effect.dispatcher(&effect, effEditIdle, 0, 0, nullptr, 0.0F);
        usleep(kIdleMicroseconds);
    }
    effect.dispatcher(&effect, effEditClose, 0, 0, nullptr, 0.0F);
    XDestroyWindow(&display, window);
    XSync(&display, False);
}

void Process(AEffect& effect)
{
    std::vector<std::vector<float>> samples(static_cast<std::size_t>(effect.numInputs + effect.numOutputs),
                                            std::vector<float>(kFrames));
    std::vector<float*> pointers;
    for (std::vector<float>& channel : samples)
    {
        pointers.push_back(channel.data());
    }
    effect.processReplacing(&effect, pointers.data(), pointers.data() + effect.numInputs, kFrames);
}

bool LiveOnce(VSTPluginMainProc entry, Display* display)
{
    AEffect* effect = entry(AnswerHost);
    if (effect == nullptr || effect->magic != kEffectMagic)
    {
        return false;
    }
    effect->dispatcher(effect, effOpen, 0, 0, nullptr, 0.0F);
    effect->dispatcher(effect, effSetSampleRate, 0, 0, nullptr, 48000.0F);
    effect->dispatcher(effect, effSetBlockSize, 0, kFrames, nullptr, 0.0F);
    effect->dispatcher(effect, effMainsChanged, 0, 1, nullptr, 0.0F);
    Process(*effect);
    if (display != nullptr && (effect->flags & effFlagsHasEditor) != 0)
    {
        ShowEditor(*effect, *display);
    }
    effect->dispatcher(effect, effMainsChanged, 0, 0, nullptr, 0.0F);
    effect->dispatcher(effect, effClose, 0, 0, nullptr, 0.0F);
    return true;
}

void Measure(VSTPluginMainProc entry, Display* display, int lives, const char* what)
{
    for (int count = 0; count < kWarmLives; ++count)
    {
        LiveOnce(entry, display);
    }
    const soak::Resources before = soak::MeasureResources();
    for (int count = 0; count < lives; ++count)
    {
        LiveOnce(entry, display);
    }
    const soak::Resources after = soak::MeasureResources();
    const double count = lives;
    std::cout << "  " << what << ": "
              << (static_cast<double>(after.inUse) - static_cast<double>(before.inUse)) / count
              << " bytes of the heap, "
              << (static_cast<double>(after.resident) - static_cast<double>(before.resident)) / count
              << " of resident memory, " << (after.descriptors - before.descriptors) / count << " descriptors, "
              << (after.threads - before.threads) / count << " threads a life" << std::endl;
}

// A module stays loaded, as in the library.
VSTPluginMainProc EntryOf(const char* path)
{
    void* module = dlopen(path, RTLD_LAZY | RTLD_LOCAL);
    void* symbol = module == nullptr ? nullptr : dlsym(module, "VSTPluginMain");
    if (module != nullptr && symbol == nullptr)
    {
        symbol = dlsym(module, "main");
    }
    return reinterpret_cast<VSTPluginMainProc>(symbol);
}

} // namespace

int main(int argc, char** argv)
{
    const int lives = argc > 2 ? std::atoi(argv[1]) : 0;
    if (lives < 1)
    {
        std::cerr << "usage: zeb_soak_direct LIVES FILE...\n";
        return 2;
    }
    XSetErrorHandler([](Display*, XErrorEvent*) { return 0; });
    Display* display = XOpenDisplay(nullptr);
    for (int index = 2; index < argc; ++index)
    {
        const VSTPluginMainProc entry = EntryOf(argv[index]);
        std::cout << argv[index] << (entry == nullptr ? ": no VST 2 plug-in" : "") << std::endl;
        if (entry != nullptr)
        {
            Measure(entry, nullptr, lives, "without editor");
            if (display != nullptr)
            {
                Measure(entry, display, lives, "with editor");
            }
        }
    }
    std::_Exit(0);
}
