#include <wincompat/winreg.h>

#include "tests/contract/ContractTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr const wchar_t* kContractKey = L"Software\\Contract";
constexpr DWORD kDataBytes = 4096;
constexpr std::size_t kDataCharacters = kDataBytes / sizeof(wchar_t);
constexpr DWORD kNameCharacters = 1024;

class RegistryContract : public ContractTest
{
protected:
    RegistryContract() { key = create(kContractKey); }
    ~RegistryContract() override { RegCloseKey(key); }

    static HKEY create(const wchar_t* path, HKEY root = HKEY_CURRENT_USER)
    {
        HKEY made = nullptr;
        EXPECT_EQ(RegCreateKeyEx(root, path, 0, nullptr, 0, KEY_WRITE, nullptr, &made, nullptr),
                  ERROR_SUCCESS);
        return made;
    }

    static LONG open(const wchar_t* path, HKEY root = HKEY_CURRENT_USER)
    {
        HKEY opened = nullptr;
        const LONG status = RegOpenKeyExW(root, path, 0, KEY_READ, &opened);
        return status == ERROR_SUCCESS ? RegCloseKey(opened) : status;
    }

    void set(const wchar_t* name, const wchar_t* data) const
    {
        EXPECT_EQ(tsudRegSetString(key, name, data), ERROR_SUCCESS);
    }

    // The value as the key at the path holds it; "?" and the status when it cannot be read.
    static std::wstring read(HKEY from, const wchar_t* name)
    {
        wchar_t buffer[kDataCharacters] = {};
        DWORD type = 0;
        DWORD size = kDataBytes;
        const LONG status = tsRegGetValue(from, name, 0, &type, buffer, &size);
        if (status != ERROR_SUCCESS)
            return L"?" + std::to_wstring(status);
        EXPECT_EQ(type, REG_SZ);
        EXPECT_EQ(size, (std::wcslen(buffer) + 1) * sizeof(wchar_t));
        return buffer;
    }
    std::wstring read(const wchar_t* name) const { return read(key, name); }

    std::vector<std::wstring> names() const
    {
        std::vector<std::wstring> found;
        wchar_t name[kNameCharacters];
        for (DWORD index = 0;; ++index)
        {
            DWORD length = kNameCharacters;
            const LONG status = RegEnumValueW(key, index, name, &length, nullptr, nullptr, nullptr, nullptr);
            if (status != ERROR_SUCCESS)
            {
                EXPECT_EQ(status, ERROR_NO_MORE_ITEMS);
                return found;
            }
            EXPECT_EQ(length, std::wcslen(name));
            found.emplace_back(name);
        }
    }

    HKEY key = nullptr;
};

TEST_F(RegistryContract, DoesNotOpenAKeyThatIsMissing)
{
    EXPECT_EQ(open(L"Software\\Contract\\None"), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(open(L"None"), ERROR_FILE_NOT_FOUND);
}

TEST_F(RegistryContract, MakesTheMissingParentsOfAKey)
{
    RegCloseKey(create(L"Software\\Contract\\One\\Two\\Three"));
    EXPECT_EQ(open(L"Software\\Contract\\One"), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Software\\Contract\\One\\Two"), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Software\\Contract\\One\\Two\\Three"), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Software\\Contract\\Two"), ERROR_FILE_NOT_FOUND);
}

TEST_F(RegistryContract, OpensWhatItIsAskedToMakeTwice)
{
    set(L"Name", L"data");
    const HKEY again = create(kContractKey);
    EXPECT_EQ(read(again, L"Name"), L"data");
    RegCloseKey(again);
}

TEST_F(RegistryContract, StoresInTheMiddleOfACommandWhatWasWritten)
{
    set(L"Name", L"1");
    EXPECT_EQ(RegFlushKey(key), ERROR_SUCCESS);
    EXPECT_EQ(read(key, L"Name"), L"1");
    set(L"Name", L"2");
    EXPECT_EQ(RegFlushKey(HKEY_CURRENT_USER), ERROR_SUCCESS);
    EXPECT_EQ(read(key, L"Name"), L"2");
    EXPECT_EQ(RegFlushKey(nullptr), ERROR_INVALID_HANDLE);
}

TEST_F(RegistryContract, HasNothingLaidDownWhereNobodyDidSo)
{
    set(L"Name", L"1");
    wchar_t place[8] = L"before";
    EXPECT_FALSE(tsRegIsLaidDown(key, L"Name", place, 8));
    EXPECT_STREQ(place, L"before");
    EXPECT_FALSE(tsRegIsLaidDown(nullptr, L"Name", nullptr, 0));
}

TEST_F(RegistryContract, MissesNothingInARegistryThatCanBeRead)
{
    set(L"Name", L"1");
    wchar_t reason[8] = L"before";
    EXPECT_FALSE(tsRegMayHaveMissed(kContractKey, L"Name", reason, 8));
    EXPECT_FALSE(tsRegMayHaveMissed(kContractKey, L"None", reason, 8));
    EXPECT_FALSE(tsRegMayHaveMissed(L"None", L"", nullptr, 0));
    EXPECT_STREQ(reason, L"before");
}

TEST_F(RegistryContract, OpensAKeyBelowAnOpenKey)
{
    const HKEY child = create(L"Child\\Grandchild", key);
    EXPECT_EQ(open(L"Software\\Contract\\Child\\Grandchild"), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Child", key), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Grandchild", key), ERROR_FILE_NOT_FOUND);
    RegCloseKey(child);
}

