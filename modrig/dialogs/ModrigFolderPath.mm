#import "modrig/dialogs/ModrigFolderPath.h"

#include "modrig/loader/LoadedApplications.h"

@implementation ModrigFolderPath

// Most folders have no dot in their paths, of which a file's row tells in a message box.
- (BOOL)findUnloadable:(const CStdStr&)path
{
    return ModrigUtils::CouldBeUnloaded(path);
}

@end
