#pragma once

#include "utility/src/Published.h"

#include <boost/function.hpp>

#include <map>

namespace zebaudiofilterhost::vst
{

/// Who answers the calls of plug-ins: handlers by the address of their owner, in the order of these addresses.
///
/// Changed on the main thread while others call: calling takes no lock, allocates nothing and waits for nobody. A
/// call that is under way goes on with the handlers that it found; these die at the first later change that
/// meets no call under way, or with the map. What a handler is bound to must outlive the calls by its own means.
class AudioMasterHandlerMap
{
public:
    using Handler = boost::function<long long(int opcode, int index, long long value, void* ptr, float opt)>;

    /// Whoever has a handler keeps the old one. [main]
    void Insert(const void* owner, const Handler& handler);
    /// An unknown owner is ignored. [main]
    void Erase(const void* owner);

    /// The answer of one owner's handler; 0 if it has none. [any]
    long long CallOne(const void* owner, int opcode, int index, long long value, void* ptr, float opt) const;
    /// The first answer that is not 0; 0 if there is none. [any]
    long long CallAll(int opcode, int index, long long value, void* ptr, float opt) const;

private:
    using Map = std::map<const void*, Handler>;

    void Replace(Map handlers);

    Published<Map> mHandlers;
};

} // namespace zebaudiofilterhost::vst
