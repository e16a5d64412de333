// The rows of a table, or the choices of a pop-up. On every platform it behaves as the toolkit documents for
// NSArrayController: inserts where it is told, keeps the selected objects selected when others come and go,
// and starts empty, with nothing selected. Rows are neither sorted nor filtered.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigArrayController : NSArrayController
{
    NSTableView* mTable;
    NSMutableSet* mKnown;
}

// The table to tell of other rows, where it is not bound to them. It is not retained.
- (void)setTable:(NSTableView*)table;

@end

// ModrigArrayController+Membership.mm
@interface ModrigArrayController (Membership)

// Whether a row is equal to the object. Takes no longer with many rows than with few: a table that is filled
// row by row asks for each of them.
- (BOOL)holds:(id)object;

// Every change of the rows is told, those that are added before they can be asked for.
- (void)noteAdded:(NSArray*)objects;
- (void)noteRemoved:(NSArray*)objects;

@end
