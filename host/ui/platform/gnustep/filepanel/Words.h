// The words of the file panel, in the person's language.
#pragma once

#import <Foundation/Foundation.h>

namespace tessel::filepanel
{
// The text of a key in the host's FilePanel.strings; the key itself where there is none.
inline NSString* word(NSString* key)
{
    return [[NSBundle mainBundle] localizedStringForKey:key value:@"" table:@"FilePanel"];
}

// The same with a text in its place.
inline NSString* wordWith(NSString* key, NSString* text)
{
    return [word(key) stringByReplacingOccurrencesOfString:@"%@" withString:text];
}
} // namespace tessel::filepanel
