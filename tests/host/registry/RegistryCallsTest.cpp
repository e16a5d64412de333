#include <gmock/gmock.h>
#include <wincompat/winreg.h>

#include <cstring>

#include "tests/host/support/RegistryHost.h"
#include "tests/support/Database.h"

using testing::ElementsAre;

namespace
{
constexpr DWORD kRoom = 1024;

class RegistryCalls : public testing::Test
{
protected:
    HKEY create(const wchar_t* path, HKEY root = HKEY_CURRENT_USER)
    {
        HKEY key = nullptr;
        EXPECT_EQ(RegCreateKeyEx(root, path, 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr),
                  ERROR_SUCCESS);
        return key;
    }
    static LONG open(const wchar_t* path, HKEY& key, HKEY root = HKEY_CURRENT_USER)
    {
        return RegOpenKeyExW(root, path, 0, KEY_READ, &key);
    }
    static LONG nameAt(HKEY key, DWORD index, std::wstring& name)
    {
        wchar_t buffer[kRoom] = {};
        DWORD length = kRoom;
        const LONG status = RegEnumValueW(key, index, buffer, &length, nullptr, nullptr, nullptr, nullptr);
        name.assign(buffer);
        EXPECT_TRUE(status != ERROR_SUCCESS || length == name.size());
        return status;
    }
    static std::vector<std::wstring> names(HKEY key)
    {
        std::vector<std::wstring> found;
        std::wstring name;
        for (DWORD index = 0; nameAt(key, index, name) == ERROR_SUCCESS; ++index)
            found.push_back(name);
        return found;
    }

    RegistryHost host;
};
} // namespace

TEST_F(RegistryCalls, MakeAKeyWithItsParentsAndSayWhetherItWasThere)
{
    HKEY key = nullptr;
    DWORD found = 0;
    EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, L"A\\B", 0, nullptr, 0, KEY_WRITE, nullptr, &key, &found),
              ERROR_SUCCESS);
    EXPECT_EQ(found, REG_CREATED_NEW_KEY);
    EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, L"a\\b", 0, nullptr, 0, KEY_WRITE, nullptr, &key, &found),
              ERROR_SUCCESS);
    EXPECT_EQ(found, REG_OPENED_EXISTING_KEY);
    EXPECT_EQ(open(L"A", key), ERROR_SUCCESS);
    EXPECT_EQ(open(L"b", key, key), ERROR_SUCCESS);
}

