// The table of the file panel: selecting by mouse and keyboard as on any desktop, going to a row by its first
// letters, and dragging files out.
#pragma once

#import <AppKit/AppKit.h>

@class TsUIFilePanel;

namespace tessel::filepanel
{
struct RowSelection;
}

@interface TsFileTable : NSTableView
{
    TsUIFilePanel* mPanel;
    tessel::filepanel::RowSelection* mSelection;
    NSMutableString* mLetters;
    NSTimeInterval mLastLetter;
}

// Not retained.
- (void)setPanel:(TsUIFilePanel*)panel;

@end
