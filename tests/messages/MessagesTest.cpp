#include "modrig/messages/Messages.h"

#include "modrig/messages/MessageIds.h"
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
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"/a/b/tool.lsp"));
    EXPECT_EQ(Message(ModrigMessages::kOneUnloaded, L"tool.lsp") + L"\n", printed());
}

TEST_F(Messages, NameAFileOfAWindowsPathWithoutItsFolder)
{
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"C:\\a b\\tööl 1.lsp"));
    EXPECT_EQ(Message(ModrigMessages::kOneUnloaded, L"tööl 1.lsp") + L"\n", printed());
}

TEST_F(Messages, NameAFileWithItsWholePathInABox)
{
    ModrigAfxMessageBox(ModrigMessages::kCannotLoadFile, CStdStr(L"/a/b/tool.lsp"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/b/tool.lsp")));
}

TEST_F(Messages, ShowTheLineInTheDialogWithoutItsLineFeed)
{
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(Message(ModrigMessages::kOneUnloaded, L"tool.lsp")));
}

TEST_F(Messages, AreInTheDialogBeforeTheyAreOnTheCommandLine)
{
    std::vector<std::wstring> printedMeanwhile;
    recordingDialog().duringMessage = [&printedMeanwhile]
    {
        printedMeanwhile.push_back(printed());
    };
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    host().output.printed.clear();
    ModrigCmdlineMessage(ModrigMessages::kManyUnloaded, 2u);
    EXPECT_THAT(printedMeanwhile, ElementsAre(L"", L""));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyUnloaded, L"2")));
}

TEST_F(Messages, PrintNothingWhenATextIsOnlyForTheDialog)
{
    ModrigCmdlineMessage(CStdStr(L"a hint"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"a hint"));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(Messages, StandAsTheyAreForAnEmptyPath)
{
    ModrigCmdlineMessage(ModrigMessages::kModuleLocked, CStdStr());
    EXPECT_EQ(Message(ModrigMessages::kModuleLocked, L"%s") + L"\n", printed());
    ModrigAfxMessageBox(ModrigMessages::kListNotStored, CStdStr());
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kListNotStored, L"%s")));
}

TEST_F(Messages, NameNothingForAPathThatIsTooLongToBeTakenApart)
{
    ModrigCmdlineMessage(ModrigMessages::kModuleLocked, CStdStr(L"/a/" + std::wstring(300, L'n') + L".lsp"));
    EXPECT_EQ(Message(ModrigMessages::kModuleLocked, L"") + L"\n", printed());
}

TEST_F(Messages, AreAnEmptyLineAndAnEmptyBoxWhenTheirTextIsMissing)
{
    host().resources.removeText(kResourceModuleName, ModrigMessages::kOneUnloaded);
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr());
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, 5u);
    EXPECT_EQ(L"\n\n\n", printed());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"", L"", L""));
    ModrigAfxMessageBox(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    ModrigAfxMessageBox(ModrigMessages::kOneUnloaded, CStdStr());
    EXPECT_THAT(boxes(), ElementsAre(L"", L""));
}

TEST_F(Messages, PrintACountInDecimal)
{
    ModrigCmdlineMessage(ModrigMessages::kManyUnloaded, 1u);
    ModrigCmdlineMessage(ModrigMessages::kManyUnloaded, 20u);
    ModrigCmdlineMessage(ModrigMessages::kManyUnloaded, 2147483647u);
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyUnloaded, L"1"),
                                     Message(ModrigMessages::kManyUnloaded, L"20"),
                                     Message(ModrigMessages::kManyUnloaded, L"2147483647")));
}

TEST_F(Messages, DoNothingAtAllForACountOfZero)
{
    recordingDialog().messages = {L"what stood there"};
    ModrigCmdlineMessage(ModrigMessages::kManyUnloaded, 0u);
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(L"what stood there"));
}

TEST_F(Messages, PrintTheTextItselfAsTheFormatSoThatNamesWithPerCentSignsStandAsTheyAre)
{
    ModrigCmdlineMessage(ModrigMessages::kOneLoaded, CStdStr(L"/a/100%.lsp"));
    ModrigCmdlineMessage(ModrigMessages::kOneLoaded, CStdStr(L"/a/%s%n.lsp"));
    ModrigCmdlineMessage(ModrigMessages::kOneLoaded, CStdStr(L"/a/%1000000000d%.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"100%.lsp"),
                                     Message(ModrigMessages::kOneLoaded, L"%s%n.lsp"),
                                     Message(ModrigMessages::kOneLoaded, L"%1000000000d%.lsp")));
}

