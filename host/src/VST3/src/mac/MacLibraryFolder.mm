#include "host/src/VST3/src/mac/MacLibraryFolder.h"

#include "foundation/zebcore/NativePath.h"

#import <Foundation/Foundation.h>

namespace zebaudiofilterhost::vst3
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

} // namespace zebaudiofilterhost::vst3
