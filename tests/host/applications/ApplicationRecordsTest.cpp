#include "host/applications/ApplicationRecords.h"

#include <gmock/gmock.h>

#include <optional>

#include <tessel/tsappinfo.h>

#include "host/commands/CallingApplication.h"
#include "host/commands/CommandStack.h"
#include "tests/host/support/RegistryHost.h"

using testing::ElementsAre;
using testing::Pair;

namespace
{
constexpr const wchar_t* kModule = L"/opt/größe 100%/Tool.bundle";

void doNothing()
{
}

class ApplicationRecords : public testing::Test
{
protected:
    ApplicationRecords()
    {
        start();
        call.emplace(calls, kModule);
    }

    // The host starts, on the registry that is open.
    void start() { records.emplace(host.layered(), commands, calls, L"Software\\Tessel\\R21"); }
    void end()
    {
        records.reset();
        host.close();
    }
    std::vector<tessel::ApplicationRecord> allRecords() const
    {
        return records ? (*records)->all() : std::vector<tessel::ApplicationRecord>();
    }

    static int store(const wchar_t* name, unsigned reasons, bool withCommands = false)
    {
        TesselAppInfo info;
        info.setAppName(name);
        info.setModuleName(kModule);
        info.setDescription(L"what it does");
        info.setLoadReason(reasons);
        return info.writeToRegistry(false, withCommands);
    }
    void addCommand(const wchar_t* global, const wchar_t* local)
    {
        EXPECT_EQ(commands.addCommand(L"GROUP", global, local, 0, doNothing, nullptr, -1, nullptr, nullptr),
                  0);
    }

    RegistryHost host;
    tessel::CallingApplication calls;
    tessel::CommandStack commands{calls};
    std::optional<tessel::Owned<tessel::ApplicationRecords>> records;
    std::optional<tessel::CallingApplication::Scope> call;
};
} // namespace

TEST_F(ApplicationRecords, ComeBackAsTheyWereStored)
{
    EXPECT_EQ(store(L"Tool", TSRX_LOAD_AT_HOST_START | TSRX_LOAD_ON_COMMAND), TSRX_APPINFO_OK);
    EXPECT_TRUE(host.registry().endOfCommand());
    end();
    host.open();
    start();
    TesselAppInfo info;
    info.setAppName(L"TOOL");
    EXPECT_EQ(info.readFromRegistry(), TSRX_APPINFO_OK);
    EXPECT_STREQ(info.appName(), L"TOOL");
    EXPECT_STREQ(info.moduleName(), kModule);
    EXPECT_STREQ(info.description(), L"what it does");
    EXPECT_EQ(info.loadReason(), 6u);
}

TEST_F(ApplicationRecords, AreEmptyAtFirst)
{
    const TesselAppInfo info;
    EXPECT_STREQ(info.appName(), L"");
    EXPECT_STREQ(info.moduleName(), L"");
    EXPECT_STREQ(info.description(), L"");
    EXPECT_EQ(info.loadReason(), 0u);
}

TEST_F(ApplicationRecords, ThatAreMissingChangeNothing)
{
    TesselAppInfo info;
    info.setAppName(L"Nobody");
    info.setModuleName(kModule);
    info.setLoadReason(4);
    EXPECT_EQ(info.readFromRegistry(), TSRX_APPINFO_NOT_FOUND);
    EXPECT_STREQ(info.moduleName(), kModule);
    EXPECT_EQ(info.loadReason(), 4u);
}

TEST_F(ApplicationRecords, AreReplacedUnderTheSameName)
{
    EXPECT_EQ(store(L"Tool", 6), TSRX_APPINFO_OK);
    EXPECT_EQ(store(L"Other", 2), TSRX_APPINFO_OK);
    EXPECT_EQ(store(L"tool", 4), TSRX_APPINFO_OK);
    const auto all = allRecords();
    ASSERT_EQ(all.size(), 2u);
    EXPECT_EQ(all[0].name, L"Tool");
    EXPECT_EQ(all[0].loadReasons, 4u);
    EXPECT_EQ(all[0].module, kModule);
    EXPECT_EQ(all[1].name, L"Other");
}

