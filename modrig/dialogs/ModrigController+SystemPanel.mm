#import "modrig/dialogs/ModrigController.h"

#import "modrig/dialogs/TsOCModrigUtil.h"

@implementation ModrigController (SystemPanel)

- (void)setupPanelWithoutButtons:(NSOpenPanel*)panel
{
    [panel setPrompt:[TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_MENU_LOAD"]];
}

- (BOOL)panel:(id)panel shouldEnableURL:(NSURL*)url
{
    return [self panel:panel shouldShowFilename:[url path]];
}

- (void)load:(NSArray*)urls
{
    [self choose:urls];
    [self openPanelOK:mOpenPanel];
}

// A press of the button may lead to a question about each file that is chosen, or to one, since that is
// refused.
- (BOOL)isFirstQuestion:(NSURL*)url of:(NSArray*)chosen
{
    const BOOL isFirst = [chosen count] < 2 || ![self.furtherQuestions containsObject:url];
    NSMutableArray* further = [[(isFirst ? chosen : self.furtherQuestions) mutableCopy] autorelease];
    [further removeObject:url];
    self.furtherQuestions = further;
    return isFirst;
}

- (BOOL)panel:(id)panel validateURL:(NSURL*)url error:(NSError**)error
{
    NSArray* chosen = [panel URLs];
    if ([self isFirstQuestion:url of:chosen])
        [self load:[self isAnyFileIn:chosen] ? chosen : [NSArray arrayWithObject:url]];
    // The system shows every error but this one, and what there is to tell has been told.
    if (error)
        *error = [NSError errorWithDomain:NSCocoaErrorDomain code:NSUserCancelledError userInfo:nil];
    return NO;
}

// To be sent into the module's own bundle is only the way to be asked again.
- (void)panel:(id)panel didChangeToDirectoryURL:(NSURL*)url
{
    NSString* folder = [url path];
    if (![folder isEqual:[[NSBundle bundleForClass:[self class]] bundlePath]])
        self.shownFolder = folder;
}

@end
