#pragma once

#include "catalogue/IScanObserver.h"

#include <foundation/zebcore/StringTypes.h>

#include <optional>
#include <string>
#include <string_view>

// What the scan and its worker process say to one another: JSON, one message a line. The worker says that it is
// ready, is sent one locator after the other, and answers each with any number of steps and a result. Whatever else
// arrives was written by a plug-in that went astray.
namespace zebhost::protocol
{

struct Message
{
    enum class Kind
    {
        Ready,
        Step,
        Result,
        Nonsense
    };
    Kind kind = Kind::Nonsense;
    std::string detail; // of a step: which filter of the plug-in
    IScanObserver::Outcome outcome;
    zebcore::UTF8String found; // of a result: the records and descriptors as the catalogue's file holds them
};

// All lines with their line end.
std::string ScanLine(const zebaudiofilterhost::PluginLocator& locator);
std::string ReadyLine();
std::string StepLine(std::string_view detail);
std::string ResultLine(const IScanObserver::Outcome& outcome, const zebcore::UTF8String& found);

std::optional<zebaudiofilterhost::PluginLocator> ParseScan(const std::string& line);
Message ParseMessage(const std::string& line);

} // namespace zebhost::protocol
