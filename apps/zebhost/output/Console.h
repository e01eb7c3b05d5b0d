#pragma once

#include <cstdio>
#include <string>
#include <string_view>

namespace zebhost
{

// The two streams. Data goes to standard output, everything else to standard error.
//
// From its construction on the process's own standard output is standard error: what plug-ins print there cannot get
// into the data, for which a private descriptor is kept.
class Console
{
public:
    Console();
    ~Console();
    Console(const Console&) = delete;
    Console& operator=(const Console&) = delete;

    void SetQuiet(bool quiet) { mQuiet = quiet; }
    bool IsQuiet() const { return mQuiet; }

    // Data, as it stands.
    void Print(std::string_view text);
    bool HasPrinted() const { return mHasPrinted; }
    // A line on standard error, unless quiet.
    void Remark(std::string_view text);
    // A line on standard error in any case.
    void Warn(std::string_view text);

    // What stands in the last line of a terminal until the next line of any kind; without a terminal, nothing.
    void ShowProgress(std::string_view text);

    // Whether everything printed has reached its reader.
    bool Flush();

    bool IsErrorTerminal() const { return mErrorTerminal; }
    bool HasOutputColour() const { return mOutputColour; }
    std::size_t OutputWidth() const;
    std::size_t ErrorWidth() const;
    int OutputDescriptor() const;

private:
    void EraseProgress();

    std::FILE* mOutput;
    bool mQuiet = false;
    bool mErrorTerminal;
    bool mOutputColour;
    bool mProgressShown = false;
    bool mHasPrinted = false;
};

} // namespace zebhost
