#import "host/ui/platform/gnustep/filepanel/FileNameCell.h"

namespace
{
constexpr CGFloat kIconWidth = 16;
constexpr CGFloat kIconStart = 4;
constexpr CGFloat kTextStart = 24;
} // namespace

@implementation TsFileNameCell

- (void)setFileIcon:(NSImage*)icon
{
    mIcon = icon;
}

- (void)drawInteriorWithFrame:(NSRect)frame inView:(NSView*)view
{
    const NSRect place =
        NSMakeRect(NSMinX(frame) + kIconStart, NSMidY(frame) - kIconWidth / 2, kIconWidth, kIconWidth);
    [mIcon drawInRect:place
              fromRect:NSZeroRect
             operation:NSCompositeSourceOver
              fraction:1
        respectFlipped:YES
                 hints:nil];
    frame.origin.x += kTextStart;
    frame.size.width -= kTextStart;
    [super drawInteriorWithFrame:frame inView:view];
}

@end
