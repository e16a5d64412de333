#include "modrig/dialogs/model/TableActions.h"

#include <gmock/gmock.h>

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr TableKind kTableOfLoaded = TableKind::kLoadedApplications;
constexpr TableKind kHistory = TableKind::kHistory;
constexpr TableKind kSuite = TableKind::kStartupSuite;

std::vector<std::pair<std::size_t, std::size_t>> Moves(const std::vector<std::size_t>& selected,
                                                       std::size_t rows, bool up)
{
    std::vector<std::pair<std::size_t, std::size_t>> moves;
    for (const RowMove& move : MovesOf(selected, rows, up))
        moves.emplace_back(move.from, move.to);
    return moves;
}
} // namespace

TEST(TableKeys, RemoveFromTheListsButUnloadNothing)
{
    for (const wchar_t key : {kForwardDeleteKey, kDeleteKey, kBackspaceKey})
    {
        EXPECT_EQ(TableAction::kRemove, ActionForKey(kHistory, {key}));
        EXPECT_EQ(TableAction::kRemove, ActionForKey(kSuite, {key}));
        EXPECT_EQ(TableAction::kNone, ActionForKey(kTableOfLoaded, {key}));
    }
}

TEST(TableKeys, AddToTheStartupSuiteOnly)
{
    EXPECT_EQ(TableAction::kAdd, ActionForKey(kSuite, {kInsertKey}));
    EXPECT_EQ(TableAction::kNone, ActionForKey(kHistory, {kInsertKey}));
}

TEST(TableKeys, SelectAndCopyWithTheCommandKeyInEveryTable)
{
    for (const TableKind kind : {kTableOfLoaded, kHistory, kSuite})
    {
        EXPECT_EQ(TableAction::kSelectAll, ActionForKey(kind, {L'a', true}));
        EXPECT_EQ(TableAction::kCopyPath, ActionForKey(kind, {L'c', true}));
        EXPECT_EQ(TableAction::kNone, ActionForKey(kind, {L'a'}));
        EXPECT_EQ(TableAction::kNone, ActionForKey(kind, {L'x', true}));
    }
}

TEST(TableKeys, MoveRowsOfTheStartupSuiteWithAlt)
{
    EXPECT_EQ(TableAction::kMoveUp, ActionForKey(kSuite, {kUpKey, false, true}));
    EXPECT_EQ(TableAction::kMoveDown, ActionForKey(kSuite, {kDownKey, false, true}));
    EXPECT_EQ(TableAction::kNone, ActionForKey(kSuite, {kUpKey}));
    EXPECT_EQ(TableAction::kNone, ActionForKey(kHistory, {kUpKey, false, true}));
}

TEST(TableMenu, HasWhatTheButtonsDoAndThePathOfTheRow)
{
    EXPECT_THAT(MenuOf(kTableOfLoaded), ElementsAre(TableAction::kUnload, TableAction::kNone,
                                                    TableAction::kCopyPath, TableAction::kShowInFolder));
    EXPECT_THAT(MenuOf(kHistory),
                ElementsAre(TableAction::kLoad, TableAction::kAddToStartupSuite, TableAction::kRemove,
                            TableAction::kNone, TableAction::kCopyPath, TableAction::kShowInFolder));
    EXPECT_THAT(MenuOf(kSuite), ElementsAre(TableAction::kMoveUp, TableAction::kMoveDown, TableAction::kNone,
                                            TableAction::kAdd, TableAction::kRemove, TableAction::kNone,
                                            TableAction::kCopyPath, TableAction::kShowInFolder));
}

TEST(TableMenu, KeepsOutOrLetsInWhereTheHostDoes)
{
    for (const TableAction action : {TableAction::kKeepOut, TableAction::kLetIn})
    {
        EXPECT_THAT(MenuOf(kTableOfLoaded, action),
                    ElementsAre(TableAction::kUnload, TableAction::kNone, action, TableAction::kNone,
                                TableAction::kCopyPath, TableAction::kShowInFolder));
        EXPECT_TRUE(IsPossible(action, {.rows = 3, .pointedAt = 1}));
        EXPECT_FALSE(IsPossible(action, {.rows = 3, .selected = 1}));
    }
}

TEST(TableActions, NeedASelectionUnlessTheyMakeOne)
{
    const TableState empty;
    const TableState unselected = {.rows = 3};
    const TableState selected = {.rows = 3, .selected = 1};
    for (const TableAction action :
         {TableAction::kLoad, TableAction::kUnload, TableAction::kRemove, TableAction::kAddToStartupSuite})
    {
        EXPECT_FALSE(IsPossible(action, unselected));
        EXPECT_TRUE(IsPossible(action, selected));
    }
    EXPECT_TRUE(IsPossible(TableAction::kAdd, empty));
    EXPECT_FALSE(IsPossible(TableAction::kSelectAll, empty));
    EXPECT_TRUE(IsPossible(TableAction::kSelectAll, unselected));
    EXPECT_FALSE(IsPossible(TableAction::kNone, selected));
}

