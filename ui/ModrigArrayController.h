// The rows of a table, or the choices of a pop-up. On every platform it behaves as the toolkit documents for
// NSArrayController: inserts where it is told, keeps the selected objects selected when others come and go,
// and starts empty, with nothing selected. Rows are neither sorted nor filtered.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigArrayController : NSArrayController
{
    NSTableView* mTable;
}

// The table to tell of other rows, where it is not bound to them. It is not retained.
- (void)setTable:(NSTableView*)table;

@end
