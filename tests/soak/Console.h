#pragma once

#include <string>

namespace soak
{

/// Where the run's own lines go: the standard output of the start. What plug-ins print goes to a file.
class Console
{
public:
    /// An empty path drops what plug-ins print.
    explicit Console(const std::string& log);
    ~Console();
    Console(const Console&) = delete;
    Console& operator=(const Console&) = delete;

    void Say(const std::string& line) const;
    int Descriptor() const { return mDescriptor; }

private:
    int mDescriptor;
};

} // namespace soak