TEST_F(ApplicationRecords, HoldTheCommandsOfTheApplicationThatIsCalled)
{
    addCommand(L"TOOL", L"WERKZEUG");
    addCommand(L"BÜRO", L"BÜRO");
    {
        const tessel::CallingApplication::Scope other(calls, L"/opt/Other.bundle");
        addCommand(L"OTHER", L"OTHER");
    }
    EXPECT_EQ(store(L"Tool", 4, true), TSRX_APPINFO_OK);
    const auto all = allRecords();
    ASSERT_EQ(all.size(), 1u);
    EXPECT_THAT(all[0].commands, ElementsAre(Pair(L"TOOL", L"WERKZEUG"), Pair(L"BÜRO", L"BÜRO")));
}

TEST_F(ApplicationRecords, ForgetTheCommandsOfAnEarlierVersion)
{
    addCommand(L"OLD", L"OLD");
    EXPECT_EQ(store(L"Tool", 4, true), TSRX_APPINFO_OK);
    EXPECT_EQ(commands.removeGroup(L"GROUP"), 0);
    addCommand(L"NEW", L"NEW");
    EXPECT_EQ(store(L"Tool", 4, false), TSRX_APPINFO_OK);
    EXPECT_THAT(allRecords().at(0).commands, ElementsAre(Pair(L"OLD", L"OLD")));
    EXPECT_EQ(store(L"Tool", 4, true), TSRX_APPINFO_OK);
    EXPECT_THAT(allRecords().at(0).commands, ElementsAre(Pair(L"NEW", L"NEW")));
}

TEST_F(ApplicationRecords, NeedANameThatIsOneKey)
{
    for (const wchar_t* name : {L"", L"\\", L"a\\b", L"Tool\\Commands"})
    {
        EXPECT_EQ(store(name, 4), TSRX_APPINFO_ERROR) << name;
        TesselAppInfo info;
        info.setAppName(name);
        EXPECT_EQ(info.readFromRegistry(), TSRX_APPINFO_ERROR) << name;
    }
    EXPECT_EQ(store(nullptr, 4), TSRX_APPINFO_ERROR);
    EXPECT_TRUE(allRecords().empty());
}

TEST_F(ApplicationRecords, AreNoneWhenHalfOfThemIsMissing)
{
    const std::wstring key = L"Software\\Tessel\\R21\\Applications\\";
    EXPECT_TRUE(host.registry().write(key + L"NoReasons", L"Module", kModule));
    EXPECT_TRUE(host.registry().write(key + L"NoModule", L"LoadReasons", L"4"));
    for (const wchar_t* reasons : {L"", L"often", L"-1", L"4x", L"99999999999"})
    {
        EXPECT_TRUE(host.registry().write(key + L"Odd", L"Module", kModule));
        EXPECT_TRUE(host.registry().write(key + L"Odd", L"LoadReasons", reasons));
        EXPECT_TRUE(allRecords().empty()) << reasons;
    }
    EXPECT_EQ(store(L"Whole", 4), TSRX_APPINFO_OK);
    EXPECT_EQ(allRecords().size(), 1u);
    TesselAppInfo info;
    info.setAppName(L"Odd");
    EXPECT_EQ(info.readFromRegistry(), TSRX_APPINFO_NOT_FOUND);
}

TEST_F(ApplicationRecords, AreStoredForTheCurrentUserWhenMeantForAll)
{
    TesselAppInfo info;
    info.setAppName(L"Tool");
    info.setModuleName(kModule);
    EXPECT_EQ(info.writeToRegistry(true, false), TSRX_APPINFO_OK);
    EXPECT_EQ(allRecords().size(), 1u);
}

TEST_F(ApplicationRecords, FailWhereTheRegistryMayNotBeWritten)
{
    EXPECT_EQ(store(L"Tool", 4), TSRX_APPINFO_OK);
    end();
    EXPECT_EQ(store(L"Tool", 4), TSRX_APPINFO_ERROR);
    EXPECT_TRUE(allRecords().empty());
    std::filesystem::permissions(host.file(), std::filesystem::perms::owner_read);
    host.open();
    start();
    EXPECT_EQ(store(L"Tool", 6), TSRX_APPINFO_ERROR);
    EXPECT_EQ(store(L"Tool", 6, true), TSRX_APPINFO_ERROR);
    ASSERT_EQ(allRecords().size(), 1u);
    EXPECT_EQ(allRecords()[0].loadReasons, 4u);
}

TEST_F(ApplicationRecords, CopyTheirTexts)
{
    TesselAppInfo info;
    std::wstring text = L"a text that is long enough to be kept elsewhere";
    info.setDescription(text.c_str());
    text[0] = L'?';
    EXPECT_STREQ(info.description(), L"a text that is long enough to be kept elsewhere");
    info.setDescription(nullptr);
    EXPECT_STREQ(info.description(), L"");
}
