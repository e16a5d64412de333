// What a dialog remembers between its runs: values by group (a dialog) and control. They belong to the
// current profile and are stored with everything else that the running command stores.
#pragma once

#import <Foundation/Foundation.h>

@interface TsUIPersistentStore : NSObject

// A check box: 0 off, 1 on. 0 when nothing is stored.
- (void)putControlState:(NSString*)group control:(NSString*)control state:(NSInteger)state;
- (NSInteger)getControlState:(NSString*)group control:(NSString*)control;

// A number. 0 when nothing is stored.
- (void)putControlInt:(NSString*)group control:(NSString*)control value:(int)value;
- (int)getControlInt:(NSString*)group control:(NSString*)control;

// A text; nil removes it. nil when nothing is stored.
- (void)putControlString:(NSString*)group control:(NSString*)control value:(NSString*)value;
- (NSString*)getControlString:(NSString*)group control:(NSString*)control;

@end
