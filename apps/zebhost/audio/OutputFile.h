#pragma once

#include <filesystem>
#include <string>

namespace zebhost
{

// A file that appears under its name when it is complete, or not at all: it is written under another name in the same
// folder.
class OutputFile
{
public:
    // Throws a Failure when the file exists and may not be replaced, or cannot be made.
    OutputFile(const std::string& path, bool overwrite);
    ~OutputFile();
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;

    // Open for writing; stays this object's.
    int Descriptor() const { return mDescriptor; }
    // As the user gave it.
    const std::string& Path() const { return mPath; }

    // Gives the file its name. Throws a Failure when that fails, or when another file has taken the name meanwhile.
    void Commit();

private:
    [[noreturn]] void Refuse(const std::string& action) const;
    void RefuseExisting() const;
    void Rename() const;

    std::string mPath;
    std::filesystem::path mTarget;
    std::string mTemporary;
    bool mOverwrite;
    int mDescriptor = -1;
};

} // namespace zebhost