TEST_F(RegistryContract, PassesOverEmptyPartsOfAPath)
{
    EXPECT_EQ(open(L"\\Software\\\\Contract\\"), ERROR_SUCCESS);
    RegCloseKey(create(L"Software\\Contract\\\\Child"));
    EXPECT_EQ(open(L"Software\\Contract\\Child"), ERROR_SUCCESS);
}

TEST_F(RegistryContract, FindsKeysInAnyLetterCase)
{
    EXPECT_EQ(open(L"SOFTWARE\\contract"), ERROR_SUCCESS);
    RegCloseKey(create(L"Software\\Contract\\\u00C4rger \u03A3\u0416"));
    EXPECT_EQ(open(L"Software\\Contract\\\u00E4RGER \u03C3\u0436"), ERROR_SUCCESS);
    EXPECT_EQ(open(L"Software\\Contract\\arger \u03C3\u0436"), ERROR_FILE_NOT_FOUND);
}

TEST_F(RegistryContract, FindsValuesInAnyLetterCase)
{
    set(L"Stra\u00DFe \u00D6l", L"data");
    EXPECT_EQ(read(L"STRA\u00DFE \u00F6L"), L"data");
    // Folding is character by character: a letter never becomes two.
    EXPECT_EQ(read(L"STRASSE \u00D6L"), L"?2");
    set(L"STRA\u00DFE \u00F6L", L"other");
    EXPECT_EQ(read(L"Stra\u00DFe \u00D6l"), L"other");
    EXPECT_THAT(names(), ElementsAre(L"Stra\u00DFe \u00D6l"));
}

TEST_F(RegistryContract, SaysThatAValueIsMissing)
{
    set(L"Name", L"data");
    EXPECT_EQ(read(L"Nam"), L"?2");
    EXPECT_EQ(read(L""), L"?2");
    RegCloseKey(create(L"Software\\Contract\\Child"));
    EXPECT_EQ(read(L"Child"), L"?2"); // a key is no value
}

TEST_F(RegistryContract, KeepsTheUnnamedValueApart)
{
    set(L"", L"unnamed");
    set(L"Name", L"named");
    EXPECT_EQ(read(L""), L"unnamed");
    EXPECT_EQ(read(L"Name"), L"named");
    EXPECT_EQ(RegDeleteValueW(key, L""), ERROR_SUCCESS);
    EXPECT_EQ(read(L""), L"?2");
    EXPECT_EQ(read(L"Name"), L"named");
}

TEST_F(RegistryContract, KeepsTheValuesOfKeysApart)
{
    const HKEY child = create(L"Child", key);
    set(L"Name", L"parent");
    EXPECT_EQ(tsudRegSetString(child, L"Name", L"child"), ERROR_SUCCESS);
    EXPECT_EQ(read(L"Name"), L"parent");
    EXPECT_EQ(read(child, L"Name"), L"child");
    RegCloseKey(child);
}

TEST_F(RegistryContract, KeepsTextOfEveryKind)
{
    for (const wchar_t* data : {L"", L"a", L"\u00FC\u4E2D\U0001F600", L"'; DROP \"%s\" -- \\ \n\t end"})
    {
        set(L"Name", data);
        EXPECT_EQ(read(L"Name"), data);
    }
}

TEST_F(RegistryContract, ReadsWhatJustFits)
{
    const std::wstring longest(kDataCharacters - 1, L'x');
    set(L"Name", longest.c_str());
    EXPECT_EQ(read(L"Name"), longest);
}

