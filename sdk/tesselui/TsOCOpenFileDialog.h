// The host's dialog for choosing files.
#pragma once

#import <AppKit/AppKit.h>

@interface TsOCOpenFileDialog : NSObject
{
    NSString* mTitle;
    NSString* mInitialPath;
    NSArray* mFileFilters;
    NSArray* mSelectedPathes;
    BOOL mAllowsMultipleSelection;
}

- (void)setTitle:(NSString*)title;

// The folder that the dialog opens in.
- (void)setInitialPath:(NSString*)path;

// Off unless switched on.
- (void)setAllowsMultipleSelection:(BOOL)allows;

// The choices of file types, `TsOCFileFilter`s; the first is chosen. Without any, every file is shown.
- (void)setFileFilters:(NSArray*)filters;

// 1 (NSModalResponseOK) when the user has chosen, otherwise 0.
- (NSInteger)runModal;

// The full paths chosen by the last run, as strings; empty after a cancelled one.
- (NSArray*)selectedPathes;

@end
