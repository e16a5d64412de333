// The cell of a file's name, with its icon.
#pragma once

#import <AppKit/AppKit.h>

@interface TsFileNameCell : NSTextFieldCell
{
    NSImage* mIcon; // not retained: the icons of the family last as long as the program
}
- (void)setFileIcon:(NSImage*)icon;
@end
