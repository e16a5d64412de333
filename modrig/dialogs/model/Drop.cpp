#include "modrig/dialogs/model/Drop.h"

#include "modrig/types/FileValidation.h"

namespace ModrigUtils
{
bool HasApplication(const DraggedFiles& files)
{
    for (std::size_t index = 0; index < files.count; ++index)
    {
        const CStdStr path = files.pathOf(index);
        // A file without an extension gets a message box when it is asked whether it can be loaded. During a
        // drag there would be one at every move of the mouse, which the program that the files come from
        // holds, out of reach until the drop. Such a file is heard of when it is dropped with others.
        if (!path.AfterLastDot().IsEmpty() && IsValidFileForModrig(path))
            return true;
    }
    return false;
}

DropAnswer AnswerDrop(const ProposedDrop& drop, const DraggedFiles& files)
{
    const bool isBelowTheRows = drop.row < 0 && drop.table == TableKind::kLoadedApplications;
    if (drop.isOnRow && !isBelowTheRows)
        return DropAnswer::kRefused;
    if (!HasApplication(files))
        return DropAnswer::kRefused;
    return isBelowTheRows ? DropAnswer::kTakenAtEnd : DropAnswer::kTaken;
}
} // namespace ModrigUtils
