#pragma once

#include "examples/effects/support/Vst3.h"

#include <atomic>
#include <tuple>
#include <type_traits>

namespace effects
{

// What every object that crosses the border to the host needs: it answers for the listed interfaces and counts its
// references. A new object has one reference, which belongs to whoever made it.
template <class... Interfaces>
class Implements : public Interfaces...
{
public:
    Implements() = default;
    Implements(const Implements&) = delete;
    Implements& operator=(const Implements&) = delete;
    virtual ~Implements() = default;

    tresult PLUGIN_API queryInterface(const TUID id, void** object) override
    {
        *object = nullptr;
        return (Answer<Interfaces>(id, object) || ...) ? kResultOk : kNoInterface;
    }

    uint32 PLUGIN_API addRef() override { return mReferences.fetch_add(1, std::memory_order_relaxed) + 1; }

    uint32 PLUGIN_API release() override
    {
        const uint32 left = mReferences.fetch_sub(1, std::memory_order_acq_rel) - 1;
        if (left == 0)
            delete this;
        return left;
    }

    FUnknown* AsUnknown() { return static_cast<std::tuple_element_t<0, std::tuple<Interfaces...>>*>(this); }

private:
    // An interface answers for itself and for what it derives from; the first one listed that can, does.
    template <class Interface>
    bool Answer(const TUID id, void** object)
    {
        bool same = Is<Interface>(id) || Is<FUnknown>(id);
        if constexpr (std::is_base_of_v<IPluginBase, Interface>)
            same = same || Is<IPluginBase>(id);
        if (!same)
            return false;
        addRef();
        *object = static_cast<Interface*>(this);
        return true;
    }

    template <class Interface>
    static bool Is(const TUID id)
    {
        return FUnknownPrivate::iidEqual(id, Interface::iid);
    }

    std::atomic<uint32> mReferences{1};
};

} // namespace effects
