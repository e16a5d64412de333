#include "host/ui/platform/gnustep/TextFitting.h"

namespace tessel::windowing
{
namespace
{
NSString* beginning(NSString* text, NSUInteger length)
{
    return [[text substringToIndex:length] stringByAppendingString:@"\u2026"];
}
} // namespace

NSString* fitted(NSString* text, NSFont* font, CGFloat width)
{
    NSDictionary* attributes = [NSDictionary dictionaryWithObject:font forKey:NSFontAttributeName];
    const auto fits = [=](NSString* candidate)
    { return [candidate sizeWithAttributes:attributes].width <= width; };
    if (fits(text))
        return text;
    NSUInteger fitting = 0;
    NSUInteger tooLong = [text length];
    while (tooLong - fitting > 1)
    {
        const NSUInteger middle = fitting + (tooLong - fitting) / 2;
        (fits(beginning(text, middle)) ? fitting : tooLong) = middle;
    }
    return beginning(text, fitting);
}
} // namespace tessel::windowing
