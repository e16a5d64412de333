#include <algorithm>
#include <unordered_set>

#include <tesselui/tsuieach.h>

#include "host/text/DayAndTime.h"
#include "host/ui/Words.h"
#include "host/ui/platform/gnustep/ThemePictures.h"
#import "host/ui/platform/gnustep/filepanel/FileNameCell.h"
#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"
#import "host/ui/platform/gnustep/filepanel/PathBar.h"

using namespace tessel::filepanel;
using tessel::word;

namespace
{
NSArray* runningModes()
{
    return [NSArray
        arrayWithObjects:NSDefaultRunLoopMode, NSModalPanelRunLoopMode, NSEventTrackingRunLoopMode, nil];
}

NSString* dateText(std::time_t date)
{
    return [NSString stringWithUTF8String:tessel::dayAndTime(date).c_str()];
}

NSImage* iconOf(const Entry& entry)
{
    return tessel::windowing::iconOfFile(string(entry.name), entry.isFolder);
}

Column columnOf(NSString* identifier)
{
    if ([identifier isEqual:@"kind"])
        return Column::kKind;
    return [identifier isEqual:@"date"] ? Column::kDate : Column::kName;
}

NSString* titleOf(NSString* identifier)
{
    switch (columnOf(identifier))
    {
    case Column::kKind:
        return word(@"KIND_COLUMN");
    case Column::kDate:
        return word(@"DATE_COLUMN");
    default:
        return word(@"NAME_COLUMN");
    }
}

KindWords kindWords()
{
    return {bytes(word(@"FOLDER")), bytes(word(@"PACKAGE")), bytes(word(@"FILE")),
            bytes(word(@"FILE_OF_KIND"))};
}
} // namespace

@implementation TsUIFilePanel (Listing)

- (BOOL)isPackage:(NSString*)path
{
    return !_treatsFilePackagesAsDirectories && [[NSWorkspace sharedWorkspace] isFilePackageAtPath:path];
}

- (BOOL)isListed:(NSString*)path
{
    id delegate = [self delegate];
    return ![delegate respondsToSelector:@selector(panel:shouldShowFilename:)] ||
           [delegate panel:self shouldShowFilename:path];
}

// What the delegate leaves of the files.
- (std::vector<Entry>)entriesToShow
{
    const KindWords words = kindWords();
    std::vector<Entry> shown;
    for (Entry& entry : readFolder(mState->folder, [self showsHiddenFiles]))
    {
        NSString* path = string(mState->pathOf(entry));
        if (![self isListed:path])
            continue;
        entry.isPackage = entry.isFolder && [self isPackage:path];
        entry.kind = kindOf(entry, words);
        shown.push_back(std::move(entry));
    }
    return shown;
}

- (void)sortEntries:(std::vector<Entry>&)entries
{
    if (mState->order.column == Column::kDate)
        for (Entry& entry : entries)
            entry.changed = dateOf(mState->pathOf(entry));
    sortEntries(entries, mState->order);
}

- (void)readEntries
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    [self watchFolder];
    mState->seen = stateOf(mState->folder);
    std::vector<Entry> entries = [self entriesToShow];
    [self sortEntries:entries];
    mState->entries = std::move(entries);
    [pool drain];
}

- (void)scrollTo:(CGFloat)top
{
    NSClipView* clip = (NSClipView*)[mTable superview];
    [clip scrollToPoint:[clip constrainScrollPoint:NSMakePoint(NSMinX([clip bounds]), top)]];
    [[mTable enclosingScrollView] reflectScrolledClipView:clip];
}

- (void)reloadTable
{
    ++mUpdates;
    [mTable deselectAll:nil];
    [mTable reloadData];
    --mUpdates;
}

- (void)listFolder:(NSString*)folder
{
    mState->wanted = mState->folder = nearestFolder(bytes(folder));
    [self readEntries];
    [self reloadTable];
    [self scrollTo:0];
    [mWay showFolder:string(mState->folder)];
    mState->isTyped = false;
    [self rowsWereChosen];
}

