#include "examples/effects/support/StateStream.h"

#include <bit>

namespace effects
{

void StateWriter::Write(double value)
{
    WriteBytes(std::bit_cast<uint64>(value), 8);
}

void StateWriter::WriteBytes(uint64 value, int32 size)
{
    std::array<uint8, 8> bytes{};
    for (std::size_t i = 0; i < bytes.size(); ++i)
        bytes[i] = static_cast<uint8>(value >> (8 * i));
    int32 written = 0;
    mFailed = mFailed || mStream->write(bytes.data(), size, &written) != kResultOk || written != size;
}

void StateReader::Read(double& value)
{
    value = std::bit_cast<double>(ReadBytes(8));
}

uint64 StateReader::ReadBytes(int32 size)
{
    std::array<uint8, 8> bytes{};
    int32 read = 0;
    mFailed = mFailed || mStream->read(bytes.data(), size, &read) != kResultOk || read != size;
    if (mFailed)
        return 0;
    uint64 value = 0;
    for (std::size_t i = 0; i < bytes.size(); ++i)
        value |= static_cast<uint64>(bytes[i]) << (8 * i);
    return value;
}

} // namespace effects
