/* Plain Objective-C: caught in Objective-C++, GCC hands over a pointer that is not the exception. */
#include <objc/objc.h>

id tesselCatch(void (*call)(const void* context), const void* context);

/* Answers the object that the call threw, or nil when it returned. */
id tesselCatch(void (*call)(const void* context), const void* context)
{
    @try
    {
        call(context);
    }
    @catch (id thrown)
    {
        return thrown;
    }
    return nil;
}