TEST(TableActions, CopyAndShowWhatThePointerIsAtAlsoWhenItCannotBeSelected)
{
    for (const TableAction action : {TableAction::kCopyPath, TableAction::kShowInFolder})
    {
        EXPECT_TRUE(IsPossible(action, {.rows = 3, .pointedAt = 1}));
        EXPECT_FALSE(IsPossible(action, {.rows = 3, .selected = 1}));
    }
}

TEST(TableActions, MoveRowsWhileThereIsRoom)
{
    EXPECT_FALSE(IsPossible(TableAction::kMoveUp, {.rows = 3, .selected = 1, .firstIsSelected = true}));
    EXPECT_TRUE(IsPossible(TableAction::kMoveDown, {.rows = 3, .selected = 1, .firstIsSelected = true}));
    EXPECT_FALSE(IsPossible(TableAction::kMoveDown, {.rows = 3, .selected = 1, .lastIsSelected = true}));
    EXPECT_TRUE(IsPossible(TableAction::kMoveUp, {.rows = 3, .selected = 1, .lastIsSelected = true}));
    EXPECT_FALSE(IsPossible(TableAction::kMoveUp, {.rows = 3}));
    EXPECT_FALSE(IsPossible(TableAction::kMoveDown, {.rows = 3}));
}

TEST(Moves, OfSeveralRowsKeepTheirOrder)
{
    EXPECT_THAT(Moves({1, 2}, 4, true), ElementsAre(std::pair(1, 0), std::pair(2, 1)));
    EXPECT_THAT(Moves({1, 2}, 4, false), ElementsAre(std::pair(2, 3), std::pair(1, 2)));
    EXPECT_THAT(Moves({0, 3}, 5, false), ElementsAre(std::pair(3, 4), std::pair(0, 1)));
}

TEST(Moves, AreNoneAtTheEnds)
{
    EXPECT_THAT(Moves({0, 2}, 4, true), IsEmpty());
    EXPECT_THAT(Moves({1, 3}, 4, false), IsEmpty());
    EXPECT_THAT(Moves({}, 4, true), IsEmpty());
}

TEST(TableKeys, AreLettersWhereADisplaySendsControlCharacters)
{
    EXPECT_EQ(L'a', KnownKey({0x01, true}).character);
    EXPECT_EQ(L'z', KnownKey({0x1A, true}).character);
    EXPECT_EQ(0x1B, KnownKey({0x1B, true}).character);
    EXPECT_EQ(0x01, KnownKey({0x01}).character);
    EXPECT_EQ(L'\0', KnownKey({L'\0', true}).character);
    EXPECT_TRUE(KnownKey({0x01, true, true}).alternate);
}

TEST(TableMenus, NameEachActionByATextOfItsOwn)
{
    EXPECT_STREQ("IDS_MODRIG_MENU_LOAD", TitleKey(TableAction::kLoad));
    EXPECT_STREQ("IDS_MODRIG_MENU_UNLOAD", TitleKey(TableAction::kUnload));
    EXPECT_STREQ("IDS_MODRIG_MENU_ADD", TitleKey(TableAction::kAdd));
    EXPECT_STREQ("IDS_MODRIG_MENU_ADD_TO_STARTUP_SUITE", TitleKey(TableAction::kAddToStartupSuite));
    EXPECT_STREQ("IDS_MODRIG_MENU_REMOVE", TitleKey(TableAction::kRemove));
    EXPECT_STREQ("IDS_MODRIG_MENU_MOVE_UP", TitleKey(TableAction::kMoveUp));
    EXPECT_STREQ("IDS_MODRIG_MENU_MOVE_DOWN", TitleKey(TableAction::kMoveDown));
    EXPECT_STREQ("IDS_MODRIG_MENU_KEEP_OUT", TitleKey(TableAction::kKeepOut));
    EXPECT_STREQ("IDS_MODRIG_MENU_LET_IN", TitleKey(TableAction::kLetIn));
    EXPECT_STREQ("IDS_MODRIG_MENU_COPY_PATH", TitleKey(TableAction::kCopyPath));
    EXPECT_STREQ("IDS_MODRIG_MENU_SHOW_IN_FOLDER", TitleKey(TableAction::kShowInFolder));
}
