// Texts for which there is too little room: the toolkit cuts them off in the middle of a letter.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// The text itself, or as much of its beginning as fits into the width with an ellipsis after it.
NSString* fitted(NSString* text, NSFont* font, CGFloat width);
} // namespace tessel::windowing
