#import "modrig/dialogs/ModrigTableView.h"

#include <algorithm>
#include <optional>

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/KeepingOut.h"
#include "modrig/dialogs/model/RowSelection.h"
#include "modrig/dialogs/model/RowSteps.h"
#include "modrig/dialogs/model/TypedLetters.h"
#include "modrig/dialogs/platform/Desktop.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/loader/FailedLoads.h"
#include "modrig/loader/KeptOut.h"
#include "modrig/types/ApplicationTypes.h"

using ModrigUtils::TableAction;

namespace
{
ModrigUtils::TableKey keyOf(NSEvent* event)
{
    NSString* characters = [event charactersIgnoringModifiers];
    return ModrigUtils::KnownKey({[characters length] == 1 ? wchar_t([characters characterAtIndex:0]) : L'\0',
                                  ModrigPlatform::IsCommand(event),
                                  ModrigPlatform::IsAlternate(event)});
}

// One person types, in one table at a time.
ModrigUtils::TypedLetters& typedLetters()
{
    static ModrigUtils::TypedLetters letters;
    return letters;
}

ModrigUtils::RowFacts factsOf(ModrigFilePath* row)
{
    ModrigUtils::RowFacts facts;
    facts.exists = ModrigPlatform::FileKindAt([row filePathName]).has_value();
    facts.unloadable = [row unloadable];
    facts.isCompiledModule = ModrigUtils::FileTypeOfPath([row path]) == kCompiledModule;
    facts.hasFailed = ModrigUtils::LastLoadFailed([row path]);
    facts.isKeptOut = !ModrigUtils::WhyKeptOut([row path]).IsEmpty();
    return facts;
}

ModrigUtils::RowTest mayBeSelectedIn(NSTableView* table)
{
    return [=](std::size_t row) -> bool
    { return [(id)[table delegate] tableView:table shouldSelectRow:static_cast<NSInteger>(row)]; };
}

CStdStr textOfKey(const char* key)
{
    return ModrigUtils::PathFromString([TsOCModrigUtil modrigLoadString:[NSString stringWithUTF8String:key]]);
}

void copyToPasteboard(NSString* text)
{
    NSPasteboard* pasteboard = [NSPasteboard generalPasteboard];
    [pasteboard declareTypes:[NSArray arrayWithObject:NSPasteboardTypeString] owner:nil];
    [pasteboard setString:text forType:NSPasteboardTypeString];
}
} // namespace

NSString* ModrigUtils::HelpKey()
{
    const unichar key = NSF1FunctionKey;
    return [NSString stringWithCharacters:&key length:1];
}

@implementation ModrigTableView

- (void)awakeFromNib
{
    NSView* frame = [[self enclosingScrollView] contentView];
    [frame setPostsFrameChangedNotifications:YES];
    [[NSNotificationCenter defaultCenter] addObserver:self
                                             selector:@selector(fillFrame:)
                                                 name:NSViewFrameDidChangeNotification
                                               object:frame];
}

- (void)dealloc
{
    [[NSNotificationCenter defaultCenter] removeObserver:self];
    [super dealloc];
}

// To the edge of what shows of the table: the toolkit's own looks at the table, which may have grown already.
- (void)sizeLastColumnToFit
{
    const NSInteger last = [self numberOfColumns] - 1;
    if (last < 0 || ![self superview])
        return;
    NSTableColumn* column = [[self tableColumns] objectAtIndex:static_cast<NSUInteger>(last)];
    const CGFloat more = NSWidth([[self superview] bounds]) - NSMaxX([self rectOfColumn:last]);
    if (more != 0)
        [column setWidth:std::max([column minWidth], [column width] + more)];
}

// At every size the columns take all the width that there is.
- (void)fillFrame:(NSNotification*)notification
{
    [self sizeLastColumnToFit];
}

- (ModrigFilePath*)fileInRow:(NSInteger)row
{
    NSArray* rows = [[(id)[self delegate] rowsOf:self] arrangedObjects];
    if (row < 0 || static_cast<NSUInteger>(row) >= [rows count])
        return nil;
    return [rows objectAtIndex:static_cast<NSUInteger>(row)];
}

- (ModrigUtils::TableState)stateWith:(NSIndexSet*)rows
{
    NSIndexSet* selected = [self selectedRowIndexes];
    const auto last = static_cast<NSUInteger>([self numberOfRows] - 1);
    return {static_cast<std::size_t>([self numberOfRows]), [selected count], [rows count],
            [selected containsIndex:0] != NO, [selected containsIndex:last] != NO};
}

