// A button whose tip depends on what it could do at the moment: its target is asked when the tip shows.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigTipButton : NSButton
@end

@interface NSObject (ModrigTipButtonTarget)

- (NSString*)tipOfButton:(NSButton*)button;

@end
