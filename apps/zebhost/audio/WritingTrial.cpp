#include "audio/WritingTrial.h"

#include "audio/SoundFile.h"

#include <algorithm>
#include <cstdio>
#include <vector>

namespace zebhost
{

namespace
{

struct Memory
{
    std::vector<char> bytes;
    sf_count_t position = 0;
};

Memory& MemoryOf(void* user)
{
    return *static_cast<Memory*>(user);
}

sf_count_t Length(void* user)
{
    return static_cast<sf_count_t>(MemoryOf(user).bytes.size());
}

sf_count_t Seek(sf_count_t offset, int origin, void* user)
{
    Memory& memory = MemoryOf(user);
    const sf_count_t from = origin == SEEK_SET ? 0 : origin == SEEK_CUR ? memory.position : Length(user);
    memory.position = std::max<sf_count_t>(from + offset, 0);
    return memory.position;
}

sf_count_t Read(void* target, sf_count_t count, void* user)
{
    Memory& memory = MemoryOf(user);
    const sf_count_t length = std::clamp<sf_count_t>(Length(user) - memory.position, 0, count);
    std::copy_n(memory.bytes.data() + memory.position, length, static_cast<char*>(target));
    memory.position += length;
    return length;
}

sf_count_t Write(const void* source, sf_count_t count, void* user)
{
    Memory& memory = MemoryOf(user);
    const sf_count_t end = memory.position + count;
    memory.bytes.resize(static_cast<std::size_t>(std::max(end, Length(user))));
    std::copy_n(static_cast<const char*>(source), count, memory.bytes.data() + memory.position);
    memory.position = end;
    return count;
}

sf_count_t Tell(void* user)
{
    return MemoryOf(user).position;
}

} // namespace

bool IsWritable(const SF_INFO& info)
{
    constexpr sf_count_t kFrames = 4096; // more than a packet of any coding
    SF_INFO wanted = info;
    // The head of a Sound Designer file is another file beside it.
    const bool isInTwo = (info.format & SF_FORMAT_TYPEMASK) == SF_FORMAT_SD2;
    if (isInTwo || sf_format_check(&wanted) != SF_TRUE)
    {
        return false;
    }
    Memory memory;
    SF_VIRTUAL_IO access = {Length, Seek, Read, Write, Tell};
    const SoundFile file(sf_open_virtual(&access, SFM_WRITE, &wanted, &memory));
    const std::vector<float> silence(static_cast<std::size_t>(kFrames * info.channels));
    return file != nullptr && sf_writef_float(file.get(), silence.data(), kFrames) == kFrames;
}

} // namespace zebhost