TEST_F(RegistryCalls, OpenOnlyWhatIsThere)
{
    HKEY key = nullptr;
    EXPECT_EQ(open(L"Nowhere", key), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(key, nullptr);
    EXPECT_EQ(host.registry().find(L"Nowhere"), tessel::Registry::kNoKey);
    EXPECT_EQ(open(L"", key), ERROR_SUCCESS);
    EXPECT_EQ(open(nullptr, key), ERROR_SUCCESS);
}

TEST_F(RegistryCalls, ReadWhatWasSet)
{
    const HKEY key = create(L"A");
    EXPECT_EQ(tsudRegSetString(key, L"größe", L"Ä"), ERROR_SUCCESS);
    wchar_t data[kRoom] = {};
    DWORD type = 0;
    DWORD size = sizeof data;
    EXPECT_EQ(tsRegGetValue(key, L"GRÖßE", 0, &type, data, &size), ERROR_SUCCESS);
    EXPECT_EQ(type, REG_SZ);
    EXPECT_EQ(size, 2 * sizeof(wchar_t));
    EXPECT_STREQ(data, L"Ä");
    EXPECT_EQ(tsRegGetValue(key, L"other", 0, &type, data, &size), ERROR_FILE_NOT_FOUND);
}

TEST_F(RegistryCalls, KeepTheUnnamedValueApart)
{
    const HKEY key = create(L"A");
    wchar_t data[kRoom] = {};
    DWORD size = sizeof data;
    EXPECT_EQ(tsRegGetValue(key, L"", 0, nullptr, data, &size), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(tsudRegSetString(key, nullptr, L"unnamed"), ERROR_SUCCESS);
    EXPECT_EQ(tsRegGetValue(key, L"", 0, nullptr, data, &size), ERROR_SUCCESS);
    EXPECT_STREQ(data, L"unnamed");
    EXPECT_EQ(tsudRegSetString(key, L"", nullptr), ERROR_SUCCESS);
    size = sizeof data;
    EXPECT_EQ(tsRegGetValue(key, nullptr, 0, nullptr, data, &size), ERROR_SUCCESS);
    EXPECT_STREQ(data, L"");
}

TEST_F(RegistryCalls, GiveDataThatFitsExactlyAndNothingOfLonger)
{
    const HKEY key = create(L"A");
    const std::wstring fits(1023, L'x');
    const std::wstring tooLong(1024, L'y');
    EXPECT_EQ(tsudRegSetString(key, L"fits", fits.c_str()), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"long", tooLong.c_str()), ERROR_SUCCESS);
    wchar_t data[kRoom] = {};
    DWORD size = sizeof data;
    EXPECT_EQ(tsRegGetValue(key, L"fits", 0, nullptr, data, &size), ERROR_SUCCESS);
    EXPECT_EQ(size, sizeof data);
    EXPECT_EQ(std::wstring(data), fits);
    EXPECT_EQ(tsRegGetValue(key, L"long", 0, nullptr, data, &size), ERROR_MORE_DATA);
    EXPECT_EQ(size, sizeof data + sizeof(wchar_t)) << "what it takes";
    EXPECT_EQ(std::wstring(data), fits) << "untouched";
}

TEST_F(RegistryCalls, TellTheSizeWithoutABuffer)
{
    const HKEY key = create(L"A");
    const std::wstring text(4000, L'ß');
    EXPECT_EQ(tsudRegSetString(key, L"name", text.c_str()), ERROR_SUCCESS);
    DWORD size = 0;
    EXPECT_EQ(tsRegGetValue(key, L"name", 0, nullptr, nullptr, &size), ERROR_SUCCESS);
    EXPECT_EQ(size, 4001 * sizeof(wchar_t));
    std::wstring data(4001, L'?');
    EXPECT_EQ(tsRegGetValue(key, L"name", 0, nullptr, data.data(), &size), ERROR_SUCCESS);
    EXPECT_EQ(data.c_str(), text);
    EXPECT_EQ(tsRegGetValue(key, L"name", 0, nullptr, nullptr, nullptr), ERROR_SUCCESS);
}

TEST_F(RegistryCalls, RefuseABufferWithoutASize)
{
    const HKEY key = create(L"A");
    EXPECT_EQ(tsudRegSetString(key, L"name", L"x"), ERROR_SUCCESS);
    wchar_t data[kRoom] = L"untouched";
    EXPECT_EQ(tsRegGetValue(key, L"name", 0, nullptr, data, nullptr), ERROR_INVALID_PARAMETER);
    EXPECT_STREQ(data, L"untouched");
    wchar_t name[kRoom] = {};
    DWORD length = kRoom;
    BYTE bytes[4] = {};
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, bytes, nullptr),
              ERROR_INVALID_PARAMETER);
}

TEST_F(RegistryCalls, EnumerateNamesAndTheirDataInTheOrderOfCreation)
{
    const HKEY key = create(L"A");
    for (const wchar_t* name : {L"z", L"a", L"m"})
        EXPECT_EQ(tsudRegSetString(key, name, L"1"), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"Z", L"two"), ERROR_SUCCESS);
    EXPECT_THAT(names(key), ElementsAre(L"z", L"a", L"m"));
    wchar_t name[kRoom] = {};
    DWORD length = kRoom;
    DWORD type = 0;
    wchar_t data[kRoom] = {};
    DWORD size = sizeof data;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, &type, reinterpret_cast<BYTE*>(data), &size),
              ERROR_SUCCESS);
    EXPECT_EQ(type, REG_SZ);
    EXPECT_STREQ(data, L"two");
    EXPECT_EQ(size, 4 * sizeof(wchar_t));
}

TEST_F(RegistryCalls, GiveANameWholeOrNotAtAll)
{
    const HKEY key = create(L"A");
    EXPECT_EQ(tsudRegSetString(key, L"four", L""), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"b", L""), ERROR_SUCCESS);
    wchar_t name[] = L"???????";
    DWORD length = 4;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_MORE_DATA);
    EXPECT_STREQ(name, L"???????");
    length = 5;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_SUCCESS);
    EXPECT_STREQ(name, L"four");
    EXPECT_EQ(length, 4u);
    length = 5;
    EXPECT_EQ(RegEnumValueW(key, 1, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_SUCCESS);
    EXPECT_STREQ(name, L"b");
}

