// What can be done with the rows of the dialogs' tables: by keys, and in the menus of the rows.
#pragma once

#include <cstddef>
#include <vector>

namespace ModrigUtils
{
enum class TableAction
{
    kNone, // in a menu: the line between two groups
    kLoad,
    kUnload,
    kAdd,
    kAddToStartupSuite,
    kRemove,
    kMoveUp,
    kMoveDown,
    kKeepOut, // at starts
    kLetIn,
    kCopyPath,
    kShowInFolder,
    kSelectAll
};

enum class TableKind
{
    kLoadedApplications,
    kHistory,
    kStartupSuite
};

// A key that goes to a table. `command`: with the platform's key for commands; `alternate`: with Alt.
struct TableKey
{
    wchar_t character;
    bool command = false;
    bool alternate = false;
};

// The key as the tables know it: some displays send Control-A as the first of the control characters.
[[nodiscard]] TableKey KnownKey(TableKey key);

// Keys that are no characters, as the tables are told of them.
inline constexpr wchar_t kInsertKey = 0xF727;
inline constexpr wchar_t kForwardDeleteKey = 0xF728;
inline constexpr wchar_t kDeleteKey = 0x7F;
inline constexpr wchar_t kBackspaceKey = 0x08;
inline constexpr wchar_t kUpKey = 0xF700;
inline constexpr wchar_t kDownKey = 0xF701;
inline constexpr wchar_t kHomeKey = 0xF729;
inline constexpr wchar_t kEndKey = 0xF72B;
inline constexpr wchar_t kPageUpKey = 0xF72C;
inline constexpr wchar_t kPageDownKey = 0xF72D;

// The key of the text of its menu item.
[[nodiscard]] const char* TitleKey(TableAction action);

// The menu of the table's rows, from top to bottom. `keepingOut`: the one of the two actions about that which
// the rows want, or `kNone` in a host that knows neither.
[[nodiscard]] std::vector<TableAction> MenuOf(TableKind kind, TableAction keepingOut = TableAction::kNone);

// What the key does in the table; `kNone` for one that the table has no action for.
[[nodiscard]] TableAction ActionForKey(TableKind kind, TableKey key);

// The rows of a table as far as they decide what can be done.
struct TableState
{
    std::size_t rows = 0;
    std::size_t selected = 0;
    std::size_t pointedAt = 0; // by the menu: the selected rows, or one that cannot be selected
    bool firstIsSelected = false;
    bool lastIsSelected = false;
};

[[nodiscard]] bool IsPossible(TableAction action, const TableState& state);

// The places that rows move to: one after the other, from `from` to `to`, each a step.
struct RowMove
{
    std::size_t from;
    std::size_t to;
};

// How the selected rows (ascending) move up or down by one, all together. None when there is no room.
[[nodiscard]] std::vector<RowMove> MovesOf(const std::vector<std::size_t>& selected, std::size_t rows,
                                           bool up);
} // namespace ModrigUtils
