#include "modrig/dialogs/TableRows.h"

#include <tesselui/tsuieach.h>

#include "modrig/dialogs/model/PathHash.h"

namespace ModrigUtils
{
JoiningRows::JoiningRows(NSArrayController* table)
    : mTable([table retain]), mRows([[NSMutableArray alloc] init]), mLinks(ModrigPlatform::MakeLinkResolver())
{
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>([table arrangedObjects]))
        mKnown.Add([row hash], row);
}

JoiningRows::~JoiningRows()
{
    [mRows release];
    [mTable release];
}

bool JoiningRows::Know(ModrigFilePath* row, std::size_t hash)
{
    const auto isEqual = [=](ModrigFilePath* known) -> bool { return [known isEqual:row]; };
    if (mKnown.AnyUnder(hash, isEqual))
        return true;
    mKnown.Add(hash, row);
    return false;
}

void JoiningRows::Expect(const CStdStr& path)
{
    mLinks->Expect(path);
}

void JoiningRows::Add(const CStdStr& path)
{
    const CStdStr& resolved = mLinks->Resolve(path);
    ModrigFilePath* row = [ModrigFilePath newWithResolvedPath:resolved];
    if (!Know(row, HashOfPath(resolved.Text())))
        [mRows addObject:row];
    [row release];
}

void JoiningRows::Join()
{
    if ([mRows count])
        [mTable addObjects:mRows];
    [mRows removeAllObjects];
    mKnown.Clear();
}
} // namespace ModrigUtils
