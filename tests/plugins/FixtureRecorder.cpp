#include "tests/plugins/FixtureRecorder.h"

#include "tests/plugins/FixturePaths.h"

#include <algorithm>
#include <dlfcn.h>
#include <sstream>
#include <stdexcept>

namespace zebtest
{

namespace
{

void* Open(const std::filesystem::path& binary)
{
    void* handle = dlopen(binary.c_str(), RTLD_LAZY | RTLD_LOCAL);
    if (handle == nullptr)
        throw std::runtime_error(dlerror());
    return handle;
}

} // namespace

// The handle is never closed: the log must outlive the host's use of the bundle.
FixtureRecorder::FixtureRecorder(const std::filesystem::path& bundle) : mHandle(Open(BinaryOf(bundle)))
{
    Symbol<const char*()>("ZebFixtureCalls");
}

template <class Function>
Function* FixtureRecorder::Symbol(const char* name) const
{
    void* address = dlsym(mHandle, name);
    if (address == nullptr)
        throw std::runtime_error(std::string("no fixture: ") + name + " is missing");
    return reinterpret_cast<Function*>(address);
}

std::vector<std::string> FixtureRecorder::Calls() const
{
    std::istringstream text(Symbol<const char*()>("ZebFixtureCalls")());
    std::vector<std::string> lines;
    for (std::string line; std::getline(text, line);)
        lines.push_back(line);
    return lines;
}

std::vector<std::string> FixtureRecorder::CallsTo(std::string_view prefix) const
{
    auto lines = Calls();
    std::erase_if(lines, [prefix](const std::string& line) { return !line.starts_with(prefix); });
    return lines;
}

std::size_t FixtureRecorder::Count(std::string_view prefix) const
{
    return CallsTo(prefix).size();
}

void FixtureRecorder::Clear() const
{
    Symbol<void()>("ZebFixtureClear")();
}

int FixtureRecorder::LiveObjects() const
{
    return Symbol<int()>("ZebFixtureLiveObjects")();
}

void FixtureRecorder::SetRecording(bool on) const
{
    Symbol<void(int)>("ZebFixtureSetRecording")(on ? 1 : 0);
}

void FixtureRecorder::Set(const std::string& name, double value) const
{
    if (Symbol<int(const char*, double)>("ZebFixtureSet")(name.c_str(), value) == 0)
        throw std::invalid_argument("the fixture has no switch " + name);
}

double FixtureRecorder::Get(const std::string& name) const
{
    return Symbol<double(const char*)>("ZebFixtureGet")(name.c_str());
}

void FixtureRecorder::Reset() const
{
    Symbol<void()>("ZebFixtureReset")();
}

std::string FixtureRecorder::Do(const std::string& command) const
{
    return Symbol<const char*(const char*)>("ZebFixtureDo")(command.c_str());
}

FixtureRecorder RecorderOf(const std::filesystem::path& bundle)
{
    return FixtureRecorder(bundle);
}

} // namespace zebtest
