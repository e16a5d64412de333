// Foundation as far as the tables do not tell: types, macros, and functions that the compiler puts in place.
#pragma once

#include <TargetConditionals.h>
#include <limits.h>
#include <math.h>
#include <objc/objc.h>
#include <objc/runtime.h>
#include <stdarg.h>
#include <stdint.h>
#include <string.h>

#ifdef __cplusplus
#define FOUNDATION_EXPORT extern "C"
#else
#define FOUNDATION_EXPORT extern
#endif
#define APPKIT_EXTERN FOUNDATION_EXPORT
#define FOUNDATION_INLINE static inline
#define NS_REQUIRES_NIL_TERMINATION __attribute__((sentinel(0, 1)))
#define NSNotFound NSIntegerMax
#define IBOutlet __attribute__((annotate("outlet")))
#define IBAction void
#define NSLocalizedString(key, comment)                                                                      \
    [[NSBundle mainBundle] localizedStringForKey:(key) value:@"" table:nil]

#define NSIntegerMax LONG_MAX
#define NSIntegerMin LONG_MIN
#define NSUIntegerMax ULONG_MAX
typedef long NSInteger;
typedef unsigned long NSUInteger;
typedef double CGFloat;
typedef unsigned short unichar;
typedef double NSTimeInterval;
typedef NSInteger NSToolTipTag;
typedef NSInteger NSControlStateValue;
typedef NSInteger NSModalResponse;
typedef NSUInteger NSStringEncoding;
typedef unsigned int UTF32Char;
typedef unsigned int OSType;
typedef unsigned char Boolean;
typedef struct _NSZone NSZone;

struct CGPoint
{
    CGFloat x;
    CGFloat y;
};
struct CGSize
{
    CGFloat width;
    CGFloat height;
};
struct CGRect
{
    struct CGPoint origin;
    struct CGSize size;
};
struct _NSRange
{
    NSUInteger location;
    NSUInteger length;
};
struct NSEdgeInsets
{
    CGFloat top;
    CGFloat left;
    CGFloat bottom;
    CGFloat right;
};
typedef struct CGPoint CGPoint;
typedef struct CGSize CGSize;
typedef struct CGRect CGRect;
typedef struct CGPoint NSPoint;
typedef struct CGSize NSSize;
typedef struct CGRect NSRect;
typedef struct _NSRange NSRange;
typedef struct NSEdgeInsets NSEdgeInsets;
typedef NSPoint* NSPointPointer;
typedef NSRect* NSRectPointer;

struct NSFastEnumerationState
{
    unsigned long state;
    id __unsafe_unretained* itemsPtr;
    unsigned long* mutationsPtr;
    unsigned long extra[5];
};
typedef struct NSFastEnumerationState NSFastEnumerationState;

static const NSPoint NSZeroPoint = {0, 0};
static const NSSize NSZeroSize = {0, 0};
static const NSRect NSZeroRect = {{0, 0}, {0, 0}};

FOUNDATION_INLINE NSPoint NSMakePoint(CGFloat x, CGFloat y)
{
    NSPoint made = {x, y};
    return made;
}
FOUNDATION_INLINE NSSize NSMakeSize(CGFloat width, CGFloat height)
{
    NSSize made = {width, height};
    return made;
}
FOUNDATION_INLINE NSRect NSMakeRect(CGFloat x, CGFloat y, CGFloat width, CGFloat height)
{
    NSRect made = {{x, y}, {width, height}};
    return made;
}
FOUNDATION_INLINE NSRange NSMakeRange(NSUInteger location, NSUInteger length)
{
    NSRange made = {location, length};
    return made;
}
FOUNDATION_INLINE NSUInteger NSMaxRange(NSRange range)
{
    return range.location + range.length;
}
FOUNDATION_INLINE BOOL NSLocationInRange(NSUInteger location, NSRange range)
{
    return location >= range.location && location - range.location < range.length;
}
FOUNDATION_INLINE BOOL NSEqualRanges(NSRange one, NSRange other)
{
    return one.location == other.location && one.length == other.length;
}
FOUNDATION_INLINE CGFloat NSMaxX(NSRect rect)
{
    return rect.origin.x + rect.size.width;
}
FOUNDATION_INLINE CGFloat NSMaxY(NSRect rect)
{
    return rect.origin.y + rect.size.height;
}
FOUNDATION_INLINE CGFloat NSMidX(NSRect rect)
{
    return rect.origin.x + rect.size.width * 0.5;
}
FOUNDATION_INLINE CGFloat NSMidY(NSRect rect)
{
    return rect.origin.y + rect.size.height * 0.5;
}
FOUNDATION_INLINE CGFloat NSMinX(NSRect rect)
{
    return rect.origin.x;
}
FOUNDATION_INLINE CGFloat NSMinY(NSRect rect)
{
    return rect.origin.y;
}
FOUNDATION_INLINE CGFloat NSWidth(NSRect rect)
{
    return rect.size.width;
}
FOUNDATION_INLINE CGFloat NSHeight(NSRect rect)
{
    return rect.size.height;
}

#include "SystemTables.h"

typedef NSString* NSNotificationName;
typedef NSString* NSPasteboardType;
typedef NSString* NSBindingName;
typedef NSComparisonResult (^NSComparator)(id, id);

FOUNDATION_EXPORT void NSLog(NSString* format, ...) __attribute__((format(__NSString__, 1, 2)));
