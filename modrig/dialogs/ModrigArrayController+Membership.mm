#import "modrig/dialogs/ModrigArrayController.h"

@implementation ModrigArrayController (Membership)

// Rows that were set all at once were not noted: their count differs then from that of the known ones.
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
