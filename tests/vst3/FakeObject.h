// What the objects of a fake plug-in have in common.
#pragma once

#include "tests/vst3/FakePlugin.h"

#include <pluginterfaces/base/ibstream.h>

#include <algorithm>
#include <atomic>
#include <cstring>

namespace fakeplugin
{

inline bool Is(const TUID asked, const FUID& known)
{
    return FUnknownPrivate::iidEqual(asked, known);
}

// Gives `object` if `asked` is its interface.
template <class Interface>
bool Answer(const TUID asked, Interface* object, void** result)
{
    if (!Is(asked, Interface::iid))
        return false;
    object->addRef();
    *result = object;
    return true;
}

// Counts an object and tells the log when it dies.
class FakeCount
{
public:
    FakeCount(FakePlugin& plugin, const char* name) : mPlugin(plugin), mName(name) { ++mPlugin.livingObjects; }
    ~FakeCount()
    {
        --mPlugin.livingObjects;
        mPlugin.Call(std::string(mName) + " destroyed");
    }
    FakeCount(const FakeCount&) = delete;
    FakeCount& operator=(const FakeCount&) = delete;

    uint32 Add() { return ++mCount; }
    template <class Object>
    uint32 Release(Object* object)
    {
        const uint32 left = --mCount;
        if (left == 0)
            delete object;
        return left;
    }

private:
    FakePlugin& mPlugin;
    const char* mName;
    std::atomic<uint32> mCount{1};
};

template <std::size_t N>
void CopyText(char16 (&target)[N], const std::u16string& text)
{
    std::memset(target, 0, sizeof(target));
    std::memcpy(target, text.data(), std::min(N, text.size()) * sizeof(char16));
}

inline tresult WriteState(IBStream* stream, const std::string& state, tresult result)
{
    std::string copy = state;
    if (!copy.empty())
        stream->write(copy.data(), static_cast<int32>(copy.size()), nullptr);
    return result;
}

// Everything from the stream's position on.
inline std::string ReadState(IBStream* stream)
{
    std::string state;
    char piece[64];
    int32 count = 0;
    while (stream->read(piece, sizeof(piece), &count) == kResultOk && count > 0)
        state.append(piece, static_cast<std::size_t>(count));
    return state;
}

extern const FUID kComponentClass;
extern const FUID kControllerClass;

IComponent* MakeFakeComponent(FakePlugin& plugin);
IEditController* MakeFakeController(FakePlugin& plugin);
IPlugView* MakeFakeView(FakePlugin& plugin);

} // namespace fakeplugin
