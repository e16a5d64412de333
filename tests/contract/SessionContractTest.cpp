#include <tessel/tssession.h>
#include <wincompat/winreg.h>

#include <poll.h>

#include "tests/contract/ContractTest.h"

namespace
{
class SessionContract : public ContractTest
{
protected:
    SessionContract()
    {
        RegCreateKeyEx(HKEY_CURRENT_USER, L"Software\\Contract", 0, nullptr, 0, KEY_WRITE, nullptr, &mKey,
                       nullptr);
    }
    ~SessionContract() override { RegCloseKey(mKey); }

    LONG set(const wchar_t* data) const { return tsudRegSetString(mKey, L"Name", data); }
    std::wstring get() const
    {
        wchar_t data[10] = {};
        DWORD size = sizeof data;
        return tsRegGetValue(mKey, L"Name", 0, nullptr, data, &size) == ERROR_SUCCESS ? data : L"?";
    }

private:
    HKEY mKey = nullptr;
};

TEST_F(SessionContract, IsNotToEndAsLongAsNobodyAsksForIt)
{
    pollfd request{tsrxEndRequest(), POLLIN, 0};
    EXPECT_EQ(poll(&request, 1, 0), 0);
}

TEST_F(SessionContract, IsAloneWithItsProfile)
{
    EXPECT_FALSE(tsrxOtherSessionRuns());
}

TEST_F(SessionContract, KeepsKeysOpenAndValuesStoredOverAWait)
{
    EXPECT_EQ(set(L"1"), ERROR_SUCCESS);
    tsrxBeforeWaiting(true);
    EXPECT_EQ(get(), L"1");
    EXPECT_EQ(set(L"2"), ERROR_SUCCESS);
    tsrxBeforeWaiting(false);
    EXPECT_EQ(get(), L"2");
    EXPECT_EQ(set(L"3"), ERROR_SUCCESS);
    EXPECT_EQ(get(), L"3");
}
} // namespace