TEST_F(RegistryCalls, EnumerateWhileValuesAreRemoved)
{
    const HKEY key = create(L"A");
    for (const wchar_t* name : {L"1", L"2", L"3", L"4", L"5"})
        EXPECT_EQ(tsudRegSetString(key, name, L""), ERROR_SUCCESS);
    std::wstring name;
    EXPECT_EQ(nameAt(key, 0, name), ERROR_SUCCESS);
    EXPECT_EQ(nameAt(key, 1, name), ERROR_SUCCESS);
    EXPECT_EQ(RegDeleteValueW(key, name.c_str()), ERROR_SUCCESS);
    EXPECT_EQ(nameAt(key, 1, name), ERROR_SUCCESS);
    EXPECT_EQ(name, L"3");
    EXPECT_EQ(RegDeleteValueW(key, L"1"), ERROR_SUCCESS);
    EXPECT_EQ(nameAt(key, 2, name), ERROR_SUCCESS) << "an index counts what is left";
    EXPECT_EQ(name, L"5");
    while (nameAt(key, 0, name) == ERROR_SUCCESS)
        ASSERT_EQ(RegDeleteValueW(key, name.c_str()), ERROR_SUCCESS);
    EXPECT_EQ(nameAt(key, 0, name), ERROR_NO_MORE_ITEMS);
}

TEST_F(RegistryCalls, EnumerateWhatIsAddedMeanwhile)
{
    const HKEY key = create(L"A");
    EXPECT_EQ(tsudRegSetString(key, L"1", L""), ERROR_SUCCESS);
    std::wstring name;
    EXPECT_EQ(nameAt(key, 0, name), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"2", L""), ERROR_SUCCESS);
    EXPECT_EQ(nameAt(key, 1, name), ERROR_SUCCESS);
    EXPECT_EQ(name, L"2");
    EXPECT_EQ(nameAt(key, 2, name), ERROR_NO_MORE_ITEMS);
}

TEST_F(RegistryCalls, RemoveAValueOnce)
{
    const HKEY key = create(L"A");
    EXPECT_EQ(tsudRegSetString(key, L"name", L""), ERROR_SUCCESS);
    EXPECT_EQ(RegDeleteValueW(key, L"NAME"), ERROR_SUCCESS);
    EXPECT_EQ(RegDeleteValueW(key, L"NAME"), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(RegDeleteValueW(key, nullptr), ERROR_FILE_NOT_FOUND);
}

TEST_F(RegistryCalls, KeepHandlesApartInWhateverOrderTheyAreClosed)
{
    const HKEY keys[] = {create(L"A"), create(L"B"), create(L"C")};
    const auto write = [&](std::size_t key)
    {
        return tsudRegSetString(keys[key], L"name", std::to_wstring(key).c_str());
    };
    for (const std::size_t key : {0U, 2U, 1U})
        EXPECT_EQ(write(key), ERROR_SUCCESS);
    for (const wchar_t* path : {L"A", L"B", L"C"})
        EXPECT_EQ(host.registry().read(path, L"name"), std::to_wstring(path[0] - L'A'));
    EXPECT_EQ(RegCloseKey(keys[1]), ERROR_SUCCESS);
    EXPECT_EQ(write(1), ERROR_INVALID_HANDLE);
    EXPECT_EQ(RegCloseKey(keys[2]), ERROR_SUCCESS);
    EXPECT_EQ(write(2), ERROR_INVALID_HANDLE);
    EXPECT_EQ(write(0), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(keys[0]), ERROR_SUCCESS);
    EXPECT_EQ(write(0), ERROR_INVALID_HANDLE);
}

TEST_F(RegistryCalls, RefuseHandlesThatAreClosedOrNeverWereOpen)
{
    HKEY closed = create(L"A");
    EXPECT_EQ(RegCloseKey(closed), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(closed), ERROR_INVALID_HANDLE);
    int somewhere = 0;
    for (const HKEY foreign : {closed, static_cast<HKEY>(nullptr), static_cast<HKEY>(&somewhere)})
    {
        HKEY key = nullptr;
        std::wstring name;
        DWORD size = 0;
        EXPECT_EQ(open(L"A", key, foreign), ERROR_INVALID_HANDLE);
        EXPECT_EQ(RegCreateKeyEx(foreign, L"A", 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr),
                  ERROR_INVALID_HANDLE);
        EXPECT_EQ(nameAt(foreign, 0, name), ERROR_INVALID_HANDLE);
        EXPECT_EQ(tsRegGetValue(foreign, L"", 0, nullptr, nullptr, &size), ERROR_INVALID_HANDLE);
        EXPECT_EQ(tsudRegSetString(foreign, L"name", L""), ERROR_INVALID_HANDLE);
        EXPECT_EQ(RegDeleteValueW(foreign, L"name"), ERROR_INVALID_HANDLE);
        EXPECT_EQ(RegCloseKey(foreign), ERROR_INVALID_HANDLE);
        EXPECT_EQ(key, nullptr);
    }
}

TEST_F(RegistryCalls, KeepTheRootOpen)
{
    EXPECT_EQ(RegCloseKey(HKEY_CURRENT_USER), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(HKEY_CURRENT_USER, L"name", L"1"), ERROR_SUCCESS);
}

TEST_F(RegistryCalls, KeepOtherHandlesOfAKeyThatIsClosed)
{
    const HKEY first = create(L"A");
    const HKEY second = create(L"A");
    EXPECT_NE(first, second);
    EXPECT_EQ(RegCloseKey(first), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(second, L"name", L"1"), ERROR_SUCCESS);
}

TEST_F(RegistryCalls, RefuseToGiveAResultNowhere)
{
    EXPECT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, L"", 0, KEY_READ, nullptr), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, L"A", 0, nullptr, 0, KEY_WRITE, nullptr, nullptr, nullptr),
              ERROR_INVALID_PARAMETER);
    wchar_t name[4] = {};
    DWORD length = 4;
    EXPECT_EQ(RegEnumValueW(HKEY_CURRENT_USER, 0, nullptr, &length, nullptr, nullptr, nullptr, nullptr),
              ERROR_INVALID_PARAMETER);
    EXPECT_EQ(RegEnumValueW(HKEY_CURRENT_USER, 0, name, nullptr, nullptr, nullptr, nullptr, nullptr),
              ERROR_INVALID_PARAMETER);
}

