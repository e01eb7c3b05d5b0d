#pragma once

#include <memory>
#include <string>

namespace zebaudiofilterhost::benchmarks
{

/// The peer host's list of known plug-ins. Texts are UTF-8. [main]
class PeerCatalogue
{
public:
    struct Plugin
    {
        std::string name;
        std::string vendor;
        std::string version;
        std::string category;
        std::string path;
        int id = 0;
    };

    PeerCatalogue();
    ~PeerCatalogue();

    PeerCatalogue(const PeerCatalogue&) = delete;
    PeerCatalogue& operator=(const PeerCatalogue&) = delete;

    void Add(const Plugin& plugin);
    int Size() const;
    /// The name of the plug-in at that path, or an empty text.
    std::string FindName(const std::string& path) const;

    /// As an application of the peer keeps its list. False if the file cannot be written, or read.
    bool Save(const std::string& file) const;
    bool Load(const std::string& file);

private:
    struct Impl;

    std::unique_ptr<Impl> mImpl;
};

} // namespace zebaudiofilterhost::benchmarks
