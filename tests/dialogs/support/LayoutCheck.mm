#include "tests/dialogs/support/LayoutCheck.h"

#include <tesselui/tsuieach.h>

#include <cmath>

namespace
{
using Faults = std::vector<std::string>;

constexpr CGFloat kTolerance = 1;     // of a point: frames are rounded to pixels
constexpr CGFloat kButtonPadding = 6; // on each side of a title
constexpr CGFloat kSwitchWidth = 20;  // of the box before its title
constexpr CGFloat kPopUpPadding = 28; // the arrow, and the space around it and the title
constexpr CGFloat kHeaderPadding = 6; // of a column's title
constexpr CGFloat kTabPadding = 28;   // of the label of a tab
constexpr CGFloat kTabStart = 20;

std::string nameOf(NSView* view)
{
    NSString* text = nil;
    if ([view isKindOfClass:[NSButton class]])
        text = [(NSButton*)view title];
    else if ([view isKindOfClass:[NSTextField class]])
        text = [(NSTextField*)view stringValue];
    else if ([view isKindOfClass:[NSBox class]])
        text = [(NSBox*)view title];
    const std::string kind = [NSStringFromClass([view class]) UTF8String];
    return [text length] ? kind + " \"" + [text UTF8String] + "\"" : kind;
}

CGFloat widthOf(NSString* text, NSFont* font)
{
    return
        [text sizeWithAttributes:[NSDictionary dictionaryWithObject:font forKey:NSFontAttributeName]].width;
}

CGFloat heightOf(NSString* text, NSFont* font, CGFloat width)
{
    NSDictionary* look = [NSDictionary dictionaryWithObject:font forKey:NSFontAttributeName];
    return NSHeight([text boundingRectWithSize:NSMakeSize(width, 10000)
                                       options:NSStringDrawingUsesLineFragmentOrigin
                                    attributes:look]);
}

void needsWidth(Faults& faults, NSView* view, NSString* text, CGFloat needed, CGFloat available)
{
    if (needed > available + kTolerance)
        faults.push_back(nameOf(view) + ": \"" + [text UTF8String] + "\" needs " +
                         std::to_string(std::lround(needed)) + " points, has " +
                         std::to_string(std::lround(available)));
}

bool isSwitch(NSButton* button)
{
    return [[button cell] imagePosition] == NSImageLeft && ![button isBordered];
}

void checkPopUp(Faults& faults, NSPopUpButton* choice)
{
    for (NSString* title : tsuiEach<NSString*>([choice itemTitles]))
        needsWidth(faults, choice, title, widthOf(title, [choice font]) + kPopUpPadding,
                   NSWidth([choice frame]));
}

void checkButton(Faults& faults, NSButton* button)
{
    const CGFloat beside = isSwitch(button) ? kSwitchWidth : 2 * kButtonPadding;
    const bool mayBeCut = [[button cell] lineBreakMode] == NSLineBreakByTruncatingMiddle;
    if (!mayBeCut && [button imagePosition] != NSImageOnly)
        needsWidth(faults, button, [button title], widthOf([button title], [button font]) + beside,
                   NSWidth([button frame]));
}

// What a person types, or what happened, may be longer than any field.
bool isLabel(NSTextField* field)
{
    return ![field isEditable] && ![field isSelectable] && ![field infoForBinding:NSValueBinding];
}

void checkLabel(Faults& faults, NSTextField* label)
{
    const NSSize available = [label frame].size;
    if (![[label cell] wraps])
        return needsWidth(faults, label, [label stringValue], widthOf([label stringValue], [label font]),
                          available.width);
    const CGFloat needed = heightOf([label stringValue], [label font], available.width + kTolerance);
    if (needed > available.height + kTolerance)
        faults.push_back(nameOf(label) + " needs a height of " + std::to_string(std::lround(needed)) +
                         " points, has " + std::to_string(std::lround(available.height)));
}

void checkTabs(Faults& faults, NSTabView* tabs)
{
    CGFloat needed = kTabStart;
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>([tabs tabViewItems]))
        needed += widthOf([item label], [tabs font]) + kTabPadding;
    needsWidth(faults, tabs, @"its tabs", needed, NSWidth([tabs frame]));
}

void checkTable(Faults& faults, NSTableView* table)
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        needsWidth(faults, table, [[column headerCell] stringValue],
                   widthOf([[column headerCell] stringValue], [[column headerCell] font]) + kHeaderPadding,
                   [column width]);
    const CGFloat place = NSWidth([[[table headerView] superview] bounds]);
    if (NSWidth([[table headerView] frame]) + kTolerance < place)
        faults.push_back(nameOf(table) + ": its header is narrower than its place");
}