TEST_F(RegistryCalls, HaveNoHandlesWhereThereIsNoRegistry)
{
    const HKEY key = create(L"A");
    host.close();
    EXPECT_EQ(tsudRegSetString(key, L"name", L"1"), ERROR_INVALID_HANDLE);
    HKEY other = nullptr;
    EXPECT_EQ(open(L"A", other), ERROR_INVALID_HANDLE);
}

// A value or key that is not found is not known not to be there.
TEST_F(RegistryCalls, TellWhatCannotBeReadFromWhatIsNotThere)
{
    host.close();
    host.folder().write("registry.db", "no registry at all, whatever its name says");
    host.open();
    HKEY key = nullptr;
    DWORD size = 0;
    EXPECT_EQ(open(L"A", key), ERROR_READ_FAULT);
    EXPECT_EQ(tsRegGetValue(HKEY_CURRENT_USER, L"name", 0, nullptr, nullptr, &size), ERROR_READ_FAULT);
    EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, L"A", 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr),
              ERROR_ACCESS_DENIED);
    wchar_t reason[kRoom] = {};
    EXPECT_TRUE(tsRegMayHaveMissed(L"A", L"name", reason, kRoom));
    EXPECT_EQ(reason, host.registry().canStore().sentence());
    EXPECT_TRUE(tsRegMayHaveMissed(L"A", L"name", reason, 4));
    EXPECT_EQ(reason, host.registry().canStore().sentence().substr(0, 3));
    EXPECT_TRUE(tsRegMayHaveMissed(nullptr, nullptr, nullptr, 0));
}

TEST_F(RegistryCalls, TellOnceWhatIsFoundDamagedWhileTheyRead)
{
    ASSERT_TRUE(host.registry().write(L"A", L"name", L"1"));
    ASSERT_TRUE(host.registry().write(L"A", L"other", L"1"));
    ASSERT_TRUE(host.registry().endOfCommand());
    ASSERT_EQ(runSql(host.file(), "UPDATE value SET data='2' WHERE name='name'"), "");
    wchar_t reason[kRoom] = {};
    EXPECT_FALSE(tsRegMayHaveMissed(L"A", L"other", reason, kRoom)) << "each value on its own account";
    EXPECT_TRUE(tsRegMayHaveMissed(L"A", L"name", reason, kRoom));
    EXPECT_NE(std::wstring(reason).find(L"a row of it is not what was stored there"), std::wstring::npos);
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_FALSE(tsRegMayHaveMissed(L"A", L"other", reason, kRoom));
    EXPECT_TRUE(tsRegMayHaveMissed(L"A", L"third", reason, kRoom));
}
