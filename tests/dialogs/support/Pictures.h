// What is drawn, to be compared.
#pragma once

#import <AppKit/AppKit.h>

// What the view looks like on the screen: equal as long as no pixel changes.
NSData* pictureOf(NSView* view);
// The same of a part of it, in its own coordinates.
NSData* pictureOf(NSView* view, NSRect part);
