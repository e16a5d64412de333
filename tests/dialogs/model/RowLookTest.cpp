#include "modrig/dialogs/model/RowLook.h"

#include <gtest/gtest.h>

using namespace ModrigUtils;

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
