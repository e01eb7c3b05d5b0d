#include "Options.h"

#include <cstdlib>
#include <iostream>
#include <random>

#include <getopt.h>

namespace soak
{

namespace
{

[[noreturn]] void EndWithHelp()
{
    std::cerr << "usage: zeb_soak [--seconds N] [--operations N] [--random-start N] [--every SECONDS] [--only TEXT]\n"
                 "                [--leave-out TEXT]... [--without-editors] [--without-editor-of PART OF PATH]... "
                 "[--json FILE] [--log FILE]\n"
                 "The folders are those of VST3_PATH, VST_PATH and AUDIO_COMPONENT_PATH.\n";
    std::exit(2);
}

std::uint64_t NewRandomStart()
{
    return std::random_device()() + 1ULL;
}

void Take(Options& options, int letter)
{
    switch (letter)
    {
    case 't':
        options.seconds = std::atoi(optarg);
        break;
    case 'n':
        options.operations = std::strtoul(optarg, nullptr, 10);
        break;
    case 's':
        options.randomStart = std::strtoull(optarg, nullptr, 10);
        break;
    case 'e':
        options.everySeconds = std::atoi(optarg);
        break;
    case 'o':
        options.only = optarg;
        break;
    case 'x':
        options.leftOut.emplace_back(optarg);
        break;
    case 'w':
        options.withEditors = false;
        break;
    case 'p':
        options.withoutEditorOf.emplace_back(optarg);
        break;
    case 'j':
        options.json = optarg;
        break;
    case 'l':
        options.log = optarg;
        break;
    default:
        EndWithHelp();
    }
}

} // namespace

Options ReadOptions(int argc, char** argv)
{
    const option known[] = {{"seconds", required_argument, nullptr, 't'},
                            {"operations", required_argument, nullptr, 'n'},
                            {"random-start", required_argument, nullptr, 's'},
                            {"every", required_argument, nullptr, 'e'},
                            {"only", required_argument, nullptr, 'o'},
                            {"leave-out", required_argument, nullptr, 'x'},
                            {"without-editors", no_argument, nullptr, 'w'},
                            {"without-editor-of", required_argument, nullptr, 'p'},
                            {"json", required_argument, nullptr, 'j'},
                            {"log", required_argument, nullptr, 'l'},
                            {nullptr, 0, nullptr, 0}};
    Options options;
    for (int letter = 0; (letter = getopt_long(argc, argv, "", known, nullptr)) != -1;)
    {
        Take(options, letter);
    }
    if (optind != argc || options.seconds < 1 || options.everySeconds < 1)
    {
        EndWithHelp();
    }
    if (options.randomStart == 0)
    {
        options.randomStart = NewRandomStart();
    }
    return options;
}

} // namespace soak
