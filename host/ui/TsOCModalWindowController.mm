#import <tesselui/TsOCModalWindowController.h>

@interface TsOCModalWindowController (Modal)
- (void)center:(NSWindow*)window over:(NSWindow*)parent;
- (void)run:(NSWindow*)window over:(NSWindow*)parent;
@end

@implementation TsOCModalWindowController

- (id)init
{
    return [self initWithWindowNibName:[self windowNibName]];
}

- (NSString*)windowNibName
{
    return [super windowNibName];
}

- (void)doInit
{
}

- (void)doClean
{
}

- (void)showModalWindowCenterOfParent:(NSWindow*)parent
{
    NSWindow* window = [self window];
    if (!window)
        return; // the toolkit has said which file it did not find
    [window setDelegate:(id)self];
    [self doInit];
    [self center:window over:parent];
    @try
    {
        [self run:window over:parent];
    }
    @finally
    {
        [parent removeChildWindow:window];
        [window setDelegate:nil];
        [window orderOut:nil];
        [self doClean];
        [parent makeKeyAndOrderFront:nil];
    }
}

- (void)center:(NSWindow*)window over:(NSWindow*)parent
{
    if (!parent)
        return [window center];
    const NSRect outer = [parent frame];
    const NSSize size = [window frame].size;
    [window setFrameOrigin:NSMakePoint(NSMidX(outer) - size.width / 2, NSMidY(outer) - size.height / 2)];
}

- (void)run:(NSWindow*)window over:(NSWindow*)parent
{
    // A click on the parent would otherwise raise it over the window, which is then out of reach.
    [parent addChildWindow:window ordered:NSWindowAbove];
    [NSApp runModalForWindow:window];
}

- (IBAction)closeModalWindow:(id)sender
{
    [NSApp stopModal];
}

- (BOOL)windowShouldClose:(id)sender
{
    [self closeModalWindow:sender];
    return YES;
}

@end
