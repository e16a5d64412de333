// The name field of the host's file panel.
#include "tests/dialogs/support/FilePanelTest.h"

#include <tesselui/tsuifilepanel.h>

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class FilePanelNames : public FilePanelTest
{
protected:
    void SetUp() override
    {
        FilePanelTest::SetUp();
        for (const char* name : {"a b.lsp", "gears.omp", "gel.omp", "sub/inner.lsp"})
            mFolder.write(name, "");
    }
    NSButton* okButton() { return [[mPanel contentView] viewWithTag:kTsUIFilePanelDefaultButton]; }
};
} // namespace

TEST_F(FilePanelNames, OfExistingFilesAreTheChoice)
{
    use({[this]
         {
             const int told = mListener->told;
             typeNameInto(mPanel, @"gel.omp");
             EXPECT_THAT(chosen(), ElementsAre(file("gel.omp")));
             EXPECT_EQ(told + 1, mListener->told);
             EXPECT_THAT(selectedRows(), ElementsAre(3)) << "the list shows the same";
             typeNameInto(mPanel, @"\"gel.omp\" \"a b.lsp\"");
             EXPECT_THAT(chosen(), ElementsAre(file("gel.omp"), file("a b.lsp")));
             typeNameInto(mPanel, in("sub/inner.lsp"));
             EXPECT_THAT(chosen(), ElementsAre(file("sub/inner.lsp")));
             EXPECT_THAT(selectedRows(), IsEmpty());
             typeNameInto(mPanel, @"nothing.omp");
             EXPECT_THAT(chosen(), IsEmpty());
         }});
}

TEST_F(FilePanelNames, ThatAreNoTextAreWrittenWithEscapesAndTakenSo)
{
    const std::wstring odd = file("odd\xFF.lsp");
    const std::wstring inner = file("r\xE9pertoire/a.lsp");
    use({[&]
         {
             selectFilesIn(mPanel, {L"odd\\xFF.lsp"});
             EXPECT_EQ(L"odd\\xFF.lsp", name());
             EXPECT_THAT(chosen(), ElementsAre(odd));
             typeNameInto(mPanel, @"\"gel.omp\" \"odd\\xFF.lsp\"");
             EXPECT_THAT(chosen(), ElementsAre(file("gel.omp"), odd));
             typeNameInto(mPanel, @"r\\xE9pertoire");
             pressKey(mPanel, @"\r");
         },
         [&] { return shown() == std::vector<std::wstring>{L"a.lsp"}; },
         [&]
         {
             EXPECT_TRUE(button(L"r\\xE9pertoire"));
             clickRow(table(), 0);
         },
         [&] { return chosen() == std::vector{inner}; }});
}

TEST_F(FilePanelNames, EnableTheDefaultButton)
{
    use({[this]
         {
             EXPECT_FALSE([okButton() isEnabled]);
             typeNameInto(mPanel, in("sub/inner.lsp"));
             EXPECT_TRUE([okButton() isEnabled]);
             typeNameInto(mPanel, @"");
             EXPECT_FALSE([okButton() isEnabled]);
         }});
}

TEST_F(FilePanelNames, AreTakenWithReturn)
{
    EXPECT_EQ(NSModalResponseOK, run({[this] { typeNameInto(mPanel, in("sub/inner.lsp")); },
                                      [this] { pressKey(mPanel, @"\r"); }}));
    EXPECT_THAT(chosen(), ElementsAre(file("sub/inner.lsp")));
}

TEST_F(FilePanelNames, OfAFolderGoThereWithReturn)
{
    use({[this] { typeNameInto(mPanel, @"sub"); }, [this] { pressKey(mPanel, @"\r"); },
         [this] { return folder() == (mFolder / "sub").wstring(); },
         [this]
         {
             EXPECT_THAT(shown(), ElementsAre(L"inner.lsp"));
             EXPECT_EQ(L"", name());
             typeNameInto(mPanel, @"~");
         },
         [this] { pressKey(mPanel, @"\r"); }, [this] { return folder() == wide(NSHomeDirectory()); }});
}

TEST_F(FilePanelNames, OfNoFileAreToldAndTheRunGoesOn)
{
    use({[this] { typeNameInto(mPanel, @"nothing.omp"); }, [this] { pressKey(mPanel, @"\r"); },
         [] { return boxes().size() == 1; },
         [this]
         {
             EXPECT_THAT(boxes(),
                         ElementsAre(L"There is no file \"" + (mFolder / "nothing.omp").wstring() + L"\"."));
             EXPECT_TRUE([mPanel isVisible]);
         }});
}

TEST_F(FilePanelNames, AreCompletedWhileTheyAreTyped)
{
    use({[this] { [mPanel makeFirstResponder:nameField(mPanel)]; }, [this] { type(@"gea"); },
         [this] { return name() == L"gears.omp"; },
         [this]
         {
             EXPECT_TRUE(NSEqualRanges(NSMakeRange(3, 6), [[nameField(mPanel) currentEditor] selectedRange]));
             EXPECT_THAT(chosen(), ElementsAre(file("gears.omp")));
             pressKey(mPanel, @"\177"); // takes the completion away
         },
         [this] { return name() == L"gea"; }, [this] { EXPECT_THAT(chosen(), IsEmpty()); }});
}

TEST_F(FilePanelNames, AreCompletedInOtherFolders)
{
    use({[this] { typeNameInto(mPanel, in("sub/")); }, [this] { type(@"i"); },
         [this] { return name() == (mFolder / "sub/inner.lsp").wstring(); }});
}

TEST_F(FilePanelNames, AreNotCompletedWithWhatTheListDoesNotShow)
{
    mListener->hidden = @"gears";
    use({[this] { [mPanel makeFirstResponder:nameField(mPanel)]; }, [this] { type(@"ge"); },
         [this] { return name() == L"gel.omp"; }});
}

TEST_F(FilePanelNames, BeginInTheListWithASlash)
{
    use({[this] { pressKey(mPanel, @"/"); }, [this] { return name() == L"/"; },
         [this] { EXPECT_TRUE([nameField(mPanel) currentEditor] != nil); }});
}

TEST_F(FilePanelNames, FollowTheRowsThatAreSelected)
{
    use({[this]
         {
             typeNameInto(mPanel, @"nothing.omp");
             selectFilesIn(mPanel, {L"gel.omp"});
             EXPECT_EQ(L"gel.omp", name());
             EXPECT_THAT(chosen(), ElementsAre(file("gel.omp")));
             [table() deselectAll:nil];
             EXPECT_EQ(L"", name());
         }});
}
