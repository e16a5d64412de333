// Paths and rows between the dialogs and the module's logic.
#pragma once

#import <Foundation/Foundation.h>

#include <vector>

#include "module/CStdStr.h"
#include "module/CStringList.h"

namespace ModrigUtils
{
// Of strings.
std::vector<CStdStr> PathsFromStrings(NSArray* strings);
// Of `ModrigFilePath` rows.
std::vector<CStdStr> PathsFromRows(NSArray* rows);

// New rows for the paths, links not resolved before their names are taken.
NSArray* RowsFromPaths(const std::vector<CStdStr>& paths);

CStdStr PathFromString(NSString* text);
NSString* StringFromPath(const CStdStr& path);
NSArray* StringsFromList(const CStringList& list);
} // namespace ModrigUtils
