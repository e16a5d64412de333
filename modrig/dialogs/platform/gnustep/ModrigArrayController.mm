#import "modrig/dialogs/ModrigArrayController.h"

// The toolkit's own controller has no content when it comes from a window file, appends what it should
// insert, and keeps the selected places instead of the selected objects.
@interface ModrigArrayController (Content)
- (void)showContentSelecting:(NSIndexSet*)selection;
@end

@implementation ModrigArrayController

- (id)initWithCoder:(NSCoder*)coder
{
    if (!(self = [super initWithCoder:coder]))
        return nil;
    if (![self content])
        [self setContent:[NSMutableArray array]];
    [self setSelectionIndexes:[NSIndexSet indexSet]];
    return self;
}

- (void)dealloc
{
    [mKnown release];
    [super dealloc];
}

- (void)setTable:(NSTableView*)table
{
    mTable = table;
}

// What is neither sorted nor filtered needs no second array, which would be made again for every row.
- (id)arrangedObjects
{
    return mTable ? [self content] : [super arrangedObjects];
}

// A table asks its data source for the rows; what is bound to them has to be told.
- (void)showContentSelecting:(NSIndexSet*)selection
{
    if (mTable)
        [mTable reloadData];
    else
        [self setContent:[NSMutableArray arrayWithArray:[self content]]];
    [self setSelectionIndexes:selection];
}

- (NSArray*)selectedObjects
{
    return [[self content] objectsAtIndexes:[self selectionIndexes]];
}

// The selected places after others have been inserted.
- (NSIndexSet*)selectionAfterInsertionAt:(NSIndexSet*)places
{
    NSMutableIndexSet* selection = [[[self selectionIndexes] mutableCopy] autorelease];
    for (NSUInteger place = [places firstIndex]; place != NSNotFound;
         place = [places indexGreaterThanIndex:place])
        if (place <= [selection lastIndex])
            [selection shiftIndexesStartingAtIndex:place by:1];
    return selection;
}

// The selected places after others, or these themselves, have been removed.
- (NSIndexSet*)selectionAfterRemovalAt:(NSIndexSet*)places
{
    NSMutableIndexSet* selection = [[[self selectionIndexes] mutableCopy] autorelease];
    [selection removeIndexes:places];
    for (NSUInteger place = [places lastIndex]; place != NSNotFound;
         place = [places indexLessThanIndex:place])
        [selection shiftIndexesStartingAtIndex:place + 1 by:-1];
    return selection;
}

- (void)insertObjects:(NSArray*)objects atArrangedObjectIndexes:(NSIndexSet*)places
{
    NSIndexSet* selection = [self selectsInsertedObjects] ? places : [self selectionAfterInsertionAt:places];
    [[self content] insertObjects:objects atIndexes:places];
    [self noteAdded:objects];
    [self showContentSelecting:selection];
}

- (void)insertObject:(id)object atArrangedObjectIndex:(NSUInteger)place
{
    [self insertObjects:[NSArray arrayWithObject:object]
        atArrangedObjectIndexes:[NSIndexSet indexSetWithIndex:place]];
}

// What is selected stays where it is, however many come after it.
- (void)addObjects:(NSArray*)objects
{
    const NSRange end = NSMakeRange([[self content] count], [objects count]);
    NSIndexSet* selection =
        [self selectsInsertedObjects] ? [NSIndexSet indexSetWithIndexesInRange:end] : [self selectionIndexes];
    [[self content] addObjectsFromArray:objects];
    [self noteAdded:objects];
    [self showContentSelecting:selection];
}

- (void)addObject:(id)object
{
    [self addObjects:[NSArray arrayWithObject:object]];
}

- (void)removeObjects:(NSArray*)objects
{
    NSSet* removed = [NSSet setWithArray:objects];
    NSMutableIndexSet* places = [NSMutableIndexSet indexSet];
    for (NSUInteger index = 0; index < [[self content] count]; ++index)
        if ([removed containsObject:[[self content] objectAtIndex:index]])
            [places addIndex:index];
    [self removeObjectsAtArrangedObjectIndexes:places];
}

// A row that comes from the table itself is found without comparing paths: rows are removed one by one.
- (void)removeObject:(id)object
{
    const NSUInteger place = [[self content] indexOfObjectIdenticalTo:object];
    if (place == NSNotFound)
        [self removeObjects:[NSArray arrayWithObject:object]];
    else
        [self removeObjectAtArrangedObjectIndex:place];
}

- (void)removeObjectsAtArrangedObjectIndexes:(NSIndexSet*)places
{
    NSIndexSet* selection = [self selectionAfterRemovalAt:places];
    [self noteRemoved:[[self content] objectsAtIndexes:places]];
    [[self content] removeObjectsAtIndexes:places];
    [self showContentSelecting:selection];
}

- (void)removeObjectAtArrangedObjectIndex:(NSUInteger)place
{
    [self removeObjectsAtArrangedObjectIndexes:[NSIndexSet indexSetWithIndex:place]];
}

@end
