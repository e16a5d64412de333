#include <algorithm>
#include <filesystem>

#include <sys/stat.h>

#include <tessel/tsmessagebox.h>
#include <wincompat/winstring.h>

#include "host/ui/Words.h"
#import "host/ui/platform/gnustep/filepanel/FileDrag.h"
#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"
#include "host/ui/platform/gnustep/filepanel/TypedNames.h"

using namespace tessel::filepanel;
using tessel::wordWith;

namespace
{
bool fileExists(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0;
}

bool isHost(NSString* path)
{
    return [path caseInsensitiveCompare:[[NSBundle mainBundle] bundlePath]] == NSOrderedSame;
}
} // namespace

@implementation TsUIFilePanel (Choosing)

- (BOOL)isWalkedThrough:(const std::string&)path
{
    if (!isFolder(path) || mChoosesFolders)
        return NO;
    return _treatsFilePackagesAsDirectories ||
           ![[NSWorkspace sharedWorkspace] isFilePackageAtPath:string(path)];
}

- (std::vector<Entry>)selectedEntries
{
    std::vector<Entry> entries;
    NSIndexSet* rows = [mTable selectedRowIndexes];
    for (NSUInteger row = [rows firstIndex]; row != NSNotFound; row = [rows indexGreaterThanIndex:row])
        if (row < mState->entries.size())
            entries.push_back(mState->entries[row]);
    return entries;
}

// The path of a name as it stands in the name field, where names that are no text are written with escapes.
- (std::string)pathOfTypedName:(const std::string&)name
{
    const std::string path = typedPath(name, mState->folder, bytes(NSHomeDirectory()));
    const auto row =
        std::ranges::find(mState->entries, name, [](const Entry& entry) { return readableName(entry.name); });
    return fileExists(path) || row == mState->entries.end() ? path : mState->pathOf(*row);
}

// The paths that stand in the name field: one name is taken as it is where there is such a file.
- (std::vector<std::string>)typedPaths
{
    const std::string text = bytes([self typedText]);
    const std::string whole = [self pathOfTypedName:text];
    if (text.empty() || fileExists(whole))
        return text.empty() ? std::vector<std::string>() : std::vector<std::string>{whole};
    std::vector<std::string> paths;
    for (const std::string& name : typedNames(text))
        paths.push_back([self pathOfTypedName:name]);
    return paths;
}

- (void)choose:(std::vector<std::string>)paths
{
    mState->chosen = std::move(paths);
    [self updateDefaultButton];
    id delegate = [self delegate];
    if ([delegate respondsToSelector:@selector(panelSelectionDidChange:)])
        [delegate panelSelectionDidChange:self];
}

- (std::vector<std::string>)pathsOfRows
{
    std::vector<std::string> paths;
    for (const Entry& entry : [self selectedEntries])
        if (mChoosesFolders || !entry.isWalkedThrough())
            paths.push_back(mState->pathOf(entry));
    return paths;
}

- (BOOL)isMissing:(const std::string&)path
{
    return !fileExists(path) &&
           !(mTakesNewNames && isFolder(std::filesystem::path(path).parent_path().string()));
}

- (std::vector<std::string>)pathsOfTyping
{
    std::vector<std::string> paths = [self typedPaths];
    std::erase_if(paths, [&](const std::string& path)
                  { return [self isMissing:path] || [self isWalkedThrough:path]; });
    return paths;
}

- (void)showNamesOfRows
{
    std::vector<std::string> names;
    for (const Entry& entry : [self selectedEntries])
        if (mChoosesFolders || !entry.isWalkedThrough())
            names.push_back(readableName(entry.name));
    mState->typed.clear();
    [mName setStringValue:string(fieldText(names))];
}

- (void)rowsWereChosen
{
    mState->isTyped = false;
    [self showNamesOfRows];
    [self choose:[self pathsOfRows]];
}

- (void)tableViewSelectionDidChange:(NSNotification*)notification
{
    if (mUpdates == 0)
        [self rowsWereChosen];
}

- (void)showSelectedRows:(NSIndexSet*)rows
{
    ++mUpdates;
    if ([rows count])
        [mTable selectRowIndexes:rows byExtendingSelection:NO];
    else
        [mTable deselectAll:nil];
    --mUpdates;
}

- (void)chooseAgain
{
    std::vector<std::string> paths = mState->isTyped ? [self pathsOfTyping] : [self pathsOfRows];
    if (paths == mState->chosen)
        return;
    if (!mState->isTyped)
        [self showNamesOfRows];
    [self choose:std::move(paths)];
}

// The rows of the typed names are selected, so that list and field never say two things.
- (void)chooseTyped
{
    mState->isTyped = true;
    std::vector<std::string> paths = [self pathsOfTyping];
    NSMutableIndexSet* rows = [NSMutableIndexSet indexSet];
    for (std::size_t row = 0; row < mState->entries.size(); ++row)
        if (std::ranges::find(paths, mState->pathOf(mState->entries[row])) != paths.end())
            [rows addIndex:row];
    [self showSelectedRows:rows];
    if ([rows count])
        [mTable scrollRowToVisible:static_cast<NSInteger>([rows firstIndex])];
    [self choose:std::move(paths)];
}

