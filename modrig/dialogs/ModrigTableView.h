// A table of the dialogs as a person expects one: keys, a menu on its rows, going to a row by its first
// letters. Its owner, the delegate, knows what can be done with the rows.
#pragma once

#import <AppKit/AppKit.h>

#include "modrig/dialogs/model/RowLook.h"

namespace ModrigUtils
{
// The key that opens a help page, as buttons have it.
NSString* HelpKey();
} // namespace ModrigUtils

@interface ModrigTableView : NSTableView

// Does what the key stands for, and answers NO when it stands for nothing here. A key that cannot act beeps.
- (BOOL)takeKey:(NSEvent*)event;

// Grey for a row that is of no use.
- (NSColor*)textColorOfRow:(NSInteger)row;
// What the tip of a row says: its whole path, and why it is grey.
- (NSString*)tipForRow:(NSInteger)row;
// How all rows are at the moment.
- (std::vector<ModrigUtils::RowState>)states;

@end

@interface NSObject (ModrigTableOwner)

- (ModrigUtils::TableKind)kindOfTable:(NSTableView*)table;
- (NSArrayController*)rowsOf:(NSTableView*)table;
// Actions that are the owner's: all but copying, showing and selecting.
- (void)perform:(ModrigUtils::TableAction)action inTable:(NSTableView*)table;

@end
