// What the dialogs share: the slot of the open Load/Unload dialog, rows without duplicates, the module's
// localized texts and file filters, and the questions asked about a file before it is accepted.
#pragma once

#import <AppKit/AppKit.h>

@class ModrigController;

@interface TsOCModrigUtil : NSObject

// The controller of the Load/Unload dialog while that is open, otherwise nil. It is retained meanwhile.
+ (void)setModrigController:(ModrigController*)controller;
+ (ModrigController*)getModrigController;

// Adds a row for the path, links resolved, unless the table has one for that file.
+ (void)addPathName:(NSString*)path toArrayController:(NSArrayController*)controller;

// The text of the key in the string table of the module's bundle, in English where the person's language has
// none; the key itself when there is none.
+ (NSString*)modrigLoadString:(NSString*)key;

// Appends the file types that the dialogs offer, `TsOCFileFilter`s: all applications, then kind by kind.
+ (void)populateModrigFileFilter:(NSMutableArray*)filters;

// Whether the file has the extension of an application kind. A path without one: kCannotLoadFile and NO.
+ (BOOL)isValidFileForModrig:(NSString*)path;

// The path at which the file is found, which may be another one of that name; nil when it is not found.
+ (NSString*)validateFileExists:(NSString*)path;

// Whether the file is a local copy of one from the internet.
+ (BOOL)isTempInternetFile:(NSString*)path;

@end
