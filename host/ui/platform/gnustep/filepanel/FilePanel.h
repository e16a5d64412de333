// The host's own file panel: a table of the files of one folder, the way to that folder, and a field for
// names.
//
// It has the interface of the toolkit's panel and nothing of its inside. What it decides without a window is
// in the plain files beside it; this class puts them together. Main thread only.
#pragma once

#import <AppKit/AppKit.h>

#include <cstddef>

@class TsFileTable;
@class TsPathBar;

namespace tessel::filepanel
{
struct PanelState;
}

@interface TsUIFilePanel : NSOpenPanel <NSTableViewDataSource, NSTableViewDelegate>
{
    tessel::filepanel::PanelState* mState;
    TsFileTable* mTable;
    TsPathBar* mWay;
    NSPopUpButton* mRecent;
    NSTextField* mName;
    NSButton* mHidden;
    NSButton* mOK;
    NSButton* mCancel;
    NSView* mAccessory;
    CGFloat mAccessoryHeight; // what it asked for when it came
    NSTimer* mLooks;          // for changes in a folder that cannot be watched
    NSInteger mUpdates;       // more than 0 while rows are selected by the panel itself
    BOOL mIsWatching;
    BOOL mIsFitting; // columns are made wider and narrower by the panel itself
    BOOL mChoosesFolders;
    BOOL mChoosesSeveral;
    BOOL mTakesNewNames;
}

// Whether a typed name may be that of a file that is not there yet, in a folder that is. Off unless switched
// on.
- (void)setTakesNewNames:(BOOL)takes;

@end

// FilePanel+Parts.mm
@interface TsUIFilePanel (Parts)
- (void)makeParts;
- (void)placeParts;
- (void)setWidth:(CGFloat)width ofColumn:(NSString*)identifier;
- (void)growFor:(NSView*)accessory;
- (void)fitOnScreen;
@end

// FilePanel+Listing.mm: what the table lists.
@interface TsUIFilePanel (Listing)
// Reads the folder that is wanted, unless that is the one that shows; asks the delegate in any case.
- (void)bringUpToDate;
- (void)bringUpToDateSoon;
- (void)cancelPendingWork;
- (void)forgetPendingWork;
- (void)listFolder:(NSString*)folder;
// The same folder again, with its place kept.
- (void)listAgain;
- (void)sortAgain;
- (void)sortBy:(NSString*)column;
- (void)markSortedColumn;
- (BOOL)isListed:(NSString*)path;
@end

// FilePanel+Watching.mm: while the panel runs it shows what happens in its folder.
@interface TsUIFilePanel (Watching)
- (void)startWatching;
- (void)stopWatching;
// Watches the folder that shows; before it is read, so that nothing is missed.
- (void)watchFolder;
@end

// FilePanel+Choosing.mm: which files are chosen, by rows or by typed names.
@interface TsUIFilePanel (Choosing)
- (void)rowsWereChosen;
- (void)chooseTyped;
// Chooses again after the list has changed.
- (void)chooseAgain;
- (void)showSelectedRows:(NSIndexSet*)rows;
- (NSString*)typedText;
- (void)beginTyping:(NSString*)text;
// What double-click and Return do.
- (void)takeDefaultAction;
// Goes into the folder that is all that is selected or typed, and answers whether there is one.
- (BOOL)goIntoFolder;
- (BOOL)tellOfMissingFile;
- (void)updateDefaultButton;
// The row whose name begins with the letters, or -1.
- (NSInteger)rowBeginningWith:(NSString*)letters from:(std::size_t)row;
- (void)dragSelectionFrom:(NSView*)view;
@end

// FilePanel+Going.mm: from folder to folder.
@interface TsUIFilePanel (Going)
- (void)goTo:(NSString*)folder;
- (IBAction)goUp:(id)sender;
- (IBAction)goHome:(id)sender;
- (IBAction)goToStep:(id)sender;
- (IBAction)goToRecent:(id)sender;
- (IBAction)toggleHidden:(id)sender;
- (BOOL)takeKey:(NSEvent*)event;
- (void)showRecentFolders;
- (void)rememberFolder;
// Hidden files and the columns as the person left them.
- (void)restoreLook;
- (void)rememberColumns;
@end
