// Errors that the toolkit raises as exceptions.
#pragma once

#import <Foundation/NSString.h>

#ifdef __cplusplus
extern "C"
{
#endif
    // Calls the function and answers what the toolkit raised meanwhile, "name: reason", or nil. (In a file of
    // plain Objective-C: GCC's Objective-C++ crashes where it should catch such an exception.)
    NSString* ModrigToolkitErrorOf(void (*function)(void*), void* argument);
#ifdef __cplusplus
}
#endif
