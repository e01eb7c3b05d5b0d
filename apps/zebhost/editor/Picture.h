#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace zebhost
{

// Rows from the top, three bytes a pixel: red, green, blue.
struct Picture
{
    int width = 0;
    int height = 0;
    std::vector<std::uint8_t> pixels;
};

// The picture as the bytes of a PNG file.
std::string ToPng(const Picture& picture);

} // namespace zebhost
