#import <tesselui/TsUIPersistentStore.h>

#include "host/ui/Words.h"
#include "host/ui/platform/gnustep/Keys.h"
#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"

using namespace tessel::filepanel;
using tessel::word;

namespace
{
NSString* const kSettings = @"FilePanel";

NSString* const kHiddenSetting = @"HiddenFiles";
NSString* const kResizedColumns[] = {@"kind", @"date"};

NSString* widthSetting(NSString* column)
{
    return [column stringByAppendingString:@"Width"];
}

TsUIPersistentStore* openSettings()
{
    return [[[TsUIPersistentStore alloc] init] autorelease];
}

NSString* recentSetting(std::size_t place)
{
    return [NSString stringWithFormat:@"RecentFolder%d", static_cast<int>(place + 1)];
}

std::vector<std::string> recentFolders()
{
    TsUIPersistentStore* store = openSettings();
    std::vector<std::string> folders;
    for (std::size_t place = 0; place < kMostRecentFolders; ++place)
        if (NSString* folder = [store getControlString:kSettings control:recentSetting(place)])
            folders.push_back(bytes(folder));
    return folders;
}

void storeRecentFolders(const std::vector<std::string>& folders)
{
    TsUIPersistentStore* store = openSettings();
    for (std::size_t place = 0; place < folders.size(); ++place)
        [store putControlString:kSettings control:recentSetting(place) value:string(folders[place])];
}
} // namespace

@implementation TsUIFilePanel (Going)

- (void)goTo:(NSString*)folder
{
    [self forgetPendingWork];
    [self listFolder:folder];
    [self makeFirstResponder:(NSView*)mTable];
}

// The folder that was left is shown among the others, so that the keyboard is where it came from.
- (IBAction)goUp:(id)sender
{
    [self bringUpToDate];
    const std::string left = mState->folder;
    [self goTo:string(folderAbove(left))];
    const auto row = rowOf(mState->entries, left.substr(left.rfind('/') + 1));
    if (!row)
        return;
    [(NSTableView*)mTable scrollRowToVisible:static_cast<NSInteger>(*row)];
    if (mState->entries[*row].isWalkedThrough())
        [self showSelectedRows:[NSIndexSet indexSetWithIndex:*row]];
}

- (IBAction)goHome:(id)sender
{
    [self goTo:NSHomeDirectory()];
}

- (IBAction)goToStep:(id)sender
{
    [self goTo:[[sender cell] representedObject]];
}

- (IBAction)goToRecent:(id)sender
{
    if (NSString* folder = [[mRecent selectedItem] representedObject])
        [self goTo:folder];
}

- (IBAction)toggleHidden:(id)sender
{
    [openSettings() putControlState:kSettings control:kHiddenSetting state:[mHidden state] == NSOnState];
    [self listAgain];
}

// In the list or in the name field.
- (BOOL)hasKeyboardInFiles
{
    NSResponder* responder = [self firstResponder];
    return responder == mTable || responder == mName || (responder && responder == [mName currentEditor]);
}

// The keys that do the same wherever the keyboard is.
- (BOOL)takeKey:(NSEvent*)event
{
    NSString* characters = [event charactersIgnoringModifiers];
    const unichar key = [characters length] ? [characters characterAtIndex:0] : 0;
    if (key == tessel::kEscapeKey)
        return [self cancel:self], YES;
    // The toolkit would press the default button, which knows nothing of folders to go into.
    if ((key == NSCarriageReturnCharacter || key == NSEnterCharacter) && [self hasKeyboardInFiles])
        return [self takeDefaultAction], YES;
    if (key == NSF5FunctionKey)
        return [self listAgain], YES;
    const bool isAlt = ([event modifierFlags] & (NSCommandKeyMask | NSAlternateKeyMask)) != 0;
    if (key == NSUpArrowFunctionKey && isAlt)
        return [self goUp:self], YES;
    return NO;
}

- (void)showRecentFolders
{
    [mRecent removeAllItems];
    [mRecent addItemWithTitle:word(@"RECENT")]; // the title of the button itself
    for (const std::string& folder : recentFolders())
    {
        [mRecent addItemWithTitle:string(shownName(folder))];
        [[mRecent lastItem] setRepresentedObject:string(folder)];
    }
}

- (void)restoreLook
{
    TsUIPersistentStore* store = openSettings();
    [mHidden setState:[store getControlState:kSettings control:kHiddenSetting] ? NSOnState : NSOffState];
    for (NSString* column : kResizedColumns)
        if (const int width = [store getControlInt:kSettings control:widthSetting(column)]; width > 0)
            [self setWidth:width ofColumn:column];
}

- (void)rememberColumns
{
    TsUIPersistentStore* store = openSettings();
    for (NSString* column : kResizedColumns)
    {
        NSTableColumn* resized = [(NSTableView*)mTable tableColumnWithIdentifier:column];
        [store putControlInt:kSettings control:widthSetting(column) value:static_cast<int>([resized width])];
    }
}

- (void)rememberFolder
{
    storeRecentFolders(withRecentFolder(recentFolders(), mState->wanted));
}

@end
