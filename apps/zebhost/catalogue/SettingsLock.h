#pragma once

#include <filesystem>

namespace zebhost
{

// Two programs that change the same settings would undo each other's work. Held by whoever changes them; ends with
// the process, however that ends.
class SettingsLock
{
public:
    // Makes the folder. Throws a Failure if another program holds it for longer than a moment. On a file system
    // without locks there is none.
    explicit SettingsLock(const std::filesystem::path& folder);
    ~SettingsLock();
    SettingsLock(const SettingsLock&) = delete;
    SettingsLock& operator=(const SettingsLock&) = delete;

private:
    int mFolder;
};

} // namespace zebhost
