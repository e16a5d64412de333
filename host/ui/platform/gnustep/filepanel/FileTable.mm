#import "host/ui/platform/gnustep/filepanel/FileTable.h"

#include <cmath>

#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#include "host/ui/platform/gnustep/filepanel/RowSelection.h"

using namespace tessel::filepanel;

namespace
{
constexpr NSTimeInterval kSecondsBetweenLetters = 1;
constexpr CGFloat kDragThreshold = 4; // points that the mouse moves before a press becomes a drag
constexpr long kFarAway = 1L << 40;

Keys keysOf(NSEvent* event)
{
    const NSUInteger flags = [event modifierFlags];
    return {(flags & NSShiftKeyMask) != 0, (flags & NSControlKeyMask) != 0};
}

std::set<std::size_t> rowsIn(NSIndexSet* indexes)
{
    std::set<std::size_t> rows;
    for (NSUInteger row = [indexes firstIndex]; row != NSNotFound; row = [indexes indexGreaterThanIndex:row])
        rows.insert(row);
    return rows;
}

NSIndexSet* indexesOf(const std::set<std::size_t>& rows)
{
    NSMutableIndexSet* indexes = [NSMutableIndexSet indexSet];
    for (const std::size_t row : rows)
        [indexes addIndex:row];
    return indexes;
}

bool isText(unichar character)
{
    // The toolkit's function keys are in a private area of Unicode.
    return character >= ' ' && character != NSDeleteCharacter && (character < 0xF700 || character > 0xF8FF);
}
} // namespace

@implementation TsFileTable

- (id)initWithFrame:(NSRect)frame
{
    if (!(self = [super initWithFrame:frame]))
        return nil;
    mSelection = new RowSelection;
    mLetters = [[NSMutableString alloc] init];
    return self;
}

- (void)dealloc
{
    delete mSelection;
    [mLetters release];
    [super dealloc];
}

- (void)setPanel:(TsUIFilePanel*)panel
{
    mPanel = panel;
}

// Rows may have been selected by others since.
- (RowSelection)selection
{
    const auto rows = rowsIn([self selectedRowIndexes]);
    if (rows != mSelection->rows)
        *mSelection = {rows, rows.empty() ? 0 : *rows.begin(), rows.empty() ? 0 : *rows.rbegin()};
    return *mSelection;
}

- (void)select:(const RowSelection&)selection
{
    const bool changes = rowsIn([self selectedRowIndexes]) != selection.rows;
    *mSelection = selection;
    if (selection.rows.empty())
        [self deselectAll:self];
    else
        [self selectRowIndexes:indexesOf(selection.rows) byExtendingSelection:NO];
    // To choose again what is chosen counts as a choice.
    if (!changes)
        [mPanel rowsWereChosen];
}

- (void)clickRow:(NSInteger)row keys:(Keys)keys
{
    [self select:afterClick([self selection], static_cast<std::size_t>(row), keys,
                            [self allowsMultipleSelection])];
}

// Waits until the button is released or the mouse has gone some way; answers whether it has.
- (BOOL)becomesDrag:(NSEvent*)press
{
    const NSPoint start = [press locationInWindow];
    for (;;)
    {
        NSEvent* event = [[self window] nextEventMatchingMask:NSLeftMouseUpMask | NSLeftMouseDraggedMask];
        if ([event type] == NSLeftMouseUp)
            return NO;
        const NSPoint now = [event locationInWindow];
        if (std::hypot(now.x - start.x, now.y - start.y) > kDragThreshold)
            return YES;
    }
}

- (void)press:(NSEvent*)event onRow:(NSInteger)row
{
    const Keys keys = keysOf(event);
    // A press on one of several selected rows may begin a drag of all of them.
    const bool waits = !keys.shift && !keys.control && [self isRowSelected:row];
    if (!waits)
        [self clickRow:row keys:keys];
    if ([self becomesDrag:event])
        return [mPanel dragSelectionFrom:self];
    if (waits)
        [self clickRow:row keys:keys];
    if ([event clickCount] == 2)
        [mPanel takeDefaultAction];
}

- (void)mouseDown:(NSEvent*)event
{
    const NSPoint place = [self convertPoint:[event locationInWindow] fromView:nil];
    const NSInteger row = [self rowAtPoint:place];
    [[self window] makeFirstResponder:self];
    [mLetters setString:@""];
    if (row >= 0)
        [self press:event onRow:row];
    else if (!keysOf(event).shift && !keysOf(event).control)
        [self select:RowSelection{}];
}

- (void)step:(long)rows keys:(Keys)keys
{
    [self select:afterStep([self selection], rows, keys, static_cast<std::size_t>([self numberOfRows]),
                           [self allowsMultipleSelection])];
    if ([self numberOfRows] > 0)
        [self scrollRowToVisible:static_cast<NSInteger>(mSelection->lead)];
}

- (long)page
{
    const long rows = static_cast<long>([self rowsInRect:[self visibleRect]].length) - 1;
    return rows > 1 ? rows : 1;
}

- (BOOL)moveBy:(unichar)key keys:(Keys)keys
{
    switch (key)
    {
    case NSUpArrowFunctionKey:
        return [self step:-1 keys:keys], YES;
    case NSDownArrowFunctionKey:
        return [self step:1 keys:keys], YES;
    case NSPageUpFunctionKey:
        return [self step:-[self page] keys:keys], YES;
    case NSPageDownFunctionKey:
        return [self step:[self page] keys:keys], YES;
    case NSHomeFunctionKey:
        return [self step:-kFarAway keys:keys], YES;
    case NSEndFunctionKey:
        return [self step:kFarAway keys:keys], YES;
    default:
        return NO;
    }
}

- (BOOL)act:(unichar)key
{
    switch (key)
    {
    case NSBackspaceCharacter:
    case NSDeleteCharacter:
        return [mPanel goUp:self], YES;
    case '/':
    case '~':
        return [mPanel beginTyping:[NSString stringWithCharacters:&key length:1]], YES;
    default:
        return NO;
    }
}

- (void)goToLetters:(NSString*)letter at:(NSTimeInterval)time
{
    if (time - mLastLetter > kSecondsBetweenLetters)
        [mLetters setString:@""];
    mLastLetter = time;
    [mLetters appendString:letter];
    const RowSelection selection = [self selection];
    // The same beginning may go on with the row that is selected; another first letter goes to the next one.
    const std::size_t from = selection.rows.empty() ? 0 : selection.lead + ([mLetters length] == 1 ? 1 : 0);
    const NSInteger row = [mPanel rowBeginningWith:mLetters from:from];
    if (row < 0)
        return NSBeep();
    [self clickRow:row keys:Keys{}];
    [self scrollRowToVisible:row];
}

- (void)keyDown:(NSEvent*)event
{
    NSString* characters = [event charactersIgnoringModifiers];
    const unichar key = [characters length] ? [characters characterAtIndex:0] : 0;
    const Keys keys = keysOf(event);
    if ([self moveBy:key keys:keys])
        return;
    if (keys.control && (key == 'a' || key == 'A') && [self allowsMultipleSelection])
        return [self selectAll:self];
    if (keys.control || ([event modifierFlags] & (NSCommandKeyMask | NSAlternateKeyMask)))
        return [super keyDown:event];
    if ([self act:key])
        return;
    if (!isText(key))
        return [super keyDown:event];
    [self goToLetters:[event characters] at:[event timestamp]];
}

@end