void checkText(Faults& faults, NSView* view)
{
    if ([view isKindOfClass:[NSPopUpButton class]])
        checkPopUp(faults, (NSPopUpButton*)view);
    else if ([view isKindOfClass:[NSButton class]])
        checkButton(faults, (NSButton*)view);
    else if ([view isKindOfClass:[NSTextField class]] && isLabel((NSTextField*)view))
        checkLabel(faults, (NSTextField*)view);
    else if ([view isKindOfClass:[NSTabView class]])
        checkTabs(faults, (NSTabView*)view);
    else if ([view isKindOfClass:[NSTableView class]])
        checkTable(faults, (NSTableView*)view);
    else if ([view isKindOfClass:[NSBox class]])
        needsWidth(faults, view, [(NSBox*)view title],
                   widthOf([(NSBox*)view title], [(NSBox*)view titleFont]), NSWidth([view frame]));
}

bool overlap(NSRect one, NSRect other)
{
    const NSRect both = NSIntersectionRect(one, other);
    return NSWidth(both) > kTolerance && NSHeight(both) > kTolerance;
}

bool holds(NSRect outer, NSRect inner)
{
    return NSContainsRect(NSInsetRect(outer, -kTolerance, -kTolerance), inner);
}

NSArray* shownIn(NSView* view)
{
    NSMutableArray* shown = [NSMutableArray array];
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        if (![part isHidden] && !NSIsEmptyRect([part frame]))
            [shown addObject:part];
    return shown;
}

void checkPlaces(Faults& faults, NSView* view)
{
    NSArray* parts = shownIn(view);
    for (NSUInteger one = 0; one < [parts count]; ++one)
    {
        NSView* part = [parts objectAtIndex:one];
        if (!holds([view bounds], [part frame]))
            faults.push_back(nameOf(part) + " stands outside of " + nameOf(view));
        for (NSUInteger other = one + 1; other < [parts count]; ++other)
            if (overlap([part frame], [[parts objectAtIndex:other] frame]))
                faults.push_back(nameOf(part) + " overlaps " + nameOf([parts objectAtIndex:other]));
    }
}

// What scrolls may be larger than what shows of it; its parts are the toolkit's.
NSArray* partsOf(NSView* view)
{
    if ([view isKindOfClass:[NSScrollView class]])
        return [NSArray arrayWithObject:[(NSScrollView*)view documentView]];
    return [view isKindOfClass:[NSControl class]] ? [NSArray array] : shownIn(view);
}

void check(Faults& faults, NSView* view)
{
    checkText(faults, view);
    if (![view isKindOfClass:[NSScrollView class]] && ![view isKindOfClass:[NSControl class]])
        checkPlaces(faults, view);
    for (NSView* part : tsuiEach<NSView*>(partsOf(view)))
        check(faults, part);
}

void lengthenColumns(NSTableView* table)
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        [[column headerCell] setStringValue:lengthened([[column headerCell] stringValue])];
}

void lengthenTabs(NSTabView* tabs)
{
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>([tabs tabViewItems]))
        [item setLabel:lengthened([item label])];
}

void lengthenItems(NSPopUpButton* choice)
{
    for (NSMenuItem* item : tsuiEach<NSMenuItem*>([choice itemArray]))
        [item setTitle:lengthened([item title])];
}

void lengthenText(NSView* view)
{
    if ([view isKindOfClass:[NSPopUpButton class]])
        lengthenItems((NSPopUpButton*)view);
    else if ([view isKindOfClass:[NSButton class]])
        [(NSButton*)view setTitle:lengthened([(NSButton*)view title])];
    else if ([view isKindOfClass:[NSTextField class]] && isLabel((NSTextField*)view))
        [(NSTextField*)view setStringValue:lengthened([(NSTextField*)view stringValue])];
    else if ([view isKindOfClass:[NSTabView class]])
        lengthenTabs((NSTabView*)view);
    else if ([view isKindOfClass:[NSTableView class]])
        lengthenColumns((NSTableView*)view);
    else if ([view isKindOfClass:[NSBox class]])
        [(NSBox*)view setTitle:lengthened([(NSBox*)view title])];
}

// A word of letters: patterns as "(*.lsp)" and names of files stay as they are in every language.
bool isWord(NSString* word)
{
    return
        [word rangeOfString:@"*"].location == NSNotFound && [word rangeOfString:@"/"].location == NSNotFound;
}
} // namespace

std::vector<std::string> layoutFaults(NSView* view)
{
    Faults faults;
    check(faults, view);
    return faults;
}

void lengthenTexts(NSView* view)
{
    lengthenText(view);
    for (NSView* part : tsuiEach<NSView*>(partsOf(view)))
        lengthenTexts(part);
}

NSString* lengthened(NSString* text)
{
    NSMutableArray* words = [NSMutableArray array];
    for (NSString* word : tsuiEach<NSString*>([text componentsSeparatedByString:@" "]))
    {
        const NSUInteger more = isWord(word) ? ([word length] + 1) / 2 : 0;
        [words addObject:[word stringByAppendingString:[word substringToIndex:more]]];
    }
    return [words componentsJoinedByString:@" "];
}
