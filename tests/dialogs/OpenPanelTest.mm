#include "tests/dialogs/support/DialogTest.h"

#include <objc/runtime.h>

#include "host/text/Unicode.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/module/DialogBridge.h"

#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
const std::wstring kPanelSettings = L"Software\\Tessel\\R21\\Profiles\\Default\\DialogSettings\\Modrig";

class OpenPanel : public OpenDialogTest
{
protected:
    void openIn(const std::filesystem::path& folder)
    {
        host().registry.setValue(kPanelSettings, L"InitialPath", folder.wstring());
        open();
    }
    // Runs the dialog in a folder; after the steps it is cancelled.
    void runIn(const std::filesystem::path& folder, std::vector<ModalStep> steps)
    {
        host().registry.setValue(kPanelSettings, L"InitialPath", folder.wstring());
        runDialog(std::move(steps));
    }
    bool shows(const std::filesystem::path& path)
    {
        return [mController panel:mPanel shouldShowFilename:text(path.wstring())];
    }
    std::vector<std::wstring> shownFiles() { return filesShownIn(mPanel); }
    std::wstring shownName() { return wide([nameField(mPanel) stringValue]); }
    void typeName(NSString* name) { typeNameInto(mPanel, name); }
    void click(std::initializer_list<const wchar_t*> names) { selectFilesIn(mPanel, names); }
    // Selects the folder and presses Return.
    void enter(const wchar_t* folder)
    {
        click({folder});
        pressKey(mPanel, @"\r");
    }
    bool isIn(const std::filesystem::path& folder) { return wide([mPanel directory]) == folder.wstring(); }
};
} // namespace

TEST_F(OpenPanel, ReplacesThePanelsButtons)
{
    open();
    NSOpenPanel* panel = [[mPanel retain] autorelease];
    NSButton* ok = [panel okButton];
    NSButton* cancel = [panel cancelButton];
    ASSERT_TRUE(ok && cancel);
    EXPECT_TRUE([ok isHidden]);
    EXPECT_EQ(mController, [ok target]);
    EXPECT_TRUE(sel_isEqual(@selector(openPanelOK:), [ok action]));
    EXPECT_EQ(L"Close", wide([cancel title]));
    EXPECT_TRUE(NSEqualRects([ok frame], [cancel frame]));
    EXPECT_NE(nil, [panel accessoryView]);
    close();
    EXPECT_EQ(nil, [panel accessoryView]);
    EXPECT_EQ(nil, [panel delegate]);
}

TEST_F(OpenPanel, ShowsTheDialogsViewAndHelpButtonUnderItsOwnTitle)
{
    open();
    EXPECT_EQ([mController view], [mPanel accessoryView]);
    EXPECT_EQ(L"Load", wide([mPanel title]));
    EXPECT_TRUE([mPanel allowsMultipleSelection]);
    NSButton* help = [mController valueForKey:@"helpButton"];
    EXPECT_EQ([[mPanel okButton] superview], [help superview]);
    EXPECT_EQ(NSMinX([[mPanel hideExtensionButton] frame]), NSMinX([help frame]));
    EXPECT_EQ(NSMinY([[mPanel okButton] frame]), NSMinY([help frame]));
    EXPECT_NE(0u, [[mController view] autoresizingMask] & NSViewWidthSizable);
}

TEST_F(OpenPanel, OpensInTheHostsFolderUnlessAnotherIsRemembered)
{
    open();
    EXPECT_EQ(wide([[NSBundle mainBundle] bundlePath]), wide([mPanel directory]));
    close();
    openIn("");
    EXPECT_EQ(wide([[NSBundle mainBundle] bundlePath]), wide([mPanel directory]));
    close();
    openIn(mFolder.path());
    EXPECT_EQ(mFolder.path().wstring(), wide([mPanel directory]));
}

TEST_F(OpenPanel, OpensInTheNearestFolderThatIsLeftOfTheRememberedOne)
{
    openIn(mFolder / "gone/for/good");
    EXPECT_EQ(mFolder.path().wstring(), wide([mPanel directory]));
}

