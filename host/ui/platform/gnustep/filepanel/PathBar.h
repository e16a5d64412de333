// A row of buttons for the folders on the way, from the root to the one that shows.
#pragma once

#import <AppKit/AppKit.h>

@interface TsPathBar : NSView
{
    NSString* mFolder;
    id mTarget;
    SEL mAction;
}

// The action of every button, whose cell has the folder's path as its represented object.
- (void)setTarget:(id)target action:(SEL)action;

- (void)showFolder:(NSString*)folder;

@end
