#import "ui/ModrigStartupSuiteBox.h"

#import "ui/ModrigController.h"
#import "ui/TsOCModrigUtil.h"

@implementation ModrigStartupSuiteBox

- (NSDragOperation)draggingEntered:(id<NSDraggingInfo>)sender
{
    return [[TsOCModrigUtil getModrigController] draggingEnteredStartupSuite:sender];
}

- (BOOL)performDragOperation:(id<NSDraggingInfo>)sender
{
    return [[TsOCModrigUtil getModrigController] performDragOperationToStartupSuite:sender];
}

@end
