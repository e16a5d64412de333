// The host's file panel alone, used as a person does.
#pragma once

#include "tests/dialogs/support/DialogTest.h"

// The delegate of the panel: hides the files whose names contain a text, and counts what it is told
// and asked.
@interface PanelListener : NSObject
{
@public
    NSString* hidden;
    int told;
    int asked;
}
@end

class FilePanelTest : public DialogTest
{
protected:
    void SetUp() override;
    void TearDown() override;

    // Runs the panel in the test's folder, or one in it, and ends it by Cancel after the steps.
    void use(std::vector<ModalStep> steps, const std::string& folder = "");
    // The same, for steps that end it themselves; answers what the run answered.
    NSInteger run(std::vector<ModalStep> steps, const std::string& folder = "");

    std::vector<std::wstring> shown() { return filesShownIn(mPanel); }
    std::vector<std::wstring> chosen();
    std::wstring folder() { return wide([mPanel directory]); }
    std::wstring name();
    NSTableView* table() { return fileTable(mPanel); }
    NSIndexSet* rows() { return [table() selectedRowIndexes]; }
    std::vector<NSUInteger> selectedRows();
    NSInteger firstVisibleRow();
    // The button that shows this title, on the way to the folder or elsewhere in the panel.
    NSButton* button(const std::wstring& title);
    void type(NSString* letters);
    NSString* in(const std::string& name) { return text((mFolder / name).wstring()); }

    NSOpenPanel* mPanel = nil;
    PanelListener* mListener = nil;
};
