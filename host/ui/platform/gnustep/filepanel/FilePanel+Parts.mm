#include <algorithm>

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#include "host/ui/Label.h"
#include "host/ui/Words.h"
#import "host/ui/platform/gnustep/filepanel/FileNameCell.h"
#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/Layout.h"
#import "host/ui/platform/gnustep/filepanel/PathBar.h"

using namespace tessel::filepanel;
using tessel::word;
using tessel::windowing::kControlFontSize;
using tessel::windowing::makeLabel;

// Places its parts by the panel's own rule whenever its size changes.
@interface TsFilePanelView : NSView
@end

@implementation TsFilePanelView

- (void)resizeSubviewsWithOldSize:(NSSize)size
{
    [super resizeSubviewsWithOldSize:size];
    [(TsUIFilePanel*)[self window] placeParts];
}

@end

namespace
{
constexpr CGFloat kMargin = 8;
constexpr CGFloat kControlHeight = 26;
constexpr CGFloat kButtonWidth = 90;
constexpr CGFloat kFieldPlace = 104; // from the left edge
constexpr CGFloat kSwitchWidth = 150;
constexpr CGFloat kSmallestWidth = 560;
constexpr CGFloat kListBeyondSmallest = 190; // points, in the size that the panel opens in
constexpr CGFloat kRowHeight = 20;
constexpr CGFloat kKindWidth = 110;
constexpr CGFloat kDateWidth = 150;
constexpr CGFloat kSmallestColumn = 60;

NSButton* makeButton(NSString* title, id target, SEL action)
{
    NSButton* button = [[[NSButton alloc] initWithFrame:NSMakeRect(0, 0, kButtonWidth, 28)] autorelease];
    [button setTitle:title];
    [button setBezelStyle:NSRoundedBezelStyle];
    [button setFont:[NSFont systemFontOfSize:kControlFontSize]];
    [button setTarget:target];
    [button setAction:action];
    return button;
}

NSView* makeRow(NSView* content)
{
    NSView* row =
        [[[NSView alloc] initWithFrame:NSMakeRect(0, 0, NSWidth([content bounds]), 40)] autorelease];
    [row setAutoresizesSubviews:YES];
    [content addSubview:row];
    return row;
}

// In the middle of its row; `fromRight`: `x` is the distance of its right edge from the row's.
void place(NSView* view, NSView* row, CGFloat x, CGFloat width, CGFloat height, bool fromRight = false)
{
    const NSRect bounds = [row bounds];
    const CGFloat left = fromRight ? NSWidth(bounds) - x - width : x;
    [view setFrame:NSMakeRect(left, (NSHeight(bounds) - height) / 2, width, height)];
    [view setAutoresizingMask:fromRight ? NSViewMinXMargin : NSViewMaxXMargin];
    [row addSubview:view];
}

NSTableColumn* makeColumn(NSString* identifier, CGFloat width, NSCell* cell)
{
    NSTableColumn* column = [[[NSTableColumn alloc] initWithIdentifier:identifier] autorelease];
    [[column headerCell] setAlignment:NSLeftTextAlignment];
    [[column headerCell] setFont:[NSFont systemFontOfSize:12]];
    [cell setFont:[NSFont systemFontOfSize:12]];
    [cell setLineBreakMode:NSLineBreakByTruncatingTail];
    [column setDataCell:cell];
    [column setEditable:NO];
    [column setMinWidth:kSmallestColumn];
    [column setWidth:width];
    return column;
}

// The toolkit would take from the last column first, and give to it, whatever it needs. The others can be
// dragged wider and narrower.
void fixWidth(NSTableColumn* column, CGFloat width)
{
    const CGFloat fixed = std::max(kSmallestColumn, width);
    if (![[column identifier] isEqual:@"date"])
        return [column setWidth:fixed];
    [column setMinWidth:0];
    [column setMaxWidth:fixed];
    [column setMinWidth:fixed];
    [column setWidth:fixed];
}

NSTextFieldCell* makeTextCell()
{
    return [[[NSTextFieldCell alloc] initTextCell:@""] autorelease];
}
} // namespace

@implementation TsUIFilePanel (Parts)

