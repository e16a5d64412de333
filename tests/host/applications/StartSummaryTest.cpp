#include "host/applications/StartSummary.h"

#include <gtest/gtest.h>
#include <tessel/tsmessagebox.h>

using tessel::Failure;
using tessel::LoadOutcome;
using tessel::LoadOutcomes;
using tessel::MessageBox;
using tessel::summarize;

namespace
{
LoadOutcome failed(const std::wstring& path, const std::wstring& why)
{
    return {path, Failure{why}, {}};
}

MessageBox::Box box(const std::wstring& text)
{
    return {.text = text, .detail = {}, .style = MB_ICONEXCLAMATION};
}
} // namespace

TEST(StartSummary, SaysNothingOfAStartWithoutFailures)
{
    EXPECT_FALSE(summarize({}, {}));
}

TEST(StartSummary, CountsWhatWasNotLoadedAndNamesEachFileWithItsReason)
{
    const auto summary =
        summarize({failed(L"/a/tool.zmb", L"it has no entry point"),
                   failed(L"/b/good.lsp", L"line 3: The form that begins here is never closed.")},
                  {});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.text, L"2 applications could not be loaded.");
    EXPECT_EQ(summary->box.detail, L"/a/tool.zmb: it has no entry point.\n\n"
                                   L"/b/good.lsp: line 3: The form that begins here is never closed.");
    EXPECT_EQ(summary->box.style, MB_ICONEXCLAMATION);
    EXPECT_EQ(summary->lines, L"2 applications could not be loaded:\n"
                              L"  /a/tool.zmb: it has no entry point.\n"
                              L"  /b/good.lsp: line 3: The form that begins here is never closed.");
}

TEST(StartSummary, SpeaksOfOneApplicationInTheSingular)
{
    const auto summary = summarize({failed(L"/a/tool.zmb", L"it is locked")}, {});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.text, L"1 application could not be loaded.");
    EXPECT_EQ(summary->lines, L"1 application could not be loaded:\n  /a/tool.zmb: it is locked.");
}

TEST(StartSummary, NamesAFileOnceThatItsReasonNames)
{
    const auto summary = summarize({failed(L"/a/x.rpk", L"“/a/x.rpk” is not of a type that can be loaded."),
                                    failed(L"/a/y.zmb", L"“/a/x.rpk” is in its way")},
                                   {});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->lines, L"2 applications could not be loaded:\n"
                              L"  “/a/x.rpk” is not of a type that can be loaded.\n"
                              L"  /a/y.zmb: “/a/x.rpk” is in its way.");
}

TEST(StartSummary, LeavesOutBoxesAboutFilesThatItNamesAndKeepsTheOthers)
{
    const auto summary = summarize({failed(L"/a/tool.zmb", L"it is gone")},
                                   {box(L"“/a/tool.zmb” could not be loaded."), box(L"The list is full.")});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.detail, L"/a/tool.zmb: it is gone.\n\nThe list is full.");
    EXPECT_EQ(summary->lines,
              L"1 application could not be loaded:\n  /a/tool.zmb: it is gone.\nThe list is full.");
}

TEST(StartSummary, ShowsAnOnlyBoxAboutSomethingElseAsItIs)
{
    const MessageBox::Box only{.text = L"The list is full.", .detail = L"Really.", .style = MB_OK};
    const auto summary = summarize({}, {only});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.text, L"The list is full.");
    EXPECT_EQ(summary->box.detail, L"Really.");
    EXPECT_EQ(summary->box.style, MB_OK);
    EXPECT_EQ(summary->lines, L"The list is full.");
    EXPECT_TRUE(summary->fits);
}

TEST(StartSummary, PutsSeveralBoxesAboutOtherThingsIntoOne)
{
    const auto summary = summarize({}, {box(L"One."), box(L"Two.")});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.text, L"One.\n\nTwo.");
    EXPECT_EQ(summary->lines, L"One.\nTwo.");
}