TEST_F(OpenPanel, FiltersAgainInsideAPackageThatTheFilterHides)
{
    mFolder.write("tool.bundle/inner.lsp", "");
    openIn(mFolder / "tool.bundle");
    chooseFileType(kLispFileType);
    EXPECT_TRUE(shows(mFolder / "tool.bundle/inner.lsp"));
}

TEST_F(OpenPanel, StartsWithTheFirstOfSixFilters)
{
    open();
    EXPECT_EQ(6u, [[fileTypes() arrangedObjects] count]);
    EXPECT_EQ(kAllFileTypes, [fileTypes() selectionIndex]);
}

TEST_F(OpenPanel, ShowsFilesOfTheFilterAndFolders)
{
    mFolder.write("a.LSP", "");
    mFolder.write("a.txt", "");
    mFolder.write("folder/inside.txt", "");
    mFolder.write("Other.app/inside.txt", "");
    mFolder.write("tool.bundle/tool", "");
    open();
    chooseFileType(kLispFileType);
    EXPECT_TRUE(shows(mFolder / "a.LSP"));
    EXPECT_FALSE(shows(mFolder / "a.txt"));
    EXPECT_TRUE(shows(mFolder / "folder"));
    EXPECT_FALSE(shows(mFolder / "Other.app"));
    EXPECT_FALSE(shows(mFolder / "tool.bundle"));
    chooseFileType(kBundleFileType);
    EXPECT_TRUE(shows(mFolder / "tool.bundle"));
    EXPECT_FALSE(shows(mFolder / "a.LSP"));
}

TEST_F(OpenPanel, ShowsEveryPackageWhereItTreatsThemAsFolders)
{
    mFolder.write("Other.app/inside.txt", "");
    open();
    chooseFileType(kLispFileType);
    EXPECT_FALSE(shows(mFolder / "Other.app"));
    [mPanel setTreatsFilePackagesAsDirectories:YES];
    EXPECT_TRUE(shows(mFolder / "Other.app"));
}

TEST_F(OpenPanel, ShowsTheHostItself)
{
    open();
    chooseFileType(kLispFileType);
    EXPECT_TRUE(shows(wide([[NSBundle mainBundle] bundlePath])));
}

TEST_F(OpenPanel, JudgesALinkByWhatItLeadsTo)
{
    file("real.lsp");
    std::filesystem::create_symlink(mFolder / "real.lsp", mFolder / "link.txt");
    std::filesystem::create_symlink(mFolder / "gone.lsp", mFolder / "broken.lsp");
    open();
    EXPECT_TRUE(shows(mFolder / "link.txt"));
    EXPECT_FALSE(shows(mFolder / "broken.lsp"));
    EXPECT_FALSE(shows(mFolder / "missing.lsp"));
}

TEST_F(OpenPanel, HidesEverythingWithoutAFilter)
{
    open();
    [fileTypes() setContent:[NSMutableArray array]];
    EXPECT_FALSE(shows(mFolder.path()));
    EXPECT_FALSE(shows(file("tool.lsp")));
}

TEST_F(OpenPanel, FiltersTheListingAgainInTheSameFolder)
{
    for (const char* name : {"one.lsp", "two.zmb", "three.txt"})
        file(name);
    runIn(mFolder.path(), {[this]
                           {
                               EXPECT_THAT(shownFiles(), ElementsAre(L"one.lsp", L"two.zmb"));
                               chooseFileType(kLispFileType);
                               EXPECT_THAT(shownFiles(), ElementsAre(L"one.lsp"));
                               chooseFileType(kAllFileTypes);
                               EXPECT_THAT(shownFiles(), ElementsAre(L"one.lsp", L"two.zmb"));
                           }});
}

TEST_F(OpenPanel, KeepsTheSelectedFilesAsTheyStandInThePanel)
{
    for (const char* name : {"one.lsp", "two.zmb"})
        file(name);
    runIn(mFolder.path(), {[this] { click({L"two.zmb"}); },
                           [this] { EXPECT_THAT(selectedFiles(), ElementsAre(file("two.zmb"))); }});
}

