#include "host/ui/Label.h"

namespace tessel::windowing
{
NSTextField* makeLabel(NSString* text, NSRect frame)
{
    NSTextField* label = [[[NSTextField alloc] initWithFrame:frame] autorelease];
    [label setStringValue:text];
    [label setFont:[NSFont systemFontOfSize:kControlFontSize]];
    [label setEditable:NO];
    [label setSelectable:NO];
    [label setBordered:NO];
    [label setBezeled:NO];
    [label setDrawsBackground:NO];
    return label;
}
} // namespace tessel::windowing
