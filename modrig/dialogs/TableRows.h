// Filling a table with rows for many paths.
#pragma once

#import <AppKit/AppKit.h>

#import "modrig/dialogs/ModrigFilePath.h"

#include "modrig/base/HashIndex.h"
#include "modrig/dialogs/platform/LinkResolver.h"

namespace ModrigUtils
{
// Rows that join a table: for each path one, links resolved, unless the table or an earlier path has one for
// that file. The table must not change meanwhile.
class JoiningRows
{
public:
    explicit JoiningRows(NSArrayController* table);
    ~JoiningRows();
    JoiningRows(const JoiningRows&) = delete;
    JoiningRows& operator=(const JoiningRows&) = delete;

    // Says which paths will be added, before any is.
    void Expect(const CStdStr& path);
    void Add(const CStdStr& path);
    // Gives them to the table, in one change; they are the table's alone then.
    void Join();

private:
    bool Know(ModrigFilePath* row, std::size_t hash);

    NSArrayController* mTable;
    NSMutableArray* mRows;
    std::unique_ptr<ModrigPlatform::LinkResolver> mLinks;
    HashIndex<ModrigFilePath*> mKnown;
};

template <typename Paths> void AddRows(NSArrayController* table, const Paths& paths)
{
    JoiningRows rows(table);
    for (const CStdStr& path : paths)
        rows.Expect(path);
    for (const CStdStr& path : paths)
        rows.Add(path);
    rows.Join();
}

// For a table that has just opened: none of the rows is selected, since nothing has been chosen by anybody
// yet.
template <typename Paths> void FillTable(NSArrayController* table, const Paths& paths)
{
    [table setSelectsInsertedObjects:NO];
    AddRows(table, paths);
    [table setSelectsInsertedObjects:YES];
}
} // namespace ModrigUtils
