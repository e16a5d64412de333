#include "modrig/dialogs/Detaching.h"

#include <tesselui/tsuieach.h>

namespace ModrigUtils
{
namespace
{
void unbindFrom(id object, NSView* view)
{
    for (NSString* binding : tsuiEach<NSString*>([view exposedBindings]))
        if ([[view infoForBinding:binding] objectForKey:NSObservedObjectKey] == object)
            [view unbind:binding];
}

void stopAsking(id object, id view)
{
    if ([view respondsToSelector:@selector(setTarget:)] && [view target] == object)
    {
        [view setTarget:nil];
        [view setAction:nullptr];
    }
    if ([view respondsToSelector:@selector(setDelegate:)] && [view delegate] == object)
        [view setDelegate:nil];
    if ([view respondsToSelector:@selector(setDataSource:)] && [view dataSource] == object)
        [view setDataSource:nil];
}

// The views of the tabs that do not show are no subviews.
void detachTabs(id object, NSView* view)
{
    if ([view isKindOfClass:[NSTabView class]])
        for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>([(NSTabView*)view tabViewItems]))
            DetachFrom(object, [item view]);
}
} // namespace

void DetachFrom(id object, NSView* view)
{
    unbindFrom(object, view);
    stopAsking(object, view);
    detachTabs(object, view);
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        DetachFrom(object, part);
}
} // namespace ModrigUtils
