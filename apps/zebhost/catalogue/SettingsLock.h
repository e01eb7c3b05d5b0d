#pragma once

#include <filesystem>
#include <memory>

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
    // Neither waits nor throws; null if that cannot be had for certain.
    static std::unique_ptr<SettingsLock> IfFree(const std::filesystem::path& folder);
    ~SettingsLock();
    SettingsLock(const SettingsLock&) = delete;
    SettingsLock& operator=(const SettingsLock&) = delete;

private:
    explicit SettingsLock(int folder) : mFolder(folder) {}

    int mFolder;
};

} // namespace zebhost
