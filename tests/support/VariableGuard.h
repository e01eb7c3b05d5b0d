#pragma once

#include <cstdlib>
#include <optional>
#include <string>

namespace zebtest
{

// An environment variable that comes back as it was.
class VariableGuard
{
public:
    VariableGuard(const char* name, const std::string& value) : mName(name)
    {
        if (const char* old = std::getenv(name))
            mOld = old;
        setenv(name, value.c_str(), 1);
    }
    ~VariableGuard()
    {
        if (mOld)
            setenv(mName, mOld->c_str(), 1);
        else
            unsetenv(mName);
    }
    VariableGuard(const VariableGuard&) = delete;
    VariableGuard& operator=(const VariableGuard&) = delete;

private:
    const char* mName;
    std::optional<std::string> mOld;
};

} // namespace zebtest
