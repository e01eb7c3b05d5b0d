#include "host/src/mac/MacLibraryFolder.h"

#include "foundation/zebcore/NativePath.h"

#import <Foundation/Foundation.h>

namespace zebaudiofilterhost
{

Dir GetMacLibraryFolder(bool user)
{
    @autoreleasepool
    {
        NSURL* url = [[NSFileManager defaultManager] URLForDirectory:NSLibraryDirectory
                                                            inDomain:user ? NSUserDomainMask : NSLocalDomainMask
                                                   appropriateForURL:nil
                                                              create:NO
                                                               error:nil];
        if (url == nil)
            return Dir();
        return Dir(zebcore::filesupport::FromNativePath([[url path] fileSystemRepresentation]));
    }
}

} // namespace zebaudiofilterhost