- (NSArray*)filesInRows:(NSIndexSet*)rows
{
    NSMutableArray* files = [NSMutableArray array];
    for (const std::size_t row : ModrigUtils::IndexesFromSet(rows))
        if (ModrigFilePath* file = [self fileInRow:static_cast<NSInteger>(row)])
            [files addObject:file];
    return files;
}

- (void)copyPathsOf:(NSIndexSet*)rows
{
    NSArray* paths = [[self filesInRows:rows] valueForKey:@"filePathName"];
    copyToPasteboard([paths componentsJoinedByString:@"\n"]);
}

// The toolkit selects none at all when one of them must not be selected.
- (void)selectEveryRow
{
    const std::vector<std::size_t> rows =
        ModrigUtils::AllSelectable(static_cast<std::size_t>([self numberOfRows]), mayBeSelectedIn(self));
    [self selectRowIndexes:ModrigUtils::SetFromIndexes(rows) byExtendingSelection:NO];
}

- (std::vector<CStdStr>)pathsInRows:(NSIndexSet*)rows
{
    return ModrigUtils::PathsFromRows([self filesInRows:rows]);
}

- (void)perform:(TableAction)action on:(NSIndexSet*)rows
{
    if (!ModrigUtils::IsPossible(action, [self stateWith:rows]))
        return NSBeep();
    switch (action)
    {
    case TableAction::kSelectAll:
        return [self selectEveryRow];
    case TableAction::kCopyPath:
        return [self copyPathsOf:rows];
    case TableAction::kKeepOut:
        ModrigUtils::KeepAllOut([self pathsInRows:rows]);
        return [self setNeedsDisplay:YES]; // what is kept out is grey
    case TableAction::kLetIn:
        ModrigUtils::LetAllIn([self pathsInRows:rows]);
        return [self setNeedsDisplay:YES];
    case TableAction::kShowInFolder:
        return ModrigPlatform::ShowInFolder(
            [[self fileInRow:static_cast<NSInteger>([rows firstIndex])] filePathName]);
    default:
        return [(id)[self delegate] perform:action inTable:self];
    }
}

- (void)goToRowBeginningWith:(const CStdStr&)letters
{
    const NSInteger selected = [self selectedRow];
    const auto row = ModrigUtils::RowBeginningWith(
        letters, static_cast<std::size_t>([self numberOfRows]),
        selected < 0 ? std::nullopt : std::optional<std::size_t>(selected),
        [self](std::size_t index)
        { return ModrigUtils::PathFromString([[self fileInRow:static_cast<NSInteger>(index)] fileName]); });
    if (!row)
        return NSBeep();
    [self selectRowIndexes:[NSIndexSet indexSetWithIndex:*row] byExtendingSelection:NO];
    [self scrollRowToVisible:static_cast<NSInteger>(*row)];
}

- (BOOL)takeKey:(NSEvent*)event
{
    const TableAction action =
        ModrigUtils::ActionForKey([(id)[self delegate] kindOfTable:self], keyOf(event));
    if (action == TableAction::kNone)
        return NO;
    [self perform:action on:[self selectedRowIndexes]];
    return YES;
}

- (ModrigUtils::RowPlaces)places
{
    const auto page = static_cast<std::size_t>(NSHeight([self visibleRect]) / [self rowHeight]);
    ModrigUtils::RowPlaces places = {static_cast<std::size_t>([self numberOfRows]), page > 1 ? page : 1, {}};
    if ([self selectedRow] >= 0)
        places.selected = static_cast<std::size_t>([self selectedRow]);
    return places;
}

// The toolkit's own would come to a row that cannot be selected, and select nothing. With Shift it leaves
// such rows out by itself, and so it may do where there are none.
- (BOOL)moveBy:(NSEvent*)event
{
    const ModrigUtils::TableKey key = keyOf(event);
    if (key.command || key.alternate || ([event modifierFlags] & NSShiftKeyMask))
        return NO;
    const auto row = ModrigUtils::RowPassedOverFor(key.character, [self places], mayBeSelectedIn(self));
    if (!row)
        return NO;
    [self selectRowIndexes:[NSIndexSet indexSetWithIndex:*row] byExtendingSelection:NO];
    [self scrollRowToVisible:static_cast<NSInteger>(*row)];
    return YES;
}

- (void)keyDown:(NSEvent*)event
{
    const ModrigUtils::TableKey key = keyOf(event);
    const auto now = std::chrono::steady_clock::now();
    if ([self takeKey:event] || [self moveBy:event])
        return;
    if (typedLetters().Take(key, now))
        [self goToRowBeginningWith:typedLetters().Add(key.character, now)];
    else
        [super keyDown:event];
}

- (void)mouseDown:(NSEvent*)event
{
    [super mouseDown:ModrigPlatform::ClickOnTable(event)];
}

