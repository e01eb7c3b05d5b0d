// bench_peer_scan FOLDER LIST: what an application of the peer does to know the VST 3 plug-ins in a folder: reads its
// list, scans what is new, with a note of the plug-in at hand in case it crashes, and writes the list.
#include <juce_audio_processors/juce_audio_processors.h>

#include <cstdio>

int main(int argc, char** argv)
{
    if (argc != 3)
    {
        std::fputs("usage: bench_peer_scan FOLDER LIST\n", stderr);
        return 2;
    }
    const juce::ScopedJuceInitialiser_GUI initialiser;
    juce::KnownPluginList list;
    const juce::File file(juce::String::fromUTF8(argv[2]));
    if (const auto known = juce::parseXML(file))
        list.recreateFromXml(*known);
    juce::VST3PluginFormat format;
    juce::PluginDirectoryScanner scanner(list, format, juce::FileSearchPath(juce::String::fromUTF8(argv[1])), true,
                                         file.getSiblingFile("scanning"));
    juce::String name;
    while (scanner.scanNextFile(true, name))
    {
    }
    if (!list.createXml()->writeTo(file))
        return 1;
    std::printf("%d\n", list.getNumTypes());
    return 0;
}
