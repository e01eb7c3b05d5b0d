#pragma once

#include "audiofilter/AudioFilter.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <string>

namespace zebaudiofilterhost::benchmarks
{

/// The bundle of the effect whose state is as long as one likes.
std::string StateBundle();

/// A new effect of it through our library, with a state of so many bytes. Throws if there is none. [main]
boost::intrusive_ptr<AudioFilter> MakeStateFilter(int bytes);

} // namespace zebaudiofilterhost::benchmarks