- (void)performMenuItem:(NSMenuItem*)item
{
    [self perform:static_cast<TableAction>([item tag]) on:[item representedObject]];
}

- (BOOL)validateMenuItem:(NSMenuItem*)item
{
    return ModrigUtils::IsPossible(static_cast<TableAction>([item tag]),
                                   [self stateWith:[item representedObject]]);
}

- (NSMenuItem*)menuItemFor:(TableAction)action rows:(NSIndexSet*)rows
{
    if (action == TableAction::kNone)
        return (NSMenuItem*)[NSMenuItem separatorItem];
    NSString* title = [NSString stringWithUTF8String:ModrigUtils::TitleKey(action)];
    NSMenuItem* item = [[[NSMenuItem alloc] initWithTitle:[TsOCModrigUtil modrigLoadString:title]
                                                   action:@selector(performMenuItem:)
                                            keyEquivalent:@""] autorelease];
    [item setTarget:self];
    [item setTag:static_cast<NSInteger>(action)];
    [item setRepresentedObject:rows];
    return item;
}

// A row that can be selected is, by the click that opens its menu; the menu is then one for all selected
// rows.
- (NSIndexSet*)rowsPointedAt:(NSInteger)row
{
    NSIndexSet* clicked =
        row < 0 ? [NSIndexSet indexSet] : [NSIndexSet indexSetWithIndex:static_cast<NSUInteger>(row)];
    switch (ModrigUtils::RowsOfMenu(row, [self isRowSelected:row],
                                    [(id)[self delegate] tableView:self shouldSelectRow:row]))
    {
    case ModrigUtils::MenuRows::kSelection:
        return [self selectedRowIndexes];
    case ModrigUtils::MenuRows::kNewSelection:
        [self selectRowIndexes:clicked byExtendingSelection:NO];
        return [self selectedRowIndexes];
    case ModrigUtils::MenuRows::kNone:
    case ModrigUtils::MenuRows::kUnselectedRow:
        break;
    }
    return clicked;
}

- (NSMenu*)menuForEvent:(NSEvent*)event
{
    const NSPoint place = [self convertPoint:[event locationInWindow] fromView:nil];
    NSIndexSet* rows = [self rowsPointedAt:[self rowAtPoint:place]];
    NSMenu* menu = [[[NSMenu alloc] initWithTitle:@""] autorelease];
    const auto actions = ModrigUtils::MenuOf([(id)[self delegate] kindOfTable:self],
                                             ModrigUtils::KeepingOutActionFor([self pathsInRows:rows]));
    for (const TableAction action : actions)
        [menu addItem:[self menuItemFor:action rows:rows]];
    return menu;
}

- (ModrigUtils::RowState)stateOfFile:(ModrigFilePath*)file
{
    return ModrigUtils::StateOf([(id)[self delegate] kindOfTable:self], factsOf(file));
}

- (std::vector<ModrigUtils::RowState>)states
{
    std::vector<ModrigUtils::RowState> states;
    for (NSInteger row = 0; row < [self numberOfRows]; ++row)
        states.push_back([self stateOfFile:[self fileInRow:row]]);
    return states;
}

- (NSColor*)textColorOfRow:(NSInteger)row
{
    ModrigFilePath* file = [self fileInRow:row];
    const bool isGrey = file && [self stateOfFile:file] != ModrigUtils::RowState::kUsable;
    return isGrey ? [NSColor disabledControlTextColor] : [NSColor controlTextColor];
}

// One tip for each row that shows. This is called whenever others do.
- (void)resetCursorRects
{
    [super resetCursorRects];
    [self removeAllToolTips];
    const NSRange shown = [self rowsInRect:[self visibleRect]];
    for (NSUInteger row = shown.location; row < NSMaxRange(shown); ++row)
        [self addToolTipRect:[self rectOfRow:static_cast<NSInteger>(row)] owner:self userData:nullptr];
}

- (void)reloadData
{
    [super reloadData];
    [[self window] invalidateCursorRectsForView:self];
}

- (NSString*)view:(NSView*)view stringForToolTip:(NSToolTipTag)tag point:(NSPoint)place userData:(void*)data
{
    return [self tipForRow:[self rowAtPoint:place]];
}

- (NSString*)tipForRow:(NSInteger)row
{
    ModrigFilePath* file = [self fileInRow:row];
    if (!file)
        return nil;
    const CStdStr path = [file path];
    const CStdStr tip =
        ModrigUtils::TipOfRow(path, ModrigUtils::WhyKeptOut(path), [self stateOfFile:file], textOfKey);
    return ModrigUtils::StringFromPath(tip);
}

@end
