#pragma once

#include <utility>

namespace zebaudiofilterhost::vst3
{

/// Calls a function at the end of a scope, however it is left. The function must not throw.
template <class Function>
class ScopeExit
{
public:
    explicit ScopeExit(Function function) : mFunction(std::move(function)) {}
    ~ScopeExit() { mFunction(); }
    ScopeExit(const ScopeExit&) = delete;
    ScopeExit& operator=(const ScopeExit&) = delete;

private:
    Function mFunction;
};

} // namespace zebaudiofilterhost::vst3
