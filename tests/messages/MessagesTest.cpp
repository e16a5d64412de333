#include "modrig/messages/Messages.h"

#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using namespace std::string_literals;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Messages : public ModuleTest
{
protected:
    static const std::wstring& printed() { return host().output.printed; }
};

class HelpTopics : public ModuleTest, public testing::WithParamInterface<std::pair<int, std::wstring>>
{
};
} // namespace

TEST_F(Messages, NameAFileWithoutItsFolderOnTheCommandLine)
{
    ModrigCmdlineMessage(12, CStdStr(L"/a/b/tool.lsp"));
    EXPECT_EQ(Message(12, L"tool.lsp") + L"\n", printed());
}

TEST_F(Messages, NameAFileOfAWindowsPathWithoutItsFolder)
{
    ModrigCmdlineMessage(12, CStdStr(L"C:\\a b\\tööl 1.lsp"));
    EXPECT_EQ(Message(12, L"tööl 1.lsp") + L"\n", printed());
}

TEST_F(Messages, NameAFileWithItsWholePathInABox)
{
    ModrigAfxMessageBox(2, CStdStr(L"/a/b/tool.lsp"));
    EXPECT_THAT(boxes(), ElementsAre(Message(2, L"/a/b/tool.lsp")));
}

TEST_F(Messages, ShowTheLineInTheDialogWithoutItsLineFeed)
{
    ModrigCmdlineMessage(12, CStdStr(L"/a/tool.lsp"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(Message(12, L"tool.lsp")));
}

TEST_F(Messages, AreInTheDialogBeforeTheyAreOnTheCommandLine)
{
    std::vector<std::wstring> printedMeanwhile;
    recordingDialog().duringMessage = [&printedMeanwhile]
    {
        printedMeanwhile.push_back(printed());
    };
    ModrigCmdlineMessage(12, CStdStr(L"/a/tool.lsp"));
    host().output.printed.clear();
    ModrigCmdlineMessage(13, 2u);
    EXPECT_THAT(printedMeanwhile, ElementsAre(L"", L""));
    EXPECT_THAT(lines(), ElementsAre(Message(13, L"2")));
}

TEST_F(Messages, PrintNothingWhenATextIsOnlyForTheDialog)
{
    ModrigCmdlineMessage(CStdStr(L"a hint"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"a hint"));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(Messages, StandAsTheyAreForAnEmptyPath)
{
    ModrigCmdlineMessage(3, CStdStr());
    EXPECT_EQ(L"[3] %s\n", printed());
    ModrigAfxMessageBox(19, CStdStr());
    EXPECT_THAT(boxes(), ElementsAre(L"[19] %s"));
}

TEST_F(Messages, NameNothingForAPathThatIsTooLongToBeTakenApart)
{
    ModrigCmdlineMessage(3, CStdStr(L"/a/" + std::wstring(300, L'n') + L".lsp"));
    EXPECT_EQ(L"[3] \n", printed());
}

TEST_F(Messages, AreAnEmptyLineAndAnEmptyBoxWhenTheirTextIsMissing)
{
    host().resources.removeText(kResourceModuleName, 12);
    ModrigCmdlineMessage(12, CStdStr(L"/a/tool.lsp"));
    ModrigCmdlineMessage(12, CStdStr());
    ModrigCmdlineMessage(12, 5u);
    EXPECT_EQ(L"\n\n\n", printed());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"", L"", L""));
    ModrigAfxMessageBox(12, CStdStr(L"/a/tool.lsp"));
    ModrigAfxMessageBox(12, CStdStr());
    EXPECT_THAT(boxes(), ElementsAre(L"", L""));
}

TEST_F(Messages, PrintACountInDecimal)
{
    ModrigCmdlineMessage(13, 1u);
    ModrigCmdlineMessage(13, 20u);
    ModrigCmdlineMessage(13, 2147483647u);
    EXPECT_THAT(lines(), ElementsAre(Message(13, L"1"), Message(13, L"20"), Message(13, L"2147483647")));
}

