#include "modrig/lists/StoredList.h"

#include <cwchar>
#include <iterator>
#include <limits>
#include <string>
#include <string_view>
#include <utility>

#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/profile/ProfileRegistry.h"

namespace ModrigUtils
{
CStdStr SubKeyOf(const StoredListNames& names)
{
    return GetModrigProfileRegKey() + CStdStr(L"\\") + CStdStr(names.subKey);
}

CStdStr EntryName(const StoredListNames& names, long index)
{
    // Without a format, which would cost more than to read the entry: names are made by the hundred thousand.
    constexpr long kBase = 10;
    wchar_t digits[std::numeric_limits<long>::digits10 + 1];
    wchar_t* first = std::end(digits);
    long rest = index;
    do
        *--first = static_cast<wchar_t>(L'0' + rest % kBase);
    while ((rest /= kBase) > 0);
    const std::wstring_view end = names.entryEnd;
    std::wstring name;
    name.reserve(std::size(digits) + end.size());
    name.append(first, static_cast<std::size_t>(std::end(digits) - first)).append(end);
    return name;
}

namespace
{
// Reads the numbered values one after the other, in as many passes as the list's count says. The number moves
// on only after a value that was read: a pass that fails is spent, and the next asks for the same value. So a
// list ends at its first gap, numbers after the gap, left over from a longer list, never come back, and a
// fault that passes costs the passes it took and no more.
class EntryReader
{
public:
    EntryReader(const StoredListNames& names, CStdStr subKey, long passes)
        : mNames(names), mSubKey(std::move(subKey)), mPassesLeft(passes), mName(EntryName(names, mIndex))
    {
    }

    // How many there were up to now.
    long Count() const { return mIndex - 1; }

    // The next entry, or false at the end.
    bool Read(CStdStr& path)
    {
        for (int failures = 0; mPassesLeft > 0 && failures < kMostFailuresInARow; ++failures)
        {
            --mPassesLeft;
            if (!ReadModrigRegString(HKEY_CURRENT_USER, mSubKey, mName, path))
                continue;
            mName = EntryName(mNames, ++mIndex);
            return true;
        }
        return false;
    }

private:
    // A gap does not close while it is looked at. A damaged count, which may be anything, must not keep the
    // host from starting.
    static constexpr int kMostFailuresInARow = 10000;

    const StoredListNames& mNames;
    const CStdStr mSubKey;
    long mPassesLeft;
    long mIndex = 1;
    CStdStr mName;
};

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

long ReadStoredList(const StoredListNames& names, CStringList& list,
                    const std::function<void(const CStdStr& path)>& appended)
{
    list.RemoveAll();
    const CStdStr subKey = SubKeyOf(names);
    CStdStr stored;
    if (!ReadModrigRegString(HKEY_CURRENT_USER, subKey, names.count, stored))
        return 0;
    EntryReader entries(names, subKey, ReadCount(stored));
    for (CStdStr path; entries.Read(path);)
        if (const CStdStr* added = list.AddTailUnlessHeld(std::move(path)))
            appended(*added);
    return entries.Count();
}

bool StoreList(const StoredListNames& names, const CStringList& list)
{
    const CStdStr subKey = SubKeyOf(names);
    // Without a value name this only makes the key.
    static_cast<void>(WriteModrigRegString(HKEY_CURRENT_USER, subKey, CStdStr(), CStdStr()));
    return DeleteStoredValues(subKey) && WriteCount(names, subKey, list.GetCount()) &&
           WriteEntries(names, subKey, list);
}

void WriteStoredList(const StoredListNames& names, const CStringList& list)
{
    if (!StoreList(names, list))
        ModrigAfxMessageBox(ModrigMessages::kListNotStored, CStdStr());
}
} // namespace ModrigUtils