// The rows that show stand where they stood, in whatever becomes of the list.
- (void)changeRowsBy:(SEL)change
{
    const std::vector<Entry> before = mState->entries;
    std::unordered_set<std::string> selected;
    NSIndexSet* indexes = [mTable selectedRowIndexes];
    for (NSUInteger row = [indexes firstIndex]; row != NSNotFound; row = [indexes indexGreaterThanIndex:row])
        selected.insert(before[row].name);
    const NSRect visible = [mTable visibleRect];
    const NSInteger top = std::max<NSInteger>(0, [mTable rowAtPoint:visible.origin]);
    const CGFloat offset = before.empty() ? 0 : NSMinY(visible) - NSMinY([mTable rectOfRow:top]);
    [self performSelector:change];
    [self reloadTable];
    NSMutableIndexSet* kept = [NSMutableIndexSet indexSet];
    for (std::size_t row = 0; row < mState->entries.size(); ++row)
        if (selected.contains(mState->entries[row].name))
            [kept addIndex:row];
    [self showSelectedRows:kept];
    const std::size_t place = rowInPlaceOf(before, static_cast<std::size_t>(top), mState->entries);
    if (!mState->entries.empty())
        [self scrollTo:NSMinY([mTable rectOfRow:static_cast<NSInteger>(place)]) + offset];
    [self chooseAgain];
}

- (void)listAgain
{
    if (mState->folder.empty())
        return; // nothing shows yet
    if (nearestFolder(mState->folder) != mState->folder)
        return [self listFolder:string(mState->folder)];
    [self changeRowsBy:@selector(readEntries)];
}

- (void)bringUpToDate
{
    if (mState->wanted == mState->folder)
        return;
    [self forgetPendingWork];
    [self listFolder:string(mState->wanted)];
}

// Who has the delegate asked again, and sends the panel away and back as well, means one question.
- (void)finishPendingWork
{
    const bool isAsked = mState->isAsked;
    mState->isAsked = false;
    if (mState->wanted != mState->folder)
        [self bringUpToDate];
    else if (!isAsked)
        [self listAgain];
}

- (void)bringUpToDateSoon
{
    [self cancelPendingWork];
    [self performSelector:@selector(finishPendingWork) withObject:nil afterDelay:0 inModes:runningModes()];
}

- (void)forgetPendingWork
{
    [self cancelPendingWork];
    mState->isAsked = false;
}

- (void)cancelPendingWork
{
    [NSObject cancelPreviousPerformRequestsWithTarget:self selector:@selector(finishPendingWork) object:nil];
}

- (void)sortRows
{
    [self sortEntries:mState->entries];
}

- (void)sortAgain
{
    [self changeRowsBy:@selector(sortRows)];
}

- (void)sortBy:(NSString*)identifier
{
    mState->order = afterClickOn(columnOf(identifier), mState->order);
    [self sortAgain];
    [self markSortedColumn];
}

// In the title: the toolkit's headers have no place for a mark of their own.
- (void)markSortedColumn
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([mTable tableColumns]))
    {
        NSString* title = titleOf([column identifier]);
        const bool isSorted = columnOf([column identifier]) == mState->order.column;
        NSString* mark = string(mState->order.descending ? "  \u2193" : "  \u2191");
        [[column headerCell] setStringValue:isSorted ? [title stringByAppendingString:mark] : title];
    }
    [[mTable headerView] setNeedsDisplay:YES];
}

- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    return static_cast<NSInteger>(mState->entries.size());
}

- (id)tableView:(NSTableView*)table objectValueForTableColumn:(NSTableColumn*)column row:(NSInteger)row
{
    if (row < 0 || static_cast<std::size_t>(row) >= mState->entries.size())
        return nil;
    Entry& entry = mState->entries[static_cast<std::size_t>(row)];
    if ([[column identifier] isEqual:@"name"])
        return string(shownName(entry.name));
    if ([[column identifier] isEqual:@"kind"])
        return string(entry.kind);
    if (!entry.changed)
        entry.changed = dateOf(mState->pathOf(entry)).value_or(0);
    return *entry.changed ? dateText(*entry.changed) : @"";
}

- (void)tableView:(NSTableView*)table
    willDisplayCell:(id)cell
     forTableColumn:(NSTableColumn*)column
                row:(NSInteger)row
{
    const bool isThere = row >= 0 && static_cast<std::size_t>(row) < mState->entries.size();
    if (isThere && [[column identifier] isEqual:@"name"])
        [(TsFileNameCell*)cell setFileIcon:iconOf(mState->entries[static_cast<std::size_t>(row)])];
}

- (void)tableView:(NSTableView*)table didClickTableColumn:(NSTableColumn*)column
{
    [self sortBy:[column identifier]];
}

@end