- (void)makeWayRowIn:(NSView*)row
{
    place(makeButton(word(@"UP"), self, @selector(goUp:)), row, kMargin, 56, kControlHeight);
    place(makeButton(word(@"HOME"), self, @selector(goHome:)), row, kMargin + 60, 84, kControlHeight);
    mRecent = [[[NSPopUpButton alloc] initWithFrame:NSMakeRect(0, 0, 100, 26) pullsDown:YES] autorelease];
    [mRecent setFont:[NSFont systemFontOfSize:kControlFontSize]];
    [mRecent setTarget:self];
    [mRecent setAction:@selector(goToRecent:)];
    [mRecent setToolTip:word(@"RECENT_TIP")];
    const CGFloat left = kMargin + 150;
    mWay = [[[TsPathBar alloc] initWithFrame:NSZeroRect] autorelease];
    [mWay setTarget:self action:@selector(goToStep:)];
    place(mWay, row, left, NSWidth([row bounds]) - left - 100 - 2 * kMargin, kControlHeight);
    [mWay setAutoresizingMask:NSViewWidthSizable];
    place(mRecent, row, kMargin, 100, kControlHeight, true);
}

- (void)makeListIn:(NSView*)content
{
    NSScrollView* frame = [[[NSScrollView alloc] initWithFrame:NSMakeRect(0, 0, 700, 200)] autorelease];
    [frame setBorderType:NSBezelBorder];
    [frame setHasVerticalScroller:YES];
    [frame setHasHorizontalScroller:NO];
    mTable = [[[TsFileTable alloc] initWithFrame:[[frame contentView] bounds]] autorelease];
    [mTable addTableColumn:makeColumn(@"name", 400, [[[TsFileNameCell alloc] initTextCell:@""] autorelease])];
    [mTable addTableColumn:makeColumn(@"kind", kKindWidth, makeTextCell())];
    [mTable addTableColumn:makeColumn(@"date", kDateWidth, makeTextCell())];
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([mTable tableColumns]))
        fixWidth(column, [column width]);
    [mTable setRowHeight:kRowHeight];
    [mTable setAllowsColumnReordering:NO];
    [mTable setAllowsColumnSelection:NO];
    [mTable setAllowsEmptySelection:YES];
    [mTable setDrawsGrid:NO];
    [self markSortedColumn];
    [mTable setPanel:self];
    [mTable setDataSource:self];
    [mTable setDelegate:self];
    [frame setDocumentView:mTable];
    [content addSubview:frame];
}

- (void)makeNameRowIn:(NSView*)row
{
    place(makeLabel(word(@"NAME_FIELD"), NSZeroRect), row, 16, 72, 18);
    mName = [[[NSTextField alloc] initWithFrame:NSZeroRect] autorelease];
    [mName setFont:[NSFont systemFontOfSize:kControlFontSize]];
    [mName setDelegate:(id)self];
    [[mName cell] setSendsActionOnEndEditing:NO];
    [[mName cell] setScrollable:YES];
    place(mName, row, kFieldPlace, NSWidth([row bounds]) - kFieldPlace - kSwitchWidth - 2 * kMargin, 24);
    [mName setAutoresizingMask:NSViewWidthSizable];
    mHidden = [[[NSButton alloc] initWithFrame:NSZeroRect] autorelease];
    [mHidden setButtonType:NSSwitchButton];
    [mHidden setTitle:word(@"HIDDEN_FILES")];
    [mHidden setFont:[NSFont systemFontOfSize:kControlFontSize]];
    [mHidden setTarget:self];
    [mHidden setAction:@selector(toggleHidden:)];
    place(mHidden, row, kMargin, kSwitchWidth, 20, true);
}

// Straight in the content view: whoever uses the panel puts a button of its own beside them.
- (void)makeButtonsIn:(NSView*)content
{
    const CGFloat right = NSWidth([content bounds]) - kMargin - kButtonWidth;
    mOK = makeButton(word(@"OPEN"), self, @selector(ok:));
    [mOK setTag:kTsUIFilePanelDefaultButton];
    [mOK setKeyEquivalent:@"\r"];
    mCancel = makeButton(word(@"CANCEL"), self, @selector(cancel:));
    [mCancel setTag:kTsUIFilePanelCancelButton];
    NSButton* spare = makeButton(@"", nil, nullptr);
    [spare setTag:kTsUIFilePanelSpareButton];
    [spare setHidden:YES];
    [spare setFrameOrigin:NSMakePoint(kMargin, 7)];
    [spare setAutoresizingMask:NSViewMaxXMargin | NSViewMaxYMargin];
    [mOK setFrameOrigin:NSMakePoint(right, 7)];
    [mCancel setFrameOrigin:NSMakePoint(right - kButtonWidth - kMargin, 7)];
    for (NSButton* button : {mCancel, mOK})
        [button setAutoresizingMask:NSViewMinXMargin | NSViewMaxYMargin];
    for (NSButton* button : {spare, mCancel, mOK}) // from left to right, for the order of the Tab key
        [content addSubview:button];
    [self setDefaultButtonCell:[mOK cell]];
}

