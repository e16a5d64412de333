#include "modrig/dialogs/Paths.h"

#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#include <algorithm>

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

std::vector<CStdStr> TakeSelectedRows(NSArrayController* table)
{
    std::vector<CStdStr> paths = PathsFromRows([table selectedObjects]);
    [table removeObjectsAtArrangedObjectIndexes:[table selectionIndexes]];
    return paths;
}

std::vector<std::size_t> IndexesFromSet(NSIndexSet* set)
{
    std::vector<std::size_t> indexes;
    for (NSUInteger index = [set firstIndex]; index != NSNotFound; index = [set indexGreaterThanIndex:index])
        indexes.push_back(index);
    return indexes;
}

NSIndexSet* SetFromIndexes(const std::vector<std::size_t>& indexes)
{
    NSMutableIndexSet* set = [NSMutableIndexSet indexSet];
    for (const std::size_t index : indexes)
        [set addIndex:index];
    return set;
}

id ValueInRow(NSArrayController* rows, NSTableColumn* column, NSInteger row)
{
    NSArray* all = [rows arrangedObjects];
    if (row < 0 || static_cast<NSUInteger>(row) >= [all count])
        return nil;
    NSString* value = [[all objectAtIndex:static_cast<NSUInteger>(row)] valueForKey:[column identifier]];
    return StringFromPath(ShownText(PathFromString(value)));
}

bool AreSamePath(NSString* path, NSString* other)
{
    if (!path || !other)
        return path == other;
    return [path caseInsensitiveCompare:other] == NSOrderedSame;
}

CStdStr PathFromString(NSString* text)
{
    return CStdStr(NSStringToWstring(text));
}

NSString* StringFromPath(const CStdStr& path)
{
    return wcharToNSString(path.c_str());
}

bool IsAscii(std::wstring_view path)
{
    constexpr wchar_t kFirstBeyond = 0x80;
    return std::all_of(path.begin(), path.end(),
                       [](wchar_t character) { return character > 0 && character < kFirstBeyond; });
}

CStdStr ResolvedByToolkit(const CStdStr& path)
{
    return PathFromString([StringFromPath(path) stringByResolvingSymlinksInPath]);
}
} // namespace ModrigUtils
