#include "modrig/dialogs/model/RowLook.h"

#include <gtest/gtest.h>

#include <string>

using namespace ModrigUtils;

namespace
{
CStdStr TextOf(const char* key)
{
    const std::string name = key;
    return CStdStr(L"text of " + std::wstring(name.begin(), name.end()));
}

CStdStr TipOf(const CStdStr& whyKeptOut, RowState state)
{
    return TipOfRow(CStdStr(L"/a/tool.lsp"), whyKeptOut, state, TextOf);
}
} // namespace

TEST(RowLook, IsGreyForAMissingFileInTheLists)
{
    for (const TableKind kind : {TableKind::kHistory, TableKind::kStartupSuite})
    {
        EXPECT_EQ(RowState::kMissing, StateOf(kind, {.exists = false, .unloadable = true}));
        EXPECT_EQ(RowState::kUsable, StateOf(kind, {.exists = true, .unloadable = false}));
    }
}

TEST(RowLook, IsGreyForAnApplicationThatFailedToLoad)
{
    for (const TableKind kind : {TableKind::kHistory, TableKind::kStartupSuite})
    {
        EXPECT_EQ(RowState::kFailed, StateOf(kind, {.exists = true, .hasFailed = true}));
        EXPECT_EQ(RowState::kMissing, StateOf(kind, {.exists = false, .hasFailed = true}));
    }
    EXPECT_EQ(RowState::kUsable,
              StateOf(TableKind::kLoadedApplications, {.unloadable = true, .hasFailed = true}));
}

TEST(RowLook, IsGreyForAnApplicationThatTheHostKeepsOut)
{
    for (const TableKind kind : {TableKind::kHistory, TableKind::kStartupSuite})
    {
        EXPECT_EQ(RowState::kKeptOut, StateOf(kind, {.exists = true, .hasFailed = true, .isKeptOut = true}));
        EXPECT_EQ(RowState::kMissing, StateOf(kind, {.exists = false, .isKeptOut = true}));
    }
    EXPECT_EQ(RowState::kUsable,
              StateOf(TableKind::kLoadedApplications, {.unloadable = true, .isKeptOut = true}));
    EXPECT_EQ(nullptr, ReasonKey(RowState::kKeptOut)) << "the host's own words";
}

TEST(RowLook, IsGreyForALoadedApplicationThatCannotBeUnloaded)
{
    constexpr TableKind kLoaded = TableKind::kLoadedApplications;
    EXPECT_EQ(RowState::kUsable, StateOf(kLoaded, {.exists = false, .unloadable = true}));
    EXPECT_EQ(RowState::kLocked, StateOf(kLoaded, {.exists = true, .isCompiledModule = true}));
    EXPECT_EQ(RowState::kNeverUnloaded, StateOf(kLoaded, {.exists = true, .isCompiledModule = false}));
}

TEST(RowLook, HasAReasonOfItsOwnForEveryGreyRow)
{
    EXPECT_EQ(nullptr, ReasonKey(RowState::kUsable));
    EXPECT_STREQ("IDS_MODRIG_ROW_MISSING", ReasonKey(RowState::kMissing));
    EXPECT_STREQ("IDS_MODRIG_ROW_FAILED", ReasonKey(RowState::kFailed));
    EXPECT_STREQ("IDS_MODRIG_ROW_LOCKED", ReasonKey(RowState::kLocked));
    EXPECT_STREQ("IDS_MODRIG_ROW_NEVER_UNLOADED", ReasonKey(RowState::kNeverUnloaded));
}

TEST(RowTip, IsThePathOfAUsableFile)
{
    EXPECT_EQ(CStdStr(L"/a/tool.lsp"), TipOf(CStdStr(), RowState::kUsable));
}

TEST(RowTip, SaysUnderThePathWhyTheRowIsGrey)
{
    EXPECT_EQ(CStdStr(L"/a/tool.lsp\ntext of IDS_MODRIG_ROW_MISSING"), TipOf(CStdStr(), RowState::kMissing));
    EXPECT_EQ(CStdStr(L"/a/tool.lsp\ntext of IDS_MODRIG_ROW_LOCKED"), TipOf(CStdStr(), RowState::kLocked));
}

// As it is in the table of loaded applications, where such a file is not grey for that.
TEST(RowTip, SaysFirstOfAllThatTheHostKeepsTheFileOut)
{
    for (const RowState state : {RowState::kKeptOut, RowState::kUsable, RowState::kLocked})
        EXPECT_EQ(CStdStr(L"/a/tool.lsp\nkept out by you"), TipOf(CStdStr(L"kept out by you"), state));
}

TEST(RowTip, ShowsThePathInOneLine)
{
    EXPECT_EQ(CStdStr(L"/a/two\\nlines.lsp"),
              TipOfRow(CStdStr(L"/a/two\nlines.lsp"), CStdStr(), RowState::kUsable, TextOf));
}

TEST(ShortenedText, IsTheWholeOneWhenItFits)
{
    EXPECT_EQ(CStdStr(L"tool.lsp"), Shortened(CStdStr(L"tool.lsp"), [](const CStdStr&) { return true; }));
}

TEST(ShortenedText, IsAsMuchAsFitsWithAnEllipsis)
{
    for (std::size_t room = 1; room < 10; ++room)
    {
        const auto fits = [room](const CStdStr& text)
        {
            return text.Text().size() <= room;
        };
        EXPECT_EQ(CStdStr(std::wstring(L"abcdefghij").substr(0, room - 1) + L"…"),
                  Shortened(CStdStr(L"abcdefghij"), fits));
    }
}

TEST(ShortenedText, IsAnEllipsisWhenNothingFits)
{
    EXPECT_EQ(CStdStr(L"…"), Shortened(CStdStr(L"tool"), [](const CStdStr&) { return false; }));
    EXPECT_EQ(CStdStr(L"…"), Shortened(CStdStr(L""), [](const CStdStr&) { return false; }));
}
