#include <tessel/tsappinfo.h>

#include "tests/contract/ContractTest.h"

namespace
{
constexpr unsigned kBothReasons = TSRX_LOAD_AT_HOST_START | TSRX_LOAD_ON_COMMAND;

class ApplicationRecordContract : public ContractTest
{
protected:
    static void write(const wchar_t* name, unsigned reasons)
    {
        TesselAppInfo record;
        record.setAppName(name);
        record.setModuleName(L"/a/\u00FC tool.bundle");
        record.setDescription(L"Tool Command Module");
        record.setLoadReason(reasons);
        EXPECT_EQ(record.writeToRegistry(false, true), TSRX_APPINFO_OK);
    }

    static void expectIs(const TesselAppInfo& record, const wchar_t* name, const wchar_t* module,
                         const wchar_t* description, unsigned reasons)
    {
        EXPECT_STREQ(record.appName(), name);
        EXPECT_STREQ(record.moduleName(), module);
        EXPECT_STREQ(record.description(), description);
        EXPECT_EQ(record.loadReason(), reasons);
    }
};

TEST_F(ApplicationRecordContract, IsEmptyAtFirst)
{
    const TesselAppInfo record;
    expectIs(record, L"", L"", L"", 0);
}

TEST_F(ApplicationRecordContract, CopiesItsTexts)
{
    std::wstring name = L"before";
    TesselAppInfo record;
    record.setAppName(name.c_str());
    name = L"after!";
    EXPECT_STREQ(record.appName(), L"before");
}

TEST_F(ApplicationRecordContract, ChangesNothingWhenThereIsNoSuchRecord)
{
    TesselAppInfo record;
    record.setAppName(L"ContractNone");
    record.setModuleName(L"/a/tool.bundle");
    record.setDescription(L"description");
    record.setLoadReason(TSRX_LOAD_ON_COMMAND);
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_NOT_FOUND);
    expectIs(record, L"ContractNone", L"/a/tool.bundle", L"description", TSRX_LOAD_ON_COMMAND);
}

TEST_F(ApplicationRecordContract, ReadsWhatWasWritten)
{
    write(L"ContractTool", kBothReasons);
    TesselAppInfo record;
    record.setAppName(L"ContractTool");
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_OK);
    expectIs(record, L"ContractTool", L"/a/\u00FC tool.bundle", L"Tool Command Module", kBothReasons);
}

TEST_F(ApplicationRecordContract, FindsARecordInAnyLetterCaseAndKeepsItsOwnName)
{
    write(L"ContractTool", kBothReasons);
    TesselAppInfo record;
    record.setAppName(L"CONTRACTTOOL");
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_OK);
    EXPECT_STREQ(record.appName(), L"CONTRACTTOOL");
    EXPECT_EQ(record.loadReason(), kBothReasons);
}

TEST_F(ApplicationRecordContract, ReplacesARecord)
{
    write(L"ContractTool", kBothReasons);
    write(L"contracttool", TSRX_LOAD_ON_COMMAND);
    TesselAppInfo record;
    record.setAppName(L"ContractTool");
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_OK);
    EXPECT_EQ(record.loadReason(), TSRX_LOAD_ON_COMMAND);
}

TEST_F(ApplicationRecordContract, KeepsRecordsApart)
{
    write(L"ContractOne", TSRX_LOAD_AT_HOST_START);
    write(L"ContractTwo", TSRX_LOAD_ON_COMMAND);
    TesselAppInfo record;
    record.setAppName(L"ContractOne");
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_OK);
    EXPECT_EQ(record.loadReason(), TSRX_LOAD_AT_HOST_START);
}

TEST_F(ApplicationRecordContract, RefusesARecordWithoutAName)
{
    TesselAppInfo record;
    record.setModuleName(L"/a/tool.bundle");
    EXPECT_EQ(record.readFromRegistry(), TSRX_APPINFO_ERROR);
    EXPECT_EQ(record.writeToRegistry(false, true), TSRX_APPINFO_ERROR);
}
} // namespace
