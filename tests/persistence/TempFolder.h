#pragma once

#include "foundation/zebcore/Dir.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/NativePath.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>

// A folder of a test's own, removed at its end.
class TempFolder
{
public:
    TempFolder() : mPath((std::filesystem::temp_directory_path() / "zeb-test-XXXXXX").string())
    {
        if (mkdtemp(mPath.data()) == nullptr)
            throw std::runtime_error("no temporary folder");
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;
    ~TempFolder()
    {
        std::error_code ignored;
        std::filesystem::remove_all(mPath, ignored);
    }

    std::filesystem::path Path(const std::string& name = {}) const
    {
        return name.empty() ? std::filesystem::path(mPath) : std::filesystem::path(mPath) / name;
    }

    zebcore::filesupport::Dir Dir() const
    {
        return zebcore::filesupport::Dir(zebcore::filesupport::FromNativePath(mPath));
    }

    zebcore::filesupport::File File(const std::string& name) const
    {
        return zebcore::filesupport::File(zebcore::filesupport::FromNativePath(Path(name).string()));
    }

    void Write(const std::string& name, const std::string& content) const
    {
        std::ofstream(Path(name), std::ios::binary) << content;
    }

    std::string Read(const std::string& name) const
    {
        std::ifstream file(Path(name), std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    std::size_t CountFiles() const
    {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(mPath), {}));
    }

private:
    std::string mPath;
};
