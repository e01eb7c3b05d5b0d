#include "benchmarks/peer/PeerCatalogue.h"

#include <juce_audio_processors/juce_audio_processors.h>

namespace zebaudiofilterhost::benchmarks
{

struct PeerCatalogue::Impl
{
    juce::KnownPluginList list;
};

PeerCatalogue::PeerCatalogue() : mImpl(std::make_unique<Impl>())
{
}

PeerCatalogue::~PeerCatalogue() = default;

void PeerCatalogue::Add(const Plugin& plugin)
{
    juce::PluginDescription description;
    description.name = juce::String::fromUTF8(plugin.name.c_str());
    description.descriptiveName = description.name;
    description.pluginFormatName = "VST3";
    description.category = juce::String::fromUTF8(plugin.category.c_str());
    description.manufacturerName = juce::String::fromUTF8(plugin.vendor.c_str());
    description.version = juce::String::fromUTF8(plugin.version.c_str());
    description.fileOrIdentifier = juce::String::fromUTF8(plugin.path.c_str());
    description.deprecatedUid = plugin.id;
    description.uniqueId = plugin.id;
    description.numInputChannels = 2;
    description.numOutputChannels = 2;
    mImpl->list.addType(description);
}

int PeerCatalogue::Size() const
{
    return mImpl->list.getNumTypes();
}

std::string PeerCatalogue::FindName(const std::string& path) const
{
    const auto found = mImpl->list.getTypeForFile(juce::String::fromUTF8(path.c_str()));
    return found == nullptr ? std::string() : found->name.toStdString();
}

bool PeerCatalogue::Save(const std::string& file) const
{
    return mImpl->list.createXml()->writeTo(juce::File(file));
}

bool PeerCatalogue::Load(const std::string& file)
{
    const auto document = juce::parseXML(juce::File(file));
    if (document == nullptr)
    {
        return false;
    }
    mImpl->list.recreateFromXml(*document);
    return true;
}

} // namespace zebaudiofilterhost::benchmarks
