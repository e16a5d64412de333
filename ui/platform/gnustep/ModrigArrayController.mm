#import "ui/ModrigArrayController.h"

// The toolkit's own controller has no content when it comes from a window file, appends what it should
// insert, and keeps the selected places instead of the selected objects.
@interface ModrigArrayController (Content)
- (void)replaceContent:(NSMutableArray*)content selecting:(NSArray*)wanted;
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

- (void)setTable:(NSTableView*)table
{
    mTable = table;
}

- (void)replaceContent:(NSMutableArray*)content selecting:(NSArray*)wanted
{
    [self setContent:content];
    [mTable reloadData];
    NSMutableIndexSet* selection = [NSMutableIndexSet indexSet];
    for (NSUInteger index = 0; index < [wanted count]; ++index)
    {
        const NSUInteger place = [content indexOfObjectIdenticalTo:[wanted objectAtIndex:index]];
        if (place != NSNotFound)
            [selection addIndex:place];
    }
    [self setSelectionIndexes:selection];
}

- (NSArray*)selectedObjects
{
    NSArray* content = [self content];
    NSIndexSet* selection = [self selectionIndexes];
    NSMutableArray* selected = [NSMutableArray array];
    for (NSUInteger index = 0; index < [content count]; ++index)
        if ([selection containsIndex:index])
            [selected addObject:[content objectAtIndex:index]];
    return selected;
}

- (void)insertObjects:(NSArray*)objects atArrangedObjectIndexes:(NSIndexSet*)places
{
    NSMutableArray* content = [NSMutableArray arrayWithArray:[self content]];
    NSArray* wanted = [self selectsInsertedObjects] ? objects : [self selectedObjects];
    [content insertObjects:objects atIndexes:places];
    [self replaceContent:content selecting:wanted];
}

- (void)insertObject:(id)object atArrangedObjectIndex:(NSUInteger)place
{
    [self insertObjects:[NSArray arrayWithObject:object]
        atArrangedObjectIndexes:[NSIndexSet indexSetWithIndex:place]];
}

- (void)addObjects:(NSArray*)objects
{
    const NSRange end = NSMakeRange([[self content] count], [objects count]);
    [self insertObjects:objects atArrangedObjectIndexes:[NSIndexSet indexSetWithIndexesInRange:end]];
}

- (void)addObject:(id)object
{
    [self addObjects:[NSArray arrayWithObject:object]];
}

- (void)removeObjects:(NSArray*)objects
{
    NSSet* removed = [NSSet setWithArray:objects];
    NSMutableArray* content = [NSMutableArray array];
    NSArray* selected = [self selectedObjects];
    for (NSUInteger index = 0; index < [[self content] count]; ++index)
        if (id object = [[self content] objectAtIndex:index]; ![removed containsObject:object])
            [content addObject:object];
    [self replaceContent:content selecting:selected];
}

- (void)removeObject:(id)object
{
    [self removeObjects:[NSArray arrayWithObject:object]];
}

- (void)removeObjectsAtArrangedObjectIndexes:(NSIndexSet*)places
{
    NSMutableArray* content = [NSMutableArray arrayWithArray:[self content]];
    NSArray* selected = [self selectedObjects];
    [content removeObjectsAtIndexes:places];
    [self replaceContent:content selecting:selected];
}

- (void)removeObjectAtArrangedObjectIndex:(NSUInteger)place
{
    [self removeObjectsAtArrangedObjectIndexes:[NSIndexSet indexSetWithIndex:place]];
}

@end