- (NSString*)typedText
{
    NSText* editor = [mName currentEditor];
    return editor ? [editor string] : [mName stringValue];
}

// The names that a typed beginning may mean, in the folder that leads to them.
- (std::vector<std::string>)namesBeginningWith:(const TypedStart&)start
{
    const std::string folder =
        typedPath(start.way.empty() ? "." : start.way, mState->folder, bytes(NSHomeDirectory()));
    std::vector<Entry> entries;
    if (folder == mState->folder)
        entries = mState->entries;
    else
        entries = readFolder(folder, start.beginning.starts_with('.'));
    std::vector<std::string> names;
    for (const Entry& entry : entries)
        if (beginsLike(readableName(entry.name), start.beginning) &&
            [self isListed:string(folder + "/" + entry.name)])
            names.push_back(readableName(entry.name));
    std::ranges::sort(names);
    return names;
}

// Puts the rest of the name after what is typed, selected: the next letter takes its place.
- (void)completeIn:(NSText*)editor
{
    const std::string text = bytes([editor string]);
    const bool grows = text.size() > mState->typed.size() && text.starts_with(mState->typed);
    mState->typed = text;
    if (!grows || text.starts_with('"') || [editor selectedRange].location != [[editor string] length])
        return;
    const TypedStart start = typedStart(text);
    if (start.beginning.empty())
        return;
    const std::string name = completed(start.beginning, [self namesBeginningWith:start]);
    if (name.empty())
        return;
    const NSUInteger typedLength = [[editor string] length];
    NSString* whole = string(start.way + name);
    [editor setString:whole];
    [editor setSelectedRange:NSMakeRange(typedLength, [whole length] - typedLength)];
}

- (void)controlTextDidChange:(NSNotification*)notification
{
    if ([notification object] != mName)
        return;
    if (!mTakesNewNames) // a new name may be the beginning of one that is there
        [self completeIn:[mName currentEditor]];
    [self chooseTyped];
}

- (void)beginTyping:(NSString*)text
{
    [mName setStringValue:@""];
    mState->typed.clear();
    [self makeFirstResponder:mName];
    [[mName currentEditor] setString:text];
    [[mName currentEditor] setSelectedRange:NSMakeRange([text length], 0)];
    mState->typed = bytes(text);
    [self chooseTyped];
}

// Of the rows, or of the name field: its only path when it is a folder to go into.
- (std::optional<std::string>)folderToGoInto
{
    std::vector<std::string> paths;
    if (mState->isTyped)
        paths = [self typedPaths];
    else
        for (const Entry& entry : [self selectedEntries])
            paths.push_back(mState->pathOf(entry));
    if (paths.size() != 1 || !isFolder(paths.front()))
        return std::nullopt;
    if ([self isWalkedThrough:paths.front()] || isHost(string(paths.front())))
        return paths.front();
    return std::nullopt;
}

- (BOOL)goIntoFolder
{
    const auto folder = [self folderToGoInto];
    if (folder)
        [self goTo:string(*folder)];
    return folder.has_value();
}

- (BOOL)tellOfMissingFile
{
    if (!mState->isTyped)
        return NO;
    for (const std::string& path : [self typedPaths])
    {
        if (![self isMissing:path])
            continue;
        NSString* text = wordWith(@"NO_SUCH_FILE", string(path));
        VqHostMessageBox::simple()->show(NSStringToWstring(text).c_str(), MB_ICONEXCLAMATION, nullptr);
        return YES;
    }
    return NO;
}

- (void)takeDefaultAction
{
    [self bringUpToDate];
    if ([mOK target] == self)
        return [self ok:mOK];
    if (![self goIntoFolder] && ![self tellOfMissingFile])
        [NSApp sendAction:[mOK action] to:[mOK target] from:mOK];
}

// Another target may have more to do than to take what is chosen here.
- (void)updateDefaultButton
{
    const bool hasSomething = !mState->chosen.empty() || [mTable numberOfSelectedRows] > 0 ||
                              (mState->isTyped && [[self typedText] length] > 0);
    [mOK setEnabled:[mOK target] != self || hasSomething];
}

- (NSInteger)rowBeginningWith:(NSString*)letters from:(std::size_t)row
{
    const auto found = rowBeginningLike(mState->entries, bytes(letters), row);
    return found ? static_cast<NSInteger>(*found) : -1;
}

- (void)dragSelectionFrom:(NSView*)view
{
    NSArray* paths = [self filenames];
    if ([paths count] == 0)
        return;
    TsFileDrag* drag = [[TsFileDrag alloc] initWithPaths:paths from:view];
    [drag run];
    [drag release];
}

@end
