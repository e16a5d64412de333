// The box of the Load/Unload dialog that takes files dropped on it into the Startup Suite.
#pragma once

#import <AppKit/AppKit.h>

@interface ModrigStartupSuiteBox : NSBox
@end
