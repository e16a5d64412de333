/* Plain Objective-C: in Objective-C++, GCC's @catch crashes. */
#import <Foundation/Foundation.h>

__attribute__((visibility("default"))) NSString* tsuiErrorOf(void (*function)(void*), void* argument);

NSString* tsuiErrorOf(void (*function)(void*), void* argument)
{
    @try
    {
        function(argument);
    }
    @catch (NSException* exception)
    {
        return [NSString stringWithFormat:@"%@: %@", [exception name], [exception reason]];
    }
    return nil;
}
