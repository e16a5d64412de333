// The choice of the file types, and what is remembered of it.
#include "tests/dialogs/support/DialogTest.h"

#include "modrig/messages/MessageIds.h"
#include "modrig/types/FileFilters.h"

#import "modrig/dialogs/TsOCModrigUtil.h"

namespace
{
class FileTypes : public OpenDialogTest
{
protected:
    std::optional<std::wstring> stored() const
    {
        return host().registry.value(host().moduleKey(), L"FileFilter");
    }
};
// The uppermost row of the view's window in which something dark is drawn, within a part of the view.
NSInteger topOfInk(NSView* view, NSRect part)
{
    [view lockFocus];
    NSBitmapImageRep* picture = [[[NSBitmapImageRep alloc] initWithFocusedViewRect:part] autorelease];
    [view unlockFocus];
    const CGFloat top = NSMaxY([view convertRect:part toView:nil]);
    for (NSInteger row = 0; row < [picture pixelsHigh]; ++row)
        for (NSInteger column = 0; column < [picture pixelsWide]; ++column)
            if ([[picture colorAtX:column y:row] brightnessComponent] < 0.4)
                return static_cast<NSInteger>(top) - row;
    return 0;
}
} // namespace

TEST_F(FileTypes, StandInLineWithTheNameFieldAndWithTheirLabel)
{
    open();
    show();
    NSView* label = [[mController view] valueForKey:@"fileTypesLabel"];
    NSView* choice = [[mController view] valueForKey:@"fileTypesChoice"];
    NSTextField* name = nameField(mPanel);
    EXPECT_EQ(NSMinX([name convertRect:[name bounds] toView:nil]), NSMinX([choice convertRect:[choice bounds]
                                                                                       toView:nil]));
    [mPanel display];
    // The letters F and A, without the edge of the pop-up button.
    EXPECT_EQ(topOfInk(label, NSMakeRect(1, 0, 9, NSHeight([label bounds]))),
              topOfInk(choice, NSInsetRect(NSMakeRect(8, 0, 10, NSHeight([choice bounds])), 0, 4)));
}

TEST_F(FileTypes, AreNotStoredByOpening)
{
    open();
    close();
    EXPECT_FALSE(stored());
}

TEST_F(FileTypes, AreStoredByTheirDescriptionWhenSomebodyChoosesOne)
{
    open();
    chooseFileType(kLispFileType);
    EXPECT_EQ(wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_LSP_APPS"]), stored());
    EXPECT_EQ(stored(), ModrigUtils::GetRegFileFilterListIndex().Text());
    chooseFileType(kAllFileTypes);
    EXPECT_EQ(wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_TESSEL_APPS"]), stored());
}

TEST_F(FileTypes, AreNotStoredWhenTheProgramChangesThem)
{
    open();
    [fileTypes() setSelectionIndex:kLispFileType];
    [mController onFileTypesChanged:nil];
    EXPECT_FALSE(stored());
}

TEST_F(FileTypes, OpenAtTheFirstWhateverIsStored)
{
    host().registry.setValue(host().moduleKey(), L"FileFilter",
                             wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_LSP_APPS"]));
    open();
    EXPECT_EQ(kAllFileTypes, [fileTypes() selectionIndex]);
}

TEST_F(FileTypes, ThatCannotBeStoredAreToldAndUsed)
{
    open();
    host().registry.failWhen([](const RecordingRegistry::Call& call)
                             { return call.valueName == L"FileFilter" ? ERROR_WRITE_FAULT : ERROR_SUCCESS; });
    chooseFileType(kLispFileType);
    EXPECT_EQ(std::vector<std::wstring>{Message(ModrigMessages::kFilterNotStored, L"%s")}, boxes());
    EXPECT_EQ(kLispFileType, [fileTypes() selectionIndex]);
}
