// Whether files that are dragged over the dialog are taken, and where they go.
#pragma once

#include <cstddef>
#include <functional>

#include "modrig/base/CStdStr.h"
#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
// The files under the mouse. They may be thousands, and are asked for one by one.
struct DraggedFiles
{
    std::size_t count = 0;
    std::function<CStdStr(std::size_t index)> pathOf;
};

// Whether there is an application among the files: one is enough. Says nothing about any of them.
[[nodiscard]] bool HasApplication(const DraggedFiles& files);

// What the toolkit suggests for a drop on a table.
struct ProposedDrop
{
    TableKind table = TableKind::kLoadedApplications;
    long row = 0;         // negative: the table as a whole, which some toolkits suggest below the rows
    bool isOnRow = false; // on the row, or else above it
};

enum class DropAnswer
{
    kRefused,
    kTaken,     // where it was suggested
    kTakenAtEnd // after the last row
};

[[nodiscard]] DropAnswer AnswerDrop(const ProposedDrop& drop, const DraggedFiles& files);
} // namespace ModrigUtils
