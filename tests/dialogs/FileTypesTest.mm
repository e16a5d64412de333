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
    NSArrayController* types() { return [mController valueForKey:@"fileTypes"]; }
    void choose(NSUInteger place)
    {
        [types() setSelectionIndex:place];
        [mController onFileTypesChanged:types()];
    }
    std::optional<std::wstring> stored() const
    {
        return host().registry.value(host().moduleKey(), L"FileFilter");
    }
};
} // namespace

TEST_F(FileTypes, AreNotStoredByOpening)
{
    open();
    close();
    EXPECT_FALSE(stored());
}

TEST_F(FileTypes, AreStoredByTheirDescriptionWhenSomebodyChoosesOne)
{
    open();
    choose(3);
    EXPECT_EQ(wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_LSP_APPS"]), stored());
    EXPECT_EQ(stored(), ModrigUtils::GetRegFileFilterListIndex().Text());
    choose(0);
    EXPECT_EQ(wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_TESSEL_APPS"]), stored());
}

TEST_F(FileTypes, AreNotStoredWhenTheProgramChangesThem)
{
    open();
    [types() setSelectionIndex:3];
    [mController onFileTypesChanged:nil];
    EXPECT_FALSE(stored());
}

TEST_F(FileTypes, OpenAtTheFirstWhateverIsStored)
{
    host().registry.setValue(host().moduleKey(), L"FileFilter",
                             wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_LSP_APPS"]));
    open();
    EXPECT_EQ(0u, [types() selectionIndex]);
}

TEST_F(FileTypes, ThatCannotBeStoredAreToldAndUsed)
{
    open();
    host().registry.failWhen([](const RecordingRegistry::Call& call)
                             { return call.valueName == L"FileFilter" ? ERROR_WRITE_FAULT : ERROR_SUCCESS; });
    choose(3);
    EXPECT_EQ(std::vector<std::wstring>{Message(ModrigMessages::kFilterNotStored, L"%s")}, boxes());
    EXPECT_EQ(3u, [types() selectionIndex]);
}
