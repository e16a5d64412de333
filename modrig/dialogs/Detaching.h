// Taking a view apart from the object that it was loaded for.
#pragma once

#import <AppKit/AppKit.h>

namespace ModrigUtils
{
// Ends what leads from the view and everything in it to the object: bindings, targets, delegates and data
// sources. A binding keeps the object alive, which keeps the view; the others would outlive it.
void DetachFrom(id object, NSView* view);
} // namespace ModrigUtils
