// How a row of a table looks, and what its tip says.
#pragma once

#include <functional>

#include "modrig/base/CStdStr.h"
#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
enum class RowState
{
    kUsable,
    kMissing,      // there is no such file
    kFailed,       // it was not loaded when that was last tried
    kKeptOut,      // the host does not load it by itself
    kLocked,       // a module that may not be unloaded
    kNeverUnloaded // an application of a kind that cannot be unloaded
};

struct RowFacts
{
    bool exists = false;
    bool unloadable = false;
    bool isCompiledModule = false;
    bool hasFailed = false;
    bool isKeptOut = false;
};

// All but usable rows are shown in grey.
[[nodiscard]] RowState StateOf(TableKind kind, const RowFacts& facts);

// The key of the text that says why a row is grey; null for one that is not, and for one that is kept out:
// the host says why.
[[nodiscard]] const char* ReasonKey(RowState state);

// The tip of a row: the path of its file as it is shown, and in a line after it why the row is grey, if it
// is. `whyKeptOut`: the host's reason for not loading the file by itself, empty when it does; it comes before
// any other reason. `textOf` answers the text of a key.
[[nodiscard]] CStdStr TipOfRow(const CStdStr& path, const CStdStr& whyKeptOut, RowState state,
                               const std::function<CStdStr(const char* key)>& textOf);

// The text itself when it fits, or as much of its beginning as fits with an ellipsis after it. `fits` answers
// whether a text does; a shorter one does when a longer one does.
[[nodiscard]] CStdStr Shortened(const CStdStr& text, const std::function<bool(const CStdStr&)>& fits);
} // namespace ModrigUtils
