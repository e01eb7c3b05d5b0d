#include "tests/plugins/support/Bytes.h"

#include <array>
#include <charconv>

namespace fixture
{

uint32 Hash(std::string_view bytes)
{
    uint32 hash = 2166136261U;
    for (const char byte : bytes)
        hash = (hash ^ static_cast<unsigned char>(byte)) * 16777619U;
    return hash;
}

std::string ReadAll(IBStream* stream)
{
    std::string bytes;
    std::array<char, 65536> chunk{};
    int32 read = 0;
    while (stream->read(chunk.data(), static_cast<int32>(chunk.size()), &read) == kResultOk && read > 0)
        bytes.append(chunk.data(), static_cast<std::size_t>(read));
    return bytes;
}

tresult WriteAll(IBStream* stream, const std::string& bytes)
{
    if (bytes.empty())
        return kResultOk;
    std::string copy = bytes; // the interface takes no constant
    return stream->write(copy.data(), static_cast<int32>(copy.size()), nullptr);
}

std::string Pattern(std::size_t size)
{
    std::string bytes(size, '\0');
    uint32 value = 1;
    for (char& byte : bytes)
    {
        value = value * 1664525U + 1013904223U;
        byte = static_cast<char>(value >> 24);
    }
    return bytes;
}

std::string Summary(std::string_view bytes)
{
    std::array<char, 16> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), Hash(bytes), 16).ptr;
    return std::to_string(bytes.size()) + " hash=" + std::string(text.data(), end);
}

} // namespace fixture