TEST_F(Messages, DoNothingAtAllForACountOfZero)
{
    recordingDialog().messages = {L"what stood there"};
    ModrigCmdlineMessage(13, 0u);
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"what stood there"));
}

TEST_F(Messages, PrintTheTextItselfAsTheFormatSoThatNamesWithPerCentSignsStandAsTheyAre)
{
    ModrigCmdlineMessage(8, CStdStr(L"/a/100%.lsp"));
    ModrigCmdlineMessage(8, CStdStr(L"/a/%s%n.lsp"));
    ModrigCmdlineMessage(8, CStdStr(L"/a/%1000000000d%.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(8, L"100%.lsp"), Message(8, L"%s%n.lsp"),
                                     Message(8, L"%1000000000d%.lsp")));
}

TEST_F(Messages, PrintADoubledPerCentSignOnceBecauseTheTextIsTheFormat)
{
    ModrigCmdlineMessage(8, CStdStr(L"/a/50%%.lsp"));
    EXPECT_EQ(Message(8, L"50%.lsp") + L"\n", printed());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(Message(8, L"50%%.lsp")));
}

TEST_F(Messages, KeepPerCentSignsInABox)
{
    ModrigAfxMessageBox(38, CStdStr(L"/50%%/%s%n.lsp"));
    ModrigAfxMessageBox(CStdStr(L"%d %%"));
    EXPECT_THAT(boxes(), ElementsAre(Message(38, L"/50%%/%s%n.lsp"), L"%d %%"));
}

TEST_F(Messages, ShowABoxWithAnExclamationIconOverTheActiveWindow)
{
    host().output.boxAnswer = 7;
    ModrigAfxMessageBox(CStdStr(L"text"));
    EXPECT_THAT(host().output.boxes, ElementsAre(RecordingOutput::Box{L"text", 48, nullptr}));
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(recordingDialog().messages, IsEmpty());
}

TEST_F(Messages, CutAPathInABoxAtTheRoomOfFormatting)
{
    const std::wstring path = LongPath(4000, L"tool.lsp");
    ModrigAfxMessageBox(38, CStdStr(path));
    const std::wstring expected = Message(38, path).substr(0, std::wstring(L"[38] %s").size() + 1023);
    EXPECT_THAT(boxes(), ElementsAre(expected));
}

TEST_F(Messages, AreShownWholeHoweverLongTheyAre)
{
    const std::wstring words(10000, L'w');
    host().resources.setText(kResourceModuleName, 12, words + L"%s");
    ModrigCmdlineMessage(12, CStdStr(L"/a/tool.lsp"));
    ModrigAfxMessageBox(12, CStdStr(L"/a/tool.lsp"));
    EXPECT_THAT(lines(), ElementsAre(words + L"tool.lsp"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(words + L"tool.lsp"));
    EXPECT_THAT(boxes(), ElementsAre(words + L"/a/tool.lsp"));
}

TEST_F(Messages, NameTheFileWhenTheCountIsExactlyOneAndCountOtherwise)
{
    ModrigCmdlineSummary(12, 13, 1, L"/a/tool.zmb");
    ModrigCmdlineSummary(12, 13, 2, L"/a/tool.zmb");
    ModrigCmdlineSummary(12, 13, 0, L"/a/tool.zmb");
    EXPECT_THAT(lines(), ElementsAre(Message(12, L"tool.zmb"), Message(13, L"2")));
}

TEST_P(HelpTopics, OpenThePageOfTheDialogInTheHostsOwnBook)
{
    const auto& [topic, page] = GetParam();
    OnCommandHelp(topic);
    EXPECT_THAT(host().output.helpCalls, ElementsAre(RecordingOutput::HelpCall{std::nullopt, page, 0}));
}

INSTANTIATE_TEST_SUITE_P(EveryTopic, HelpTopics,
                         testing::Values(std::pair{0, L"load_unload_applications_dialog"s},
                                         std::pair{1, L"startup_suite_dialog"s},
                                         std::pair{2, L"StandardFileSelectionDialogs"s},
                                         std::pair{3, L"load_unload_applications_dialog"s},
                                         std::pair{-1, L"load_unload_applications_dialog"s}));
