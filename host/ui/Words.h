// The words of the host's windows, in the person's language.
#pragma once

#import <tesselui/tsuitexts.h>

namespace tessel
{
// The text of a key in the host's Windows.strings.
inline NSString* word(NSString* key)
{
    return tsuiTextOf([NSBundle mainBundle], key, @"Windows");
}

// The same with a text in its place.
inline NSString* wordWith(NSString* key, NSString* text)
{
    return [word(key) stringByReplacingOccurrencesOfString:@"%@" withString:text];
}
} // namespace tessel
