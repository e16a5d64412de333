// The files of a folder as rows of the file panel's table. Names are the file system's bytes.
#pragma once

#include <ctime>
#include <optional>
#include <string>
#include <vector>

namespace tessel::filepanel
{
struct Entry
{
    std::string name;
    std::wstring key; // what it is sorted by: see `sortKey`
    std::string kind; // as it is shown: see `kindOf`
    bool isFolder = false;
    bool isPackage = false; // a folder that is shown as one file
    std::optional<std::time_t> changed;

    bool isWalkedThrough() const { return isFolder && !isPackage; }
};

enum class Column
{
    kName,
    kKind,
    kDate
};

struct Order
{
    Column column = Column::kName;
    bool descending = false;
};

// What a click on a column's header makes of the order: the column, or the other way round.
Order afterClickOn(Column column, Order order);

// The files of the folder, unsorted, without packages told from folders, without kinds and dates. Empty when
// it cannot be read. Names that begin with a dot are hidden files.
std::vector<Entry> readFolder(const std::string& folder, bool withHiddenFiles);

// Folders first; by name among equals.
void sortEntries(std::vector<Entry>& entries, Order order);

// Names in a person's order: whatever their case, "file9" before "file10".
std::wstring sortKey(const std::string& name);

// The name as text, also where it is none: its bytes are then written as escapes (\xFF).
std::string readableName(const std::string& name);

// The name in one line: what is no visible character is written as an escape (\n, \x1B).
std::string shownName(const std::string& name);

// What kinds are called. An extension takes the place of "%@" in the last.
struct KindWords
{
    std::string folder;
    std::string package;
    std::string file;
    std::string fileWithExtension;
};

// "Folder", "Package", "LSP file", "File".
std::string kindOf(const Entry& entry, const KindWords& words);

// When the file was last changed; nothing when it is gone.
std::optional<std::time_t> dateOf(const std::string& path);

// Whether the name begins with the text, whatever the case.
bool beginsLike(const std::string& name, const std::string& beginning);

// The row whose name begins with the text, the first at `from` or after it, then those before it.
std::optional<std::size_t> rowBeginningLike(const std::vector<Entry>& entries, const std::string& beginning,
                                            std::size_t from);

std::optional<std::size_t> rowOf(const std::vector<Entry>& entries, const std::string& name);

// The row that takes the place of a row of an earlier listing: the one of the same name, or else the first of
// those that stood after it and are still there, or the last.
std::size_t rowInPlaceOf(const std::vector<Entry>& before, std::size_t row, const std::vector<Entry>& now);

// Changes whenever a file comes into the folder or goes; nothing when there is no such folder.
std::optional<std::string> stateOf(const std::string& folder);
} // namespace tessel::filepanel
