// A cell of the dialogs' tables: grey where its row is, and with an ellipsis where its text does not fit.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigNameCell : NSTextFieldCell

// As much of its text as there is room for.
- (NSString*)textIn:(CGFloat)width;

@end
