#import "ui/ToolkitErrors.h"

#import <Foundation/Foundation.h>

NSString* ModrigToolkitErrorOf(void (*function)(void*), void* argument)
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
