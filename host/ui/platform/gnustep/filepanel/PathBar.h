// A row of buttons for the folders on the way, from the root to the one that shows. The Tab key comes to one
// of them, from which the arrows lead to the others.
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
