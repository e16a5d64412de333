// The Startup Suite dialog: what is loaded at every start. Every change is made to the rows and to the
// module's list at once; the Load/Unload dialog stores the list when it closes.
#pragma once

#import <AppKit/AppKit.h>
#import <tesselui/TsOCModalWindowController.h>

@interface ModrigStartupSuitController : TsOCModalWindowController
{
    IBOutlet NSArrayController* startupApps;
    IBOutlet NSTableView* startupTableView;
    IBOutlet NSSegmentedControl* segmentedControl;
}

- (NSString*)windowNibName;
- (id)init;
- (void)doInit;
- (void)doClean;

// The control with the segments Add and Remove; the keys Insert and Delete do the same.
- (IBAction)onSegmentedButton:(id)sender;
- (void)onAdd;
- (void)onRemove;

// Loads the files (path strings), up to 50 of them, that are not in the Suite, and takes them into it.
- (void)addFiles:(NSArray*)paths;

- (void)tableViewSelectionDidChange:(NSNotification*)notification;
- (IBAction)help:(id)sender;

@end
