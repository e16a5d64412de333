// Paths and rows between the dialogs and the module's logic.
#pragma once

#import <AppKit/AppKit.h>

#include <functional>
#include <string_view>
#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Of strings.
std::vector<CStdStr> PathsFromStrings(NSArray* strings);
// Of `ModrigFilePath` rows.
std::vector<CStdStr> PathsFromRows(NSArray* rows);

// New rows for the paths, links not resolved before their names are taken.
NSArray* RowsFromPaths(const std::vector<CStdStr>& paths);

// Removes the row of an index from the table. Neither array may go before the function does.
std::function<void(std::size_t index)> RemovingRows(NSArray* rows, NSArrayController* table);

// Takes the selected rows out of the table, all in one change, and answers their paths: a table that changed
// for each of thousands of rows would be told of its selection as often.
std::vector<CStdStr> TakeSelectedRows(NSArrayController* table);

// Places in a table, ascending.
std::vector<std::size_t> IndexesFromSet(NSIndexSet* set);
NSIndexSet* SetFromIndexes(const std::vector<std::size_t>& indexes);

// What a column shows of a row; nil for a row that is not there.
id ValueInRow(NSArrayController* rows, NSTableColumn* column, NSInteger row);

// Whether the dialogs take both for the same file: by the toolkit's rule, for which accents, too, may be
// written in two ways, and case does not matter. No path is the same as none.
bool AreSamePath(NSString* path, NSString* other);

CStdStr PathFromString(NSString* text);
NSString* StringFromPath(const CStdStr& path);

// Whether each character is one byte wherever the path goes.
bool IsAscii(std::wstring_view path);

// What the toolkit's stringByResolvingSymlinksInPath makes of the path.
CStdStr ResolvedByToolkit(const CStdStr& path);
} // namespace ModrigUtils
