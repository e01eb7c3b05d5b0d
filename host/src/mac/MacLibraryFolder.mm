#include "host/src/mac/MacLibraryFolder.h"

#include "foundation/zebcore/NativePath.h"

#import <Foundation/Foundation.h>

#include <array>

namespace zebaudiofilterhost
{

namespace
{

constexpr std::size_t kPathRoom = 4096; // bytes, with the terminating zero

} // namespace

Dir GetMacLibraryFolder(bool user)
{
    @autoreleasepool
    {
        NSURL* url = [[NSFileManager defaultManager] URLForDirectory:NSLibraryDirectory
                                                            inDomain:user ? NSUserDomainMask : NSLocalDomainMask
                                                   appropriateForURL:nil
                                                              create:NO
                                                               error:nil];
        std::array<char, kPathRoom> path = {};
        if (![url getFileSystemRepresentation:path.data() maxLength:path.size()]) // NO of no URL, too
            return Dir();
        return Dir(zebcore::filesupport::FromNativePath(path.data()));
    }
}

} // namespace zebaudiofilterhost
