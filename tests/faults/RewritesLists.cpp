// An application that keeps the History and the Startup Suite as Modrig does: it makes sure of the key, lists
// the old names, deletes them one by one, and writes the count and the entries. All of one writing carry its
// number.
#include <cwchar>
#include <string>
#include <vector>

#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>
#include <tessel/tssession.h>
#include <wincompat/winreg.h>

namespace
{
constexpr int kEntries = 12;
constexpr DWORD kNameCharacters = 64;
constexpr DWORD kDataCharacters = 256;
constexpr int kNone = 0;
constexpr int kTorn = -1;

struct List
{
    const wchar_t* name;
    int entries; // the suite is no longer than a person makes it
};

constexpr List kLists[] = {{L"History", kEntries}, {L"Startup", kEntries / 4}};

std::wstring keyOf(const List& list)
{
    return std::wstring(L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\") + list.name;
}

std::wstring entryName(const List& list, int number)
{
    return std::to_wstring(number) + list.name;
}

std::wstring countName(const List& list)
{
    return std::wstring(L"Num") + list.name;
}

// Of a generation, in which no two lists are of one length.
int lengthOf(const List& list, int generation)
{
    return list.entries + generation % 7;
}

std::wstring entryData(int generation, int number)
{
    return L"/nowhere/" + std::to_wstring(generation) + L"/tool" + std::to_wstring(number) + L".lsp";
}

class OpenKey
{
public:
    explicit OpenKey(const List& list)
    {
        mOpen = RegCreateKeyEx(HKEY_CURRENT_USER, keyOf(list).c_str(), 0, nullptr, 0, KEY_WRITE, nullptr,
                               &mKey, nullptr) == ERROR_SUCCESS;
    }
    ~OpenKey()
    {
        if (mOpen)
            RegCloseKey(mKey);
    }
    OpenKey(const OpenKey&) = delete;
    OpenKey& operator=(const OpenKey&) = delete;

    bool set(const std::wstring& name, const std::wstring& data) const
    {
        return mOpen && tsudRegSetString(mKey, name.c_str(), data.c_str()) == ERROR_SUCCESS;
    }
    bool remove(const std::wstring& name) const
    {
        return mOpen && RegDeleteValueW(mKey, name.c_str()) == ERROR_SUCCESS;
    }
    std::vector<std::wstring> names() const
    {
        std::vector<std::wstring> found;
        wchar_t name[kNameCharacters];
        for (DWORD length = kNameCharacters;
             mOpen && RegEnumValueW(mKey, static_cast<DWORD>(found.size()), name, &length, nullptr, nullptr,
                                    nullptr, nullptr) == ERROR_SUCCESS;
             length = kNameCharacters)
            found.emplace_back(name);
        return found;
    }

private:
    HKEY mKey = nullptr;
    bool mOpen = false;
};

std::wstring read(const List& list, const std::wstring& name)
{
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_CURRENT_USER, keyOf(list).c_str(), 0, KEY_READ, &key) != ERROR_SUCCESS)
        return L"";
    wchar_t data[kDataCharacters] = {};
    DWORD size = sizeof data;
    const LONG status = tsRegGetValue(key, name.c_str(), 0, nullptr, data, &size);
    RegCloseKey(key);
    return status == ERROR_SUCCESS ? data : L"";
}

bool rewrite(const List& list, int generation)
{
    for (const auto& name : OpenKey(list).names())
        if (!OpenKey(list).remove(name))
            return false;
    const int length = lengthOf(list, generation);
    bool written = OpenKey(list).set(countName(list), std::to_wstring(length));
    for (int number = 1; number <= length; ++number)
        written = OpenKey(list).set(entryName(list, number), entryData(generation, number)) && written;
    return written;
}

bool rewriteBoth(int generation)
{
    bool written = true;
    for (const List& list : kLists)
        written = rewrite(list, generation) && written;
    return written;
}

int generationOf(const List& list)
{
    const std::wstring first = read(list, entryName(list, 1));
    if (first.empty() && read(list, countName(list)).empty())
        return kNone;
    const std::size_t start = std::wcslen(L"/nowhere/");
    const int generation =
        first.size() > start ? static_cast<int>(std::wcstol(first.c_str() + start, nullptr, 10)) : kTorn;
    const int length = lengthOf(list, generation);
    if (read(list, countName(list)) != std::to_wstring(length) ||
        !read(list, entryName(list, length + 1)).empty())
        return kTorn;
    for (int number = 1; number <= length; ++number)
        if (read(list, entryName(list, number)) != entryData(generation, number))
            return kTorn;
    return generation;
}

int generationOfBoth()
{
    const int generation = generationOf(kLists[0]);
    return generationOf(kLists[1]) == generation ? generation : kTorn;
}

void tellLists()
{
    tsutPrintf(L"The lists are of writing %d.\n", generationOfBoth());
}

void rewriteOnce()
{
    const int generation = generationOfBoth() + 1;
    tsutPrintf(rewriteBoth(generation) ? L"Written.\n" : L"Not written.\n");
}

// Until somebody kills it. Each round is an action of its own, as in a dialog.
void rewriteForEver()
{
    for (int generation = generationOfBoth() + 1;; ++generation)
    {
        if (!rewriteBoth(generation))
            return;
        tsrxBeforeWaiting(true);
        tsutPrintf(L"Stored %d.\n", generation);
    }
}

void add(const wchar_t* name, TsEdCommandHandler handler)
{
    auto* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    commands->addCommand(L"REWRITESLISTS", name, name, 0, handler);
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    if (message != TSRX_MSG_LOAD)
        return TSRX_RET_OK;
    add(L"TELLLISTS", tellLists);
    add(L"REWRITELISTS", rewriteOnce);
    add(L"REWRITEFOREVER", rewriteForEver);
    return TSRX_RET_OK;
}
