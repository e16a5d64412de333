#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
namespace
{
bool IsDelete(wchar_t character)
{
    return character == kForwardDeleteKey || character == kDeleteKey || character == kBackspaceKey;
}

TableAction CommandFor(wchar_t character)
{
    switch (character)
    {
    case L'a':
        return TableAction::kSelectAll;
    case L'c':
        return TableAction::kCopyPath;
    default:
        return TableAction::kNone;
    }
}

TableAction MoveFor(wchar_t character)
{
    if (character == kUpKey)
        return TableAction::kMoveUp;
    return character == kDownKey ? TableAction::kMoveDown : TableAction::kNone;
}
} // namespace

TableKey KnownKey(TableKey key)
{
    constexpr wchar_t kLastControlCharacter = 0x1A;
    if (key.command && key.character > 0 && key.character <= kLastControlCharacter)
        key.character = static_cast<wchar_t>(key.character + L'a' - 1);
    return key;
}

const char* TitleKey(TableAction action)
{
    switch (action)
    {
    case TableAction::kLoad:
        return "IDS_MODRIG_MENU_LOAD";
    case TableAction::kUnload:
        return "IDS_MODRIG_MENU_UNLOAD";
    case TableAction::kAdd:
        return "IDS_MODRIG_MENU_ADD";
    case TableAction::kAddToStartupSuite:
        return "IDS_MODRIG_MENU_ADD_TO_STARTUP_SUITE";
    case TableAction::kRemove:
        return "IDS_MODRIG_MENU_REMOVE";
    case TableAction::kMoveUp:
        return "IDS_MODRIG_MENU_MOVE_UP";
    case TableAction::kMoveDown:
        return "IDS_MODRIG_MENU_MOVE_DOWN";
    case TableAction::kKeepOut:
        return "IDS_MODRIG_MENU_KEEP_OUT";
    case TableAction::kLetIn:
        return "IDS_MODRIG_MENU_LET_IN";
    case TableAction::kShowInFolder:
        return "IDS_MODRIG_MENU_SHOW_IN_FOLDER";
    default:
        return "IDS_MODRIG_MENU_COPY_PATH";
    }
}

std::vector<TableAction> MenuOf(TableKind kind, TableAction keepingOut)
{
    std::vector<TableAction> menu;
    switch (kind)
    {
    case TableKind::kLoadedApplications:
        menu = {TableAction::kUnload};
        break;
    case TableKind::kHistory:
        menu = {TableAction::kLoad, TableAction::kAddToStartupSuite, TableAction::kRemove};
        break;
    case TableKind::kStartupSuite:
        menu = {TableAction::kMoveUp, TableAction::kMoveDown, TableAction::kNone, TableAction::kAdd,
                TableAction::kRemove};
        break;
    }
    if (keepingOut != TableAction::kNone)
        menu.insert(menu.end(), {TableAction::kNone, keepingOut});
    menu.insert(menu.end(), {TableAction::kNone, TableAction::kCopyPath, TableAction::kShowInFolder});
    return menu;
}

TableAction ActionForKey(TableKind kind, TableKey key)
{
    const bool isSuite = kind == TableKind::kStartupSuite;
    if (key.command)
        return CommandFor(key.character);
    if (key.alternate)
        return isSuite ? MoveFor(key.character) : TableAction::kNone;
    if (IsDelete(key.character) && kind != TableKind::kLoadedApplications)
        return TableAction::kRemove;
    return key.character == kInsertKey && isSuite ? TableAction::kAdd : TableAction::kNone;
}

bool IsPossible(TableAction action, const TableState& state)
{
    switch (action)
    {
    case TableAction::kNone:
        return false;
    case TableAction::kAdd:
        return true;
    case TableAction::kSelectAll:
        return state.rows > 0;
    case TableAction::kKeepOut:
    case TableAction::kLetIn:
    case TableAction::kCopyPath:
    case TableAction::kShowInFolder:
        return state.pointedAt > 0;
    case TableAction::kMoveUp:
        return state.selected > 0 && !state.firstIsSelected;
    case TableAction::kMoveDown:
        return state.selected > 0 && !state.lastIsSelected;
    default:
        return state.selected > 0;
    }
}

std::vector<RowMove> MovesOf(const std::vector<std::size_t>& selected, std::size_t rows, bool up)
{
    std::vector<RowMove> moves;
    if (selected.empty() || (up ? selected.front() == 0 : selected.back() + 1 == rows))
        return moves;
    for (const std::size_t row : selected)
        moves.insert(up ? moves.end() : moves.begin(), {row, up ? row - 1 : row + 1});
    return moves;
}
} // namespace ModrigUtils
