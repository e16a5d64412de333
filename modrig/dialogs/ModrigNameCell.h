// A cell of a table that ends a text in an ellipsis when it does not fit.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigNameCell : NSTextFieldCell

// Makes the cells of the column such cells, where the toolkit's own only cut the text off.
+ (void)adoptIn:(NSTableColumn*)column;

// As much of its text as there is room for.
- (NSString*)textIn:(CGFloat)width;

@end
