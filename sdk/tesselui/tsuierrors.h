// Errors that the toolkit raises as exceptions.
#pragma once

#import <Foundation/NSString.h>

#include "../tessel/tsdefs.h"

// Calls the function and answers what the toolkit raised meanwhile, "name: reason", or nil. An application
// written in Objective-C++ needs it on every platform where GCC compiles it: there, GCC's own `@catch`
// crashes.
extern "C" TESSEL_API NSString* tsuiErrorOf(void (*function)(void*), void* argument);
