#import "modrig/dialogs/ModrigArrayController.h"

@implementation ModrigArrayController (Membership)

// Rows that came by another way, all of them at once, are found by their number.
- (NSMutableSet*)knownRows
{
    NSArray* rows = [self arrangedObjects];
    if (!mKnown || [mKnown count] != [rows count])
    {
        [mKnown release];
        mKnown = [[NSMutableSet alloc] initWithArray:rows];
    }
    return mKnown;
}

- (BOOL)holds:(id)object
{
    return [[self knownRows] containsObject:object];
}

- (void)noteAdded:(NSArray*)objects
{
    [mKnown addObjectsFromArray:objects];
}

- (void)noteRemoved:(NSArray*)objects
{
    [mKnown minusSet:[NSSet setWithArray:objects]];
}

@end