TEST_F(OpenPanel, TakesAFolderThatIsWalkedThroughForNoSelection)
{
    mFolder.write("folder/one.lsp", "");
    runIn(mFolder.path(), {[this]
                           {
                               selectFiles({"old.lsp"});
                               enter(L"folder");
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               EXPECT_EQ(L"", shownName());
                           },
                           [this] { return isIn(mFolder / "folder"); },
                           [this]
                           {
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               EXPECT_THAT(boxes(), IsEmpty());
                               EXPECT_THAT(shownFiles(), ElementsAre(L"one.lsp"));
                               click({L"one.lsp"});
                           },
                           [this] { EXPECT_THAT(selectedFiles(), ElementsAre(file("folder/one.lsp"))); }});
}

TEST_F(OpenPanel, RemembersTheFolderThatTheUserWentTo)
{
    mFolder.write("folder/one.zmb", "");
    runIn(mFolder.path(), {[this] { enter(L"folder"); }, [this] { return isIn(mFolder / "folder"); },
                           [this] { click({L"one.zmb"}); }, [this] { [mController onLoad:nil]; }});
    EXPECT_EQ((mFolder / "folder").wstring(), host().registry.value(kPanelSettings, L"InitialPath"));
}

TEST_F(OpenPanel, KnowsTheHostsFolderInAnyCase)
{
    open();
    NSString* folder = [[NSBundle mainBundle] bundlePath];
    EXPECT_TRUE([mController isTesselFolder:folder]);
    EXPECT_TRUE([mController isTesselFolder:[folder uppercaseString]]);
    EXPECT_FALSE([mController isTesselFolder:[folder stringByDeletingLastPathComponent]]);
    EXPECT_FALSE([mController isTesselFolder:nil]);
}

TEST_F(OpenPanel, LoadsWithReturnAndClosesWithEscape)
{
    host().registry.setValue(kPanelSettings, L"InitialPath", mFolder.path().wstring());
    file("one.zmb");
    const ModalSteps steps({[this]
                            {
                                mPanel = [runningPanel() retain];
                                click({L"one.zmb"});
                            },
                            [this] { pressKey(mPanel, @"\r"); },
                            [this] { return host().linker.isLoaded(file("one.zmb")); },
                            [this]
                            {
                                EXPECT_TRUE([mPanel isVisible]);
                                pressKey(mPanel, @"\033");
                            }});
    ModrigUtils::RunModrigDialog();
    EXPECT_FALSE([mPanel isVisible]);
    [mPanel release];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"one.zmb")));
}

TEST_F(OpenPanel, ForgetsTheSelectedFileWhenTheListingIsFilteredAgain)
{
    for (const char* name : {"one.lsp", "two.zmb"})
        file(name);
    runIn(mFolder.path(), {[this] { click({L"two.zmb"}); },
                           [this]
                           {
                               EXPECT_THAT(selectedFiles(), ElementsAre(file("two.zmb")));
                               EXPECT_EQ(L"two.zmb", shownName());
                               chooseFileType(kLispFileType);
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               EXPECT_EQ(L"", shownName());
                               [mController onLoad:nil];
                               EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
                           }});
}

TEST_F(OpenPanel, LoadsTheTypedNameWithTheLoadButton)
{
    for (const char* name : {"one.zmb", "two.zmb"})
        file(name);
    runIn(mFolder.path(), {[this]
                           {
                               selectFiles({"one.zmb"});
                               typeName(@"two.zmb");
                           },
                           [this]
                           {
                               // A click on the button takes the keyboard from the name.
                               [mPanel makeFirstResponder:nil];
                               [mController onLoad:nil];
                               EXPECT_TRUE(host().linker.isLoaded(file("two.zmb")));
                               EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
                               EXPECT_EQ(L"two.zmb", shownName());
                           }});
}

TEST_F(OpenPanel, LoadsNothingForATypedNameOfNoFile)
{
    file("one.zmb");
    mFolder.write("folder/inside.zmb", "");
    runIn(mFolder.path(), {[this] { click({L"one.zmb"}); },
                           [this]
                           {
                               typeName(@"folder");
                               [mController onLoad:nil];
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               EXPECT_THAT(boxes(), IsEmpty());
                               typeName(@"zz.zmb");
                               [mController onLoad:nil];
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
                               EXPECT_THAT(boxes(), ElementsAre(L"There is no file \"" +
                                                                (mFolder / "zz.zmb").wstring() + L"\"."));
                           }});
}

