#import "host/ui/platform/gnustep/filepanel/FileNameCell.h"

#include <initializer_list>

namespace
{
constexpr CGFloat kIconWidth = 16;
constexpr CGFloat kIconPlace = 24; // from the cell's edge to its text

NSColor* folderColor()
{
    return [NSColor colorWithCalibratedRed:0.42 green:0.62 blue:0.91 alpha:1];
}

NSColor* lineColor()
{
    return [NSColor colorWithCalibratedRed:0.55 green:0.58 blue:0.62 alpha:1];
}

NSColor* packageColor()
{
    return [NSColor colorWithCalibratedRed:0.93 green:0.69 blue:0.35 alpha:1];
}

// All shapes in a square of 16 units, its origin the upper left corner.
NSBezierPath* polygon(std::initializer_list<NSPoint> points)
{
    NSBezierPath* path = [NSBezierPath bezierPath];
    for (const NSPoint& point : points)
        [path elementCount] ? [path lineToPoint:point] : [path moveToPoint:point];
    [path closePath];
    return path;
}

void drawFolder()
{
    [folderColor() set];
    [polygon({{1, 3}, {6, 3}, {7.5, 5}, {15, 5}, {15, 13.5}, {1, 13.5}}) fill];
    [[[NSColor whiteColor] colorWithAlphaComponent:0.35] set];
    NSRectFillUsingOperation(NSMakeRect(1, 6.5, 14, 1), NSCompositeSourceOver);
}

void drawDocument()
{
    NSBezierPath* page = polygon({{3.5, 1.5}, {9.5, 1.5}, {12.5, 4.5}, {12.5, 14.5}, {3.5, 14.5}});
    [[NSColor whiteColor] set];
    [page fill];
    [lineColor() set];
    [page stroke];
    [polygon({{9.5, 1.5}, {9.5, 4.5}, {12.5, 4.5}}) stroke];
}

void drawPackage()
{
    [packageColor() set];
    [polygon({{8, 1}, {14.5, 4.2}, {14.5, 11.8}, {8, 15}, {1.5, 11.8}, {1.5, 4.2}}) fill];
    [[NSColor whiteColor] set];
    NSBezierPath* edges = [NSBezierPath bezierPath];
    for (const NSPoint& end : {NSMakePoint(1.5, 4.2), NSMakePoint(14.5, 4.2), NSMakePoint(8, 15)})
    {
        [edges moveToPoint:NSMakePoint(8, 7.5)];
        [edges lineToPoint:end];
    }
    [edges stroke];
}

void drawIcon(TsFileIcon icon, NSPoint corner, bool flipped)
{
    [NSGraphicsContext saveGraphicsState];
    NSAffineTransform* place = [NSAffineTransform transform];
    [place translateXBy:corner.x yBy:flipped ? corner.y : corner.y + kIconWidth];
    if (!flipped)
        [place scaleXBy:1 yBy:-1];
    [place concat];
    if (icon == TsFolderIcon)
        drawFolder();
    else if (icon == TsPackageIcon)
        drawPackage();
    else
        drawDocument();
    [NSGraphicsContext restoreGraphicsState];
}
} // namespace

@implementation TsFileNameCell

- (void)setFileIcon:(TsFileIcon)icon
{
    mIcon = icon;
}

- (void)drawInteriorWithFrame:(NSRect)frame inView:(NSView*)view
{
    const CGFloat top = NSMidY(frame) - kIconWidth / 2;
    drawIcon(mIcon, NSMakePoint(NSMinX(frame) + 4, top), [view isFlipped]);
    frame.origin.x += kIconPlace;
    frame.size.width -= kIconPlace;
    [super drawInteriorWithFrame:frame inView:view];
}

@end
