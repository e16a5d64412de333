// One row of a table of the dialogs: an application file.
#pragma once

#import <Foundation/Foundation.h>

#include "modrig/base/CStdStr.h"

@interface ModrigFilePath : NSObject
{
    NSString* mFilePathName;
    NSString* mFileName;
    NSString* mFilePath;
    BOOL mUnloadable;
    BOOL mIsPlain; // the characters of the path stand right after the object
}

// The full path with symbolic links resolved: what the row stands for.
@property (nonatomic, readonly) NSString* filePathName;
// File name and folder of the path as it was given.
@property (nonatomic, readonly) NSString* fileName;
@property (nonatomic, readonly) NSString* filePath;
// Whether the application could be unloaded when the row was made.
@property (nonatomic, readonly) BOOL unloadable;

// With nil all texts are nil, and `unloadable` is NO. A path without a dot: message 2.
- (id)initWithFilePathName:(NSString*)path;

// A new row, which the caller releases, for a path that has no symbolic links in it: the disk is not looked
// at. Few of many rows ever show, so its strings are made when they are first asked for.
+ (ModrigFilePath*)newWithResolvedPath:(const CStdStr&)path;

// What `unloadable` becomes for the path; asked once, when the row is made.
- (BOOL)findUnloadable:(const CStdStr&)path;

// `filePathName` as the module's logic takes it.
- (CStdStr)path;

// Whether both stand for the same file; case does not matter.
- (BOOL)isEqual:(id)other;
- (NSUInteger)hash;

@end
