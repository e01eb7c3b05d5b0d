#pragma once

#include <sndfile.h>

#include <memory>
#include <string>

namespace zebhost
{

struct SoundFileCloser
{
    void operator()(SNDFILE* file) const { sf_close(file); }
};
using SoundFile = std::unique_ptr<SNDFILE, SoundFileCloser>;

// What libsndfile says of the last call on `file`, to stand in brackets: null means the last file that could not be
// opened. Empty if nothing is wrong.
std::string SoundFileError(SNDFILE* file);

// Whether the head of a file that was opened for reading speaks of more than the file has. libsndfile reads such
// files up to their end without an error, and says so in its log alone.
bool HeadTellsMore(SNDFILE* file);

} // namespace zebhost
