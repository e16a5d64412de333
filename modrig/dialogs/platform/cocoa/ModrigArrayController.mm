#import "modrig/dialogs/ModrigArrayController.h"

// The toolkit does all that it documents; the calls are passed on, and the rows are noted on the way.
@implementation ModrigArrayController

- (void)dealloc
{
    [mKnown release];
    [super dealloc];
}

- (void)setTable:(NSTableView*)table
{
    mTable = table;
}

- (void)insertObject:(id)object atArrangedObjectIndex:(NSUInteger)place
{
    [self noteAdded:[NSArray arrayWithObject:object]];
    [super insertObject:object atArrangedObjectIndex:place];
}

- (void)insertObjects:(NSArray*)objects atArrangedObjectIndexes:(NSIndexSet*)places
{
    [self noteAdded:objects];
    [super insertObjects:objects atArrangedObjectIndexes:places];
}

- (void)addObject:(id)object
{
    [self noteAdded:[NSArray arrayWithObject:object]];
    [super addObject:object];
}

- (void)addObjects:(NSArray*)objects
{
    [self noteAdded:objects];
    [super addObjects:objects];
}

- (void)removeObject:(id)object
{
    [self noteRemoved:[NSArray arrayWithObject:object]];
    [super removeObject:object];
}

- (void)removeObjects:(NSArray*)objects
{
    [self noteRemoved:objects];
    [super removeObjects:objects];
}

- (void)removeObjectAtArrangedObjectIndex:(NSUInteger)place
{
    [self noteRemoved:[NSArray arrayWithObject:[[self arrangedObjects] objectAtIndex:place]]];
    [super removeObjectAtArrangedObjectIndex:place];
}

- (void)removeObjectsAtArrangedObjectIndexes:(NSIndexSet*)places
{
    [self noteRemoved:[[self arrangedObjects] objectsAtIndexes:places]];
    [super removeObjectsAtArrangedObjectIndexes:places];
}

@end