TEST_F(OpenPanel, LoadsSelectedFilesInItsOwnOrder)
{
    for (const char* name : {"a.zmb", "b.zmb", "c.zmb"})
        file(name);
    runIn(mFolder.path(), {[this] {
                               click({L"c.zmb", L"a.zmb"});
                           },
                           [this]
                           {
                               [mController panelSelectionDidChange:mPanel];
                               EXPECT_THAT(selectedFiles(), ElementsAre(file("a.zmb"), file("c.zmb")));
                           }});
}

TEST_F(OpenPanel, MovesIntoTheHostsFolderVisiblyWithLoad)
{
    NSString* host = [[NSBundle mainBundle] bundlePath];
    const std::wstring name = wide([host lastPathComponent]);
    runIn(tessel::toUtf8(wide([host stringByDeletingLastPathComponent])),
          {[&]
           {
               click({name.c_str()});
               EXPECT_THAT(selectedFiles(), ElementsAre(wide(host)));
               [mController onLoad:nil];
           },
           // What lies in the program's folder there are folders only.
           [&] { return shownFiles() == std::vector<std::wstring>{L"Resources"}; },
           [&] { EXPECT_EQ(wide(host), wide([mPanel directory])); }});
}

TEST_F(OpenPanel, ShowsTheSameFolderForEveryTypeAlsoInAPackageThatOneHides)
{
    mFolder.write("tool.bundle/inner.lsp", "");
    const std::wstring package = (mFolder / "tool.bundle").wstring();
    runIn(package, {[this] { chooseFileType(kLispFileType); },
                    [&]
                    {
                        EXPECT_EQ(package, wide([mPanel directory]));
                        EXPECT_THAT(shownFiles(), ElementsAre(L"inner.lsp"));
                        chooseFileType(kBundleFileType);
                    },
                    [&]
                    {
                        EXPECT_EQ(package, wide([mPanel directory]));
                        EXPECT_THAT(shownFiles(), IsEmpty());
                        chooseFileType(kLispFileType);
                    },
                    [&] { EXPECT_THAT(shownFiles(), ElementsAre(L"inner.lsp")); }});
}

TEST_F(OpenPanel, MovesIntoTheHostsFolderWithReturnAndWithADoubleClick)
{
    NSString* host = [[NSBundle mainBundle] bundlePath];
    NSString* outside = [host stringByDeletingLastPathComponent];
    const std::wstring name = wide([host lastPathComponent]);
    const auto isInside = [&] { return wide([mPanel directory]) == wide(host); };
    runIn(tessel::toUtf8(wide(outside)),
          {[&] { click({name.c_str()}); }, [&] { pressKey(mPanel, @"\r"); }, [&] { return isInside(); },
           [&] { [mPanel setDirectory:outside]; }, [&] { click({name.c_str()}); },
           [&] { clickRow(fileTable(mPanel), [fileTable(mPanel) selectedRow], 0, 2); },
           [&] { return isInside(); }});
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(OpenPanel, KeepsWhatIsChosenInTheHistoryWhenATypeHidesItsOwnFile)
{
    for (const char* name : {"one.lsp", "two.zmb", "old.zmb"})
        file(name);
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    runIn(mFolder.path(), {[this] { click({L"two.zmb"}); },
                           [this]
                           {
                               select(historyTable(), {0});
                               chooseFileType(kLispFileType);
                               EXPECT_EQ(L"", shownName());
                               EXPECT_THAT(selectedFiles(), ElementsAre(file("old.zmb")));
                               [mController onLoad:nil];
                               EXPECT_TRUE(host().linker.isLoaded(file("old.zmb")));
                               EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
                           }});
}

TEST_F(OpenPanel, LoadsTheFileThatItStillShowsAsSelectedAfterARemovalFromTheHistory)
{
    for (const char* name : {"two.zmb", "old.zmb"})
        file(name);
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    runIn(mFolder.path(), {[this] { click({L"two.zmb"}); },
                           [this]
                           {
                               select(historyTable(), {0});
                               [mController onRemove:nil];
                               EXPECT_THAT(selectedFiles(), IsEmpty());
                               [mController onLoad:nil];
                               EXPECT_TRUE(host().linker.isLoaded(file("two.zmb")));
                           }});
}
