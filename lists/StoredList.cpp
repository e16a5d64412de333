#include "lists/StoredList.h"

#include <cwchar>

#include "lists/ListMembership.h"
#include "lists/ProfileRegistry.h"
#include "module/MessageIds.h"
#include "module/Messages.h"

namespace ModrigUtils
{
namespace
{
CStdStr SubKeyOf(const StoredListNames& names)
{
    return GetModrigProfileRegKey() + CStdStr(L"\\") + CStdStr(names.subKey);
}

CStdStr EntryName(const StoredListNames& names, long index)
{
    CStdStr name;
    name.Fmt(names.entryFormat, index);
    return name;
}

// The leading decimal digits; 0 when there are none.
long ReadCount(const CStdStr& text)
{
    return std::wcstol(text.c_str(), nullptr, 10);
}

bool DeleteStoredValues(const CStdStr& subKey)
{
    CStringList stored;
    if (!EnumModrigRegString(HKEY_CURRENT_USER, subKey, stored))
        return false;
    for (const CStdStr& name : stored)
        if (!DeleteModrigRegString(HKEY_CURRENT_USER, subKey, name))
            return false;
    return true;
}

bool WriteCount(const StoredListNames& names, const CStdStr& subKey, std::size_t count)
{
    CStdStr decimal;
    decimal.Fmt(L"%d", count);
    return WriteModrigRegString(HKEY_CURRENT_USER, subKey, names.count, decimal);
}

// One entry that cannot be written does not keep the others from being stored; what the last write answered
// is what counts.
bool WriteEntries(const StoredListNames& names, const CStdStr& subKey, const CStringList& list)
{
    bool written = true;
    long index = 0;
    for (const CStdStr& path : list)
        written = WriteModrigRegString(HKEY_CURRENT_USER, subKey, EntryName(names, ++index), path);
    return written;
}
} // namespace

void ReadStoredList(const StoredListNames& names, CStringList& list,
                    const std::function<void(const CStdStr& path)>& appended)
{
    list.RemoveAll();
    const CStdStr subKey = SubKeyOf(names);
    CStdStr stored;
    if (!ReadModrigRegString(HKEY_CURRENT_USER, subKey, names.count, stored))
        return;
    const long count = ReadCount(stored);
    long index = 1;
    for (long pass = 0; pass < count; ++pass)
    {
        CStdStr path;
        // The index advances only behind a value that was read: the list ends at the first gap, and numbers
        // behind a gap, left over from a longer list, never come back.
        if (!ReadModrigRegString(HKEY_CURRENT_USER, subKey, EntryName(names, index), path))
            return;
        ++index;
        if (FoundinSpecificList(path, list))
            continue;
        list.AddTail(path);
        appended(path);
    }
}

void WriteStoredList(const StoredListNames& names, const CStringList& list)
{
    const CStdStr subKey = SubKeyOf(names);
    // Without a value name this only makes the key.
    static_cast<void>(WriteModrigRegString(HKEY_CURRENT_USER, subKey, CStdStr(), CStdStr()));
    const bool stored = DeleteStoredValues(subKey) && WriteCount(names, subKey, list.GetCount()) &&
                        WriteEntries(names, subKey, list);
    if (!stored)
        ModrigAfxMessageBox(ModrigMessages::kListNotStored, CStdStr());
}
} // namespace ModrigUtils
