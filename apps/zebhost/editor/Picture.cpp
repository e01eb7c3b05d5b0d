#include "editor/Picture.h"

#include <algorithm>
#include <string_view>

namespace zebhost
{

namespace
{

std::string BigEndian(std::uint32_t value)
{
    std::string bytes;
    for (unsigned int shift = 32; shift > 0; shift -= 8)
    {
        bytes += static_cast<char>((value >> (shift - 8)) & 0xFFU);
    }
    return bytes;
}

std::uint32_t Crc(std::string_view bytes)
{
    std::uint32_t crc = 0xFFFFFFFF;
    for (const char byte : bytes)
    {
        crc ^= static_cast<std::uint8_t>(byte);
        for (int bit = 0; bit < 8; ++bit)
        {
            crc = (crc >> 1U) ^ ((crc & 1U) != 0 ? 0xEDB88320U : 0U);
        }
    }
    return ~crc;
}

std::uint32_t Adler(std::string_view bytes)
{
    constexpr std::uint32_t kModulus = 65521;
    std::uint32_t low = 1;
    std::uint32_t high = 0;
    for (const char byte : bytes)
    {
        low = (low + static_cast<std::uint8_t>(byte)) % kModulus;
        high = (high + low) % kModulus;
    }
    return (high << 16U) | low;
}

std::string Chunk(std::string_view type, const std::string& data)
{
    const std::string body = std::string(type) + data;
    return BigEndian(static_cast<std::uint32_t>(data.size())) + body + BigEndian(Crc(body));
}

// Deflate's stored form: no compression, and no library for it.
std::string Stored(const std::string& bytes)
{
    constexpr std::size_t kMost = 65535;
    std::string stream("\x78\x01", 2);
    std::size_t at = 0;
    do
    {
        const std::size_t count = std::min(kMost, bytes.size() - at);
        const bool isLast = at + count == bytes.size();
        stream += isLast ? '\x01' : '\x00';
        for (const std::size_t length : {count, ~count})
        {
            stream += static_cast<char>(length & 0xFFU);
            stream += static_cast<char>((length >> 8U) & 0xFFU);
        }
        stream.append(bytes, at, count);
        at += count;
    } while (at < bytes.size());
    return stream + BigEndian(Adler(bytes));
}

} // namespace

std::string ToPng(const Picture& picture)
{
    const auto rowBytes = static_cast<std::size_t>(picture.width) * 3;
    std::string rows;
    for (std::size_t row = 0; row < static_cast<std::size_t>(picture.height); ++row)
    {
        rows += '\0'; // no filter
        rows.append(reinterpret_cast<const char*>(picture.pixels.data()) + row * rowBytes, rowBytes);
    }
    const std::string head = BigEndian(static_cast<std::uint32_t>(picture.width)) +
                             BigEndian(static_cast<std::uint32_t>(picture.height)) +
                             std::string("\x08\x02\x00\x00\x00", 5);
    return "\x89PNG\r\n\x1a\n" + Chunk("IHDR", head) + Chunk("IDAT", Stored(rows)) + Chunk("IEND", {});
}

} // namespace zebhost
