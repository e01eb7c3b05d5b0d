#pragma once

#include "examples/effects/support/Implements.h"
#include "tests/plugins/support/Behaviour.h"
#include "tests/plugins/support/Recorder.h"

#include <algorithm>

namespace fixture
{

// An object of a fixture: counted while it lives, and without the interfaces that its bundle hides.
template <class... Interfaces>
class FixtureObject : public Implements<Interfaces...>
{
public:
    FixtureObject() { CountLiveObject(1); }
    ~FixtureObject() override { CountLiveObject(-1); }

    tresult PLUGIN_API queryInterface(const TUID id, void** object) override
    {
        const auto& hidden = TheBehaviour().hiddenInterfaces;
        if (std::find(hidden.begin(), hidden.end(), FUID::fromTUID(id)) == hidden.end())
            return Implements<Interfaces...>::queryInterface(id, object);
        *object = nullptr;
        return kNoInterface;
    }
};

} // namespace fixture
