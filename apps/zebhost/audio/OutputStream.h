#pragma once

#include "audio/SoundFile.h"

namespace zebhost
{

// What libsndfile writes through. It passes over errors in some kinds of files: this keeps the first one.
class OutputStream
{
public:
    // The descriptor is open for writing, and stays the caller's.
    explicit OutputStream(int descriptor) : mDescriptor(descriptor) {}
    OutputStream(const OutputStream&) = delete;
    OutputStream& operator=(const OutputStream&) = delete;

    // Null if libsndfile refuses. What it returns does not outlive this.
    SoundFile Open(SF_INFO& info);
    // A system error number; 0 if all has been written.
    int Error() const { return mError; }

private:
    static sf_count_t Length(void* user);
    static sf_count_t Seek(sf_count_t offset, int origin, void* user);
    static sf_count_t Read(void* target, sf_count_t count, void* user);
    static sf_count_t Write(const void* source, sf_count_t count, void* user);
    static sf_count_t Tell(void* user);

    int mDescriptor;
    int mError = 0;
};

} // namespace zebhost