TEST(StartSummary, ShowsFiveFilesInTheBoxAndAllOnTheCommandLine)
{
    std::vector<LoadOutcome> many;
    for (int number = 1; number <= 11; ++number)
        many.push_back(failed(L"/a/" + std::to_wstring(number) + L".zmb", L"it is gone"));
    const auto summary = summarize(many, {});
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->box.text, L"11 applications could not be loaded.");
    EXPECT_NE(
        summary->box.detail.find(L"/a/5.zmb: it is gone.\n\nAnd 6 more: the command line lists them all."),
        std::wstring::npos);
    EXPECT_EQ(summary->box.detail.find(L"/a/6.zmb"), std::wstring::npos);
    EXPECT_NE(summary->lines.find(L"/a/11.zmb: it is gone."), std::wstring::npos);
    EXPECT_FALSE(summary->fits);
    many.resize(5);
    EXPECT_EQ(summarize(many, {})->box.detail.find(L"more"), std::wstring::npos);
    EXPECT_TRUE(summarize(many, {})->fits);
    EXPECT_FALSE(summarize(many, {box(L"One more.")})->fits);
}

TEST(StartSummary, CutsALongReasonInTheBoxAndNotOnTheCommandLine)
{
    const std::wstring fits(240 - 4, L'y'); // with "/a: "
    EXPECT_EQ(summarize({failed(L"/a", fits.substr(1))}, {})->box.detail, L"/a: " + fits.substr(1) + L".");
    const auto summary = summarize({failed(L"/a", fits)}, {});
    EXPECT_EQ(summary->box.detail, L"/a: " + fits.substr(1) + L"…");
    EXPECT_EQ(summary->lines, L"1 application could not be loaded:\n  /a: " + fits + L".");
    EXPECT_FALSE(summary->fits);
}

TEST(StartSummary, ShowsFiveOfManyBoxesAboutOtherThings)
{
    const std::vector<MessageBox::Box> boxes(7, box(L"One."));
    const auto summary = summarize({}, boxes);
    EXPECT_EQ(summary->box.text,
              L"One.\n\nOne.\n\nOne.\n\nOne.\n\nOne.\n\nAnd 2 more: the command line lists them all.");
    EXPECT_EQ(summary->lines, L"One.\nOne.\nOne.\nOne.\nOne.\nOne.\nOne.");
    EXPECT_FALSE(summary->fits);
}

TEST(RefusedFiles, AreThoseThatTwoBoxesQuoteAndOfWhichNothingElseIsKnown)
{
    LoadOutcomes outcomes;
    outcomes.note(L"/a/tool.zmb", Failure{L"it is gone"}, LoadOutcomes::Clock::now());
    tessel::noteRefusedFiles({box(L"“/a/letter.txt” is of no known type."), box(L"“/a/once.txt” is odd."),
                              box(L"“/a/letter.txt” could not be loaded."), box(L"The list is full."),
                              box(L"The list is full."), box(L"“/a/tool.zmb” is odd."),
                              box(L"“/a/tool.zmb” could not be loaded."), box(L"“never closed"),
                              box(L"“never closed")},
                             outcomes);
    ASSERT_EQ(outcomes.failed().size(), 2U);
    EXPECT_EQ(outcomes.failed()[0].loaded.sentence(), L"it is gone");
    EXPECT_EQ(outcomes.failed()[1].path, L"/a/letter.txt");
    EXPECT_EQ(outcomes.failed()[1].loaded.sentence(), L"“/a/letter.txt” is of no known type.");
}

TEST(LoadOutcomes, KnowTheLastOfEachPathInTheOrderOfTheFirst)
{
    LoadOutcomes outcomes;
    const auto now = LoadOutcomes::Clock::now();
    for (const wchar_t* path : {L"/a", L"/b", L"/c"})
        outcomes.note(path, Failure{L"gone"}, now - std::chrono::milliseconds(7));
    outcomes.note(L"/b", {}, now);
    outcomes.note(L"/a", Failure{L"still gone"}, now);
    ASSERT_EQ(outcomes.failed().size(), 2U);
    EXPECT_EQ(outcomes.failed()[0].loaded.sentence(), L"still gone");
    EXPECT_EQ(outcomes.failed()[1].path, L"/c");
    EXPECT_GE(outcomes.failed()[1].took, std::chrono::milliseconds(7));
    ASSERT_TRUE(outcomes.of(L"/b"));
    EXPECT_TRUE(outcomes.of(L"/b")->loaded);
    EXPECT_FALSE(outcomes.of(L"/d"));
}