TEST_F(RegistryContract, LeavesTheBufferAloneWhenTheDataDoesNotFit)
{
    const std::wstring tooLong(kDataCharacters, L'x');
    set(L"Name", tooLong.c_str());
    wchar_t buffer[kDataCharacters] = L"before";
    DWORD type = 0;
    DWORD size = kDataBytes;
    EXPECT_EQ(tsRegGetValue(key, L"Name", 0, &type, buffer, &size), ERROR_MORE_DATA);
    EXPECT_EQ(size, (tooLong.size() + 1) * sizeof(wchar_t));
    EXPECT_STREQ(buffer, L"before");
}

TEST_F(RegistryContract, ReadsLongDataIntoALargeEnoughBuffer)
{
    const std::wstring data(10 * kDataCharacters, L'\u00FC');
    set(L"Name", data.c_str());
    std::vector<wchar_t> buffer(data.size() + 1);
    DWORD type = 0;
    DWORD size = static_cast<DWORD>(buffer.size() * sizeof(wchar_t));
    EXPECT_EQ(tsRegGetValue(key, L"Name", 0, &type, buffer.data(), &size), ERROR_SUCCESS);
    EXPECT_EQ(std::wstring(buffer.data()), data);
}

TEST_F(RegistryContract, EnumeratesNothingInAnEmptyKey)
{
    EXPECT_THAT(names(), IsEmpty());
}

TEST_F(RegistryContract, EnumeratesInTheOrderOfCreation)
{
    for (const wchar_t* name : {L"zebra", L"10", L"9", L"Apple"})
        set(name, L"data");
    EXPECT_THAT(names(), ElementsAre(L"zebra", L"10", L"9", L"Apple"));
}

TEST_F(RegistryContract, KeepsPlaceAndSpellingOfAValueThatIsWrittenAgain)
{
    set(L"First", L"1");
    set(L"Second", L"2");
    set(L"FIRST", L"3");
    EXPECT_THAT(names(), ElementsAre(L"First", L"Second"));
    EXPECT_EQ(read(L"First"), L"3");
}

TEST_F(RegistryContract, PutsAValueThatWasDeletedAtTheEnd)
{
    for (const wchar_t* name : {L"First", L"Second", L"Third"})
        set(name, L"data");
    EXPECT_EQ(RegDeleteValueW(key, L"first"), ERROR_SUCCESS);
    EXPECT_THAT(names(), ElementsAre(L"Second", L"Third"));
    set(L"First", L"data");
    EXPECT_THAT(names(), ElementsAre(L"Second", L"Third", L"First"));
}

TEST_F(RegistryContract, SaysThatANameDoesNotFit)
{
    set(L"Four", L"data");
    wchar_t name[kNameCharacters];
    DWORD length = 4;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_MORE_DATA);
    length = 5;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_SUCCESS);
    EXPECT_EQ(length, 4u);
    EXPECT_STREQ(name, L"Four");
}

TEST_F(RegistryContract, EnumeratesDataWhenAskedTo)
{
    set(L"Name", L"data");
    wchar_t name[kNameCharacters];
    DWORD length = kNameCharacters;
    wchar_t data[kNameCharacters];
    DWORD size = sizeof data;
    DWORD type = 0;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, &type, reinterpret_cast<BYTE*>(data), &size),
              ERROR_SUCCESS);
    EXPECT_STREQ(data, L"data");
    EXPECT_EQ(size, 5 * sizeof(wchar_t));
    EXPECT_EQ(type, REG_SZ);
}

TEST_F(RegistryContract, DeletesAValueOnce)
{
    set(L"Name", L"data");
    EXPECT_EQ(RegDeleteValueW(key, L"NAME"), ERROR_SUCCESS);
    EXPECT_EQ(RegDeleteValueW(key, L"Name"), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(read(L"Name"), L"?2");
}

TEST_F(RegistryContract, RefusesAKeyThatIsClosed)
{
    const HKEY closed = create(kContractKey);
    EXPECT_EQ(RegCloseKey(closed), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(closed), ERROR_INVALID_HANDLE);
    EXPECT_EQ(tsudRegSetString(closed, L"Name", L"data"), ERROR_INVALID_HANDLE);
    EXPECT_EQ(read(closed, L"Name"), L"?6");
    EXPECT_EQ(RegDeleteValueW(closed, L"Name"), ERROR_INVALID_HANDLE);
    EXPECT_EQ(open(L"Child", closed), ERROR_INVALID_HANDLE);
}

TEST_F(RegistryContract, SeesThroughOneHandleWhatAnotherWrote)
{
    const HKEY other = create(kContractKey);
    set(L"Name", L"data");
    EXPECT_EQ(read(other, L"Name"), L"data");
    EXPECT_EQ(RegDeleteValueW(other, L"Name"), ERROR_SUCCESS);
    EXPECT_EQ(read(L"Name"), L"?2");
    RegCloseKey(other);
}
} // namespace
