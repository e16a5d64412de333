// A row for a folder on the way to files. A file panel may have it chosen as it has files; nothing is loaded
// from it, and as many are walked through, none of them is worth a message.
#pragma once

#import "modrig/dialogs/ModrigFilePath.h"

@interface ModrigFolderPath : ModrigFilePath

@end
