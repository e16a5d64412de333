#include "host/ui/Words.h"
#include "host/ui/platform/Windowing.h"
#import "host/ui/platform/gnustep/filepanel/FilePanel.h"

#include <tesselui/tsuifilepanel.h>

// The name is completed by what lies in the folder, which has to be listed before.
NSString* tessel::windowing::chooseFile(NSString* folder, NSString* name, bool mayBeNew)
{
    auto* panel = (TsUIFilePanel*)tsuiMakeFilePanel();
    [panel setTitle:word(@"CHOOSE_FILE_TITLE")];
    [panel setPrompt:word(@"CHOOSE")];
    [panel setTakesNewNames:mayBeNew];
    [panel setDirectory:folder];
    static_cast<void>([panel filenames]);
    if ([name length])
        [panel beginTyping:name];
    return [panel runModal] == NSModalResponseOK ? [panel filename] : nil;
}