TEST_F(Messages, PrintADoubledPerCentSignOnceBecauseTheTextIsTheFormat)
{
    ModrigCmdlineMessage(ModrigMessages::kOneLoaded, CStdStr(L"/a/50%%.lsp"));
    EXPECT_EQ(Message(ModrigMessages::kOneLoaded, L"50%.lsp") + L"\n", printed());
    EXPECT_THAT(recordingDialog().messages, ElementsAre(Message(ModrigMessages::kOneLoaded, L"50%%.lsp")));
}

TEST_F(Messages, KeepPerCentSignsInABox)
{
    ModrigAfxMessageBox(ModrigMessages::kLoadFailed, CStdStr(L"/50%%/%s%n.lsp"));
    ModrigAfxMessageBox(CStdStr(L"%d %%"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, L"/50%%/%s%n.lsp"), L"%d %%"));
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
    ModrigAfxMessageBox(ModrigMessages::kLoadFailed, CStdStr(path));
    const std::wstring expected = Message(ModrigMessages::kLoadFailed, path)
                                      .substr(0, Message(ModrigMessages::kLoadFailed, L"%s").size() + 1023);
    EXPECT_THAT(boxes(), ElementsAre(expected));
}

TEST_F(Messages, AreShownWholeHoweverLongTheyAre)
{
    const std::wstring words(10000, L'w');
    host().resources.setText(kResourceModuleName, ModrigMessages::kOneUnloaded, words + L"%s");
    ModrigCmdlineMessage(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    ModrigAfxMessageBox(ModrigMessages::kOneUnloaded, CStdStr(L"/a/tool.lsp"));
    EXPECT_THAT(lines(), ElementsAre(words + L"tool.lsp"));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(words + L"tool.lsp"));
    EXPECT_THAT(boxes(), ElementsAre(words + L"/a/tool.lsp"));
}

TEST_F(Messages, NameTheFileWhenTheCountIsExactlyOneAndCountOtherwise)
{
    ModrigCmdlineSummary(ModrigMessages::kOneUnloaded, ModrigMessages::kManyUnloaded, 1, L"/a/tool.zmb");
    ModrigCmdlineSummary(ModrigMessages::kOneUnloaded, ModrigMessages::kManyUnloaded, 2, L"/a/tool.zmb");
    ModrigCmdlineSummary(ModrigMessages::kOneUnloaded, ModrigMessages::kManyUnloaded, 0, L"/a/tool.zmb");
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"tool.zmb"),
                                     Message(ModrigMessages::kManyUnloaded, L"2")));
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

// The tests name messages; translations of the resource module know their numbers.
TEST_F(Messages, KeepTheirNumbers)
{
    using namespace ModrigMessages;
    const std::pair<unsigned, unsigned> numbers[] = {
        {1, kOpenPanelTitle},
        {2, kCannotLoadFile},
        {3, kModuleLocked},
        {8, kOneLoaded},
        {9, kManyLoaded},
        {10, kOneAddedToStartupSuite},
        {11, kManyAddedToStartupSuite},
        {12, kOneUnloaded},
        {13, kManyUnloaded},
        {14, kStartupSuitePanelTitle},
        {15, kLispPrompt},
        {16, kCommandGroup},
        {17, kCommandGlobalName},
        {18, kCommandLocalName},
        {19, kListNotStored},
        {24, kFilterNotStored},
        {25, kAllApplicationsFilter},
        {26, kBundleFilter},
        {27, kLispSourceFilter},
        {28, kObjectModuleFilter},
        {29, kCompiledLispFilter},
        {35, kOneRemovedFromHistory},
        {36, kManyRemovedFromHistory},
        {37, kTooManyFiles},
        {38, kLoadFailed},
        {39, kUrlNotFetched},
        {41, kTemporaryInternetFile},
        {46, kPackagedLispFilter},
        {47, kMacroProjectFilter},
        {48, ModrigMessages::kAlreadyLoaded},
        {51, kCoreModuleFilter},
        {60, kDialogFailed},
    };
    for (const auto& [number, message] : numbers)
        EXPECT_EQ(number, message);
}
