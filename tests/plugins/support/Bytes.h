#pragma once

#include "examples/effects/support/Vst3.h"

#include <string>
#include <string_view>

namespace fixture
{

using namespace Steinberg;

uint32 Hash(std::string_view bytes); // 32-bit FNV-1a

// All that the stream has from where it stands.
std::string ReadAll(IBStream* stream);

tresult WriteAll(IBStream* stream, const std::string& bytes);

// So many bytes of a pattern without a short period.
std::string Pattern(std::size_t size);

// "24 hash=1a2b3c4d" for a record.
std::string Summary(std::string_view bytes);

} // namespace fixture
