// The cell of a file's name, with its icon: drawn, and so sharp at every scale.
#pragma once

#import <AppKit/AppKit.h>

enum TsFileIcon
{
    TsFolderIcon,
    TsPackageIcon,
    TsDocumentIcon
};

@interface TsFileNameCell : NSTextFieldCell
{
    TsFileIcon mIcon;
}
- (void)setFileIcon:(TsFileIcon)icon;
@end
