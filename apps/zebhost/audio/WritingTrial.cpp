#include "audio/WritingTrial.h"

#include "audio/SoundFile.h"

#include <algorithm>
#include <cstdio>
#include <vector>

namespace zebhost
{

namespace
{

class Memory
{
public:
    static SF_VIRTUAL_IO Access() { return {Length, Seek, Read, Write, Tell}; }

private:
    static Memory& Of(void* user) { return *static_cast<Memory*>(user); }

    static sf_count_t Length(void* user) { return static_cast<sf_count_t>(Of(user).mBytes.size()); }

    static sf_count_t Seek(sf_count_t offset, int origin, void* user)
    {
        Memory& memory = Of(user);
        const sf_count_t from = origin == SEEK_SET ? 0 : origin == SEEK_CUR ? memory.mPosition : Length(user);
        memory.mPosition = std::max<sf_count_t>(from + offset, 0);
        return memory.mPosition;
    }

    static sf_count_t Read(void* target, sf_count_t count, void* user)
    {
        Memory& memory = Of(user);
        const sf_count_t length = std::clamp<sf_count_t>(Length(user) - memory.mPosition, 0, count);
        std::copy_n(memory.mBytes.data() + memory.mPosition, length, static_cast<char*>(target));
        memory.mPosition += length;
        return length;
    }

    static sf_count_t Write(const void* source, sf_count_t count, void* user)
    {
        Memory& memory = Of(user);
        const sf_count_t end = memory.mPosition + count;
        memory.mBytes.resize(static_cast<std::size_t>(std::max(end, Length(user))));
        std::copy_n(static_cast<const char*>(source), count, memory.mBytes.data() + memory.mPosition);
        memory.mPosition = end;
        return count;
    }

    static sf_count_t Tell(void* user) { return Of(user).mPosition; }

    std::vector<char> mBytes;
    sf_count_t mPosition = 0;
};

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
    SF_VIRTUAL_IO access = Memory::Access();
    const SoundFile file(sf_open_virtual(&access, SFM_WRITE, &wanted, &memory));
    const std::vector<float> silence(static_cast<std::size_t>(kFrames * info.channels));
    return file != nullptr && sf_writef_float(file.get(), silence.data(), kFrames) == kFrames;
}

} // namespace zebhost