- (void)makeParts
{
    NSView* content = [[[TsFilePanelView alloc] initWithFrame:[[self contentView] frame]] autorelease];
    [self setContentView:content];
    [self makeWayRowIn:makeRow(content)];
    [self makeListIn:content];
    [self makeNameRowIn:makeRow(content)];
    [self makeButtonsIn:content];
    [self setContentMinSize:NSMakeSize(kSmallestWidth, smallestHeight(0))];
    [self placeParts];
}

// The names get what the other columns leave. The toolkit counts the space between columns as part of them.
- (void)fitColumns
{
    NSTableColumn* name = [[mTable tableColumns] objectAtIndex:0];
    NSTableColumn* kind = [mTable tableColumnWithIdentifier:@"kind"];
    NSTableColumn* date = [mTable tableColumnWithIdentifier:@"date"];
    const CGFloat available = NSWidth([[[mTable enclosingScrollView] contentView] bounds]) - [date width];
    mIsFitting = YES;
    fixWidth(kind, std::min([kind width], available - kSmallestColumn));
    fixWidth(name, available - [kind width]);
    mIsFitting = NO;
}

- (void)setWidth:(CGFloat)width ofColumn:(NSString*)identifier
{
    mIsFitting = YES;
    fixWidth([mTable tableColumnWithIdentifier:identifier], width);
    mIsFitting = NO;
    [self fitColumns];
}

// What a column gets by hand, the next one gives.
- (void)tableViewColumnDidResize:(NSNotification*)notification
{
    NSArray* columns = [mTable tableColumns];
    NSTableColumn* column = [[notification userInfo] objectForKey:@"NSTableColumn"];
    const NSUInteger next = [columns indexOfObject:column] + 1;
    if (mIsFitting || !column || next >= [columns count])
        return;
    const CGFloat before = [[[notification userInfo] objectForKey:@"NSOldWidth"] floatValue];
    NSTableColumn* giver = [columns objectAtIndex:next];
    [self setWidth:[giver width] + before - [column width] ofColumn:[giver identifier]];
}

- (void)placeParts
{
    const NSSize size = [[self contentView] bounds].size;
    const Layout layout = layoutFor(size.height, mAccessoryHeight);
    const auto put = [&](NSView* view, Extent extent, CGFloat margin)
    { [view setFrame:NSMakeRect(margin, extent.bottom, size.width - 2 * margin, extent.height)]; };
    put([mWay superview], layout.ways, 0);
    put([mTable enclosingScrollView], layout.list, kMargin);
    put([mName superview], layout.name, 0);
    if (mAccessory)
        put(mAccessory, layout.accessory, 0);
    [self fitColumns];
    [[self contentView] setNeedsDisplay:YES];
}

- (CGFloat)smallestHeightOf:(NSView*)accessory
{
    if ([accessory respondsToSelector:@selector(tsuiSmallestHeight)])
        return [(id<TsUILowAccessory>)accessory tsuiSmallestHeight];
    return NSHeight([accessory frame]);
}

// The list keeps its usual height above the view.
- (void)growFor:(NSView*)accessory
{
    const NSSize asked = [accessory frame].size;
    mAccessoryHeight = asked.height;
    NSView* content = [self contentView];
    // Before the buttons below it, for the order of the Tab key.
    [content addSubview:accessory
             positioned:NSWindowBelow
             relativeTo:[content viewWithTag:kTsUIFilePanelSpareButton]];
    [accessory setAutoresizingMask:NSViewWidthSizable];
    const CGFloat width = std::max(asked.width, kSmallestWidth);
    [self setContentMinSize:NSMakeSize(width, smallestHeight([self smallestHeightOf:accessory]))];
    const CGFloat shown = NSWidth([[self contentView] bounds]);
    [self setContentSize:NSMakeSize(std::max(shown, width),
                                    smallestHeight(asked.height) + kListBeyondSmallest)];
}

// No higher and no wider than the screen, and in its middle.
- (void)fitOnScreen
{
    const NSRect screen = [[NSScreen mainScreen] visibleFrame];
    const NSSize inside = [self contentRectForFrameRect:screen].size;
    const NSSize least = [self contentMinSize];
    [self setContentMinSize:NSMakeSize(std::min(least.width, inside.width),
                                       std::min(least.height, inside.height))];
    NSRect frame = [self frame];
    frame.size.width = std::min(NSWidth(frame), NSWidth(screen));
    frame.size.height = std::min(NSHeight(frame), NSHeight(screen));
    frame.origin.x = NSMidX(screen) - NSWidth(frame) / 2;
    frame.origin.y = NSMidY(screen) - NSHeight(frame) / 2;
    [self setFrame:NSIntegralRect(frame) display:NO];
}

@end
