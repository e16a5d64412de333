// What the dialogs share: the module's localized texts.
#pragma once

#import <Foundation/Foundation.h>

@interface TsOCModrigUtil : NSObject

// The text of the key in the string table of the module's bundle; the key itself when there is none.
+ (NSString*)modrigLoadString:(NSString*)key;

@end
