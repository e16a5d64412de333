// One choice of the file types that a file dialog shows.
#pragma once

#import <Foundation/Foundation.h>

@interface TsOCFileFilter : NSObject
{
    NSString* mDescription;
    NSArray* mFileExtensions;
}

// `extensions`: separated by ";", each with or without a leading "*." ("lsp;qbc", "*.lsp;*.qbc").
- (id)initWithDescription:(NSString*)description extensionStr:(NSString*)extensions;

// What the user reads.
- (NSString*)description;

// The extensions as strings, without the dot.
- (NSArray*)fileExtensions;

@end
