#include "host/src/VST/src/AudioMasterHandlerMap.h"

#include <utility>

namespace zebaudiofilterhost::vst
{

void AudioMasterHandlerMap::Insert(const void* owner, const Handler& handler)
{
    Map handlers = *Published<Map>::Reader(mHandlers);
    if (handlers.try_emplace(owner, handler).second)
        Replace(std::move(handlers));
}

void AudioMasterHandlerMap::Erase(const void* owner)
{
    Map handlers = *Published<Map>::Reader(mHandlers);
    if (handlers.erase(owner) != 0)
        Replace(std::move(handlers));
}

void AudioMasterHandlerMap::Replace(Map handlers)
{
    mHandlers.Publish(std::move(handlers));
    mHandlers.FreeRetired();
}

long long AudioMasterHandlerMap::CallOne(const void* owner, int opcode, int index, long long value, void* ptr,
                                         float opt) const
{
    const Published<Map>::Reader handlers(mHandlers);
    const auto found = handlers->find(owner);
    return found == handlers->end() ? 0 : found->second(opcode, index, value, ptr, opt);
}

long long AudioMasterHandlerMap::CallAll(int opcode, int index, long long value, void* ptr, float opt) const
{
    const Published<Map>::Reader handlers(mHandlers);
    for (const auto& [owner, handler] : *handlers)
    {
        if (const long long answer = handler(opcode, index, value, ptr, opt); answer != 0)
            return answer;
    }
    return 0;
}

} // namespace zebaudiofilterhost::vst
