#include "modrig/dialogs/Layout.h"

#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/model/WindowPlace.h"

namespace ModrigUtils
{
namespace
{
Frame frameOf(NSRect rect)
{
    return {NSMinX(rect), NSMinY(rect), NSWidth(rect), NSHeight(rect)};
}

NSTableColumn* firstColumnOf(NSTableView* table)
{
    return [[table tableColumns] objectAtIndex:0];
}
} // namespace

void RestoreFrame(NSWindow* window, TsUIPersistentStore* settings, NSString* name)
{
    NSString* stored = [settings getControlString:kSettingsGroup control:name];
    const NSRect remembered = [stored length] ? NSRectFromString(stored) : NSZeroRect;
    NSScreen* screen = [NSScreen mainScreen];
    if (NSIsEmptyRect(remembered) || !screen)
        return;
    const NSSize least = [window minSize];
    const Frame frame =
        OnScreen(frameOf(remembered), frameOf([screen visibleFrame]), least.width, least.height);
    [window setFrame:NSMakeRect(frame.x, frame.y, frame.width, frame.height) display:NO];
}

void StoreFrame(NSWindow* window, TsUIPersistentStore* settings, NSString* name)
{
    if (window)
        [settings putControlString:kSettingsGroup control:name value:NSStringFromRect([window frame])];
}

void RestoreColumns(NSTableView* table, TsUIPersistentStore* settings, NSString* name)
{
    const int width = [settings getControlInt:kSettingsGroup control:name];
    if (width > 0)
        [firstColumnOf(table) setWidth:width];
    [table sizeLastColumnToFit];
}

void StoreColumns(NSTableView* table, TsUIPersistentStore* settings, NSString* name)
{
    [settings putControlInt:kSettingsGroup control:name value:static_cast<int>([firstColumnOf(table) width])];
}
} // namespace ModrigUtils
