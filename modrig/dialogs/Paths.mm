#include "modrig/dialogs/Paths.h"

#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#import "modrig/dialogs/ModrigFilePath.h"

#include "modrig/dialogs/model/ShownText.h"

namespace ModrigUtils
{
std::vector<CStdStr> PathsFromStrings(NSArray* strings)
{
    std::vector<CStdStr> paths;
    for (NSString* path : tsuiEach<NSString*>(strings))
        paths.push_back(PathFromString(path));
    return paths;
}

std::vector<CStdStr> PathsFromRows(NSArray* rows)
{
    std::vector<CStdStr> paths;
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
        paths.push_back([row path]);
    return paths;
}

NSArray* RowsFromPaths(const std::vector<CStdStr>& paths)
{
    NSMutableArray* rows = [NSMutableArray array];
    for (const CStdStr& path : paths)
    {
        ModrigFilePath* row = [[ModrigFilePath alloc] initWithFilePathName:StringFromPath(path)];
        [rows addObject:row];
        [row release];
    }
    return rows;
}

std::function<void(std::size_t)> RemovingRows(NSArray* rows, NSArrayController* table)
{
    return [=](std::size_t index) { [table removeObject:[rows objectAtIndex:index]]; };
}

id ValueInRow(NSArrayController* rows, NSTableColumn* column, NSInteger row)
{
    NSArray* all = [rows arrangedObjects];
    if (row < 0 || static_cast<NSUInteger>(row) >= [all count])
        return nil;
    NSString* value = [[all objectAtIndex:static_cast<NSUInteger>(row)] valueForKey:[column identifier]];
    return StringFromPath(ShownText(PathFromString(value)));
}

CStdStr PathFromString(NSString* text)
{
    return CStdStr(NSStringToWstring(text));
}

NSString* StringFromPath(const CStdStr& path)
{
    return wcharToNSString(path.c_str());
}

NSArray* StringsFromList(const CStringList& list)
{
    NSMutableArray* strings = [NSMutableArray arrayWithCapacity:list.GetCount()];
    for (const CStdStr& path : list)
        [strings addObject:StringFromPath(path)];
    return strings;
}
} // namespace ModrigUtils
