#include <tessel/tsdocument.h>
#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>
#include <tessel/tshostservices.h>
#include <tessel/tsmessagebox.h>
#include <tessel/tsrxlinker.h>
#include <wincompat/winreg.h>

#include "tests/contract/ContractTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class ServicesContract : public ContractTest
{
protected:
    static std::vector<std::wstring> documentApplications()
    {
        std::vector<std::wstring> names;
        for (int index = 0; index < curDoc()->loadedApplicationCount(); ++index)
            names.emplace_back(curDoc()->loadedApplicationName(index));
        return names;
    }
};

TEST_F(ServicesContract, FindsServicesByTheirNames)
{
    TsRxObject* linker = tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER);
    TsRxObject* commands = tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS);
    EXPECT_EQ(static_cast<TsRxObject*>(TsRxDynamicLinker::cast(linker)), linker);
    EXPECT_EQ(static_cast<TsRxObject*>(TsEdCommandStack::cast(commands)), commands);
    EXPECT_NE(linker, nullptr);
    EXPECT_NE(commands, nullptr);
}

TEST_F(ServicesContract, HasNoServiceOfAnotherName)
{
    EXPECT_EQ(tsrxSysRegistry()->at(L"ContractNone"), nullptr);
    EXPECT_EQ(tsrxSysRegistry()->at(L"dynamiclinker"), nullptr); // case matters
    EXPECT_EQ(tsrxSysRegistry()->at(L""), nullptr);
}

TEST_F(ServicesContract, CastsNothingToAnotherClass)
{
    EXPECT_EQ(TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS)), nullptr);
    EXPECT_EQ(TsEdCommandStack::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER)), nullptr);
    EXPECT_EQ(TsRxDynamicLinker::cast(nullptr), nullptr);
    EXPECT_EQ(TsEdCommandStack::cast(nullptr), nullptr);
}

TEST_F(ServicesContract, NamesTheProductAndItsKey)
{
    TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    ASSERT_NE(services, nullptr);
    EXPECT_STREQ(services->product(), L"Tessel");
    EXPECT_STREQ(services->productRegistryRoot(), L"Software\\Tessel\\R21");
}

TEST_F(ServicesContract, NamesTheFolderOfTheProfileByItsFullPath)
{
    EXPECT_EQ(tsdbHostApplicationServices()->profileFolder()[0], L'/');
}

TEST_F(ServicesContract, HasACurrentProfileFromItsFirstStart)
{
    const std::wstring profiles =
        std::wstring(tsdbHostApplicationServices()->productRegistryRoot()) + L"\\Profiles";
    HKEY key = nullptr;
    ASSERT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, profiles.c_str(), 0, KEY_READ, &key), ERROR_SUCCESS);
    wchar_t name[kPathSize] = {};
    DWORD size = sizeof name;
    DWORD type = 0;
    EXPECT_EQ(tsRegGetValue(key, L"", 0, &type, name, &size), ERROR_SUCCESS);
    EXPECT_STRNE(name, L"");
    RegCloseKey(key);
}

TEST_F(ServicesContract, ShowsAMessageAndAnswersItsButton)
{
    VqHostMessageBox* box = VqHostMessageBox::simple();
    ASSERT_NE(box, nullptr);
    EXPECT_EQ(box->show(L"100%s \u00FC of /a/tool.lsp", MB_OK | MB_ICONEXCLAMATION, nullptr), IDOK);
    EXPECT_TRUE(contains(host->seen(), L"100%s \u00FC of /a/tool.lsp"));
}

TEST_F(ServicesContract, KnowsWhichHelpTopicsThereAre)
{
    EXPECT_TRUE(tsedHelp(nullptr, L"load_unload_applications_dialog", 0));
    EXPECT_FALSE(tsedHelp(nullptr, L"contract_none", 0));
}

TEST_F(ServicesContract, ListsTheApplicationsOfTheDocumentInOrder)
{
    ASSERT_NE(curDoc(), nullptr);
    EXPECT_THAT(documentApplications(), IsEmpty());
    const std::wstring first = host->loadLispFile(L"zebra.lsp");
    const std::wstring second = host->loadLispFile(L"apple.lsp");
    EXPECT_THAT(documentApplications(), ElementsAre(first, second));
}

TEST_F(ServicesContract, HasNoApplicationOutsideTheRange)
{
    host->loadLispFile(L"tool.lsp");
    EXPECT_EQ(curDoc()->loadedApplicationName(-1), nullptr);
    EXPECT_EQ(curDoc()->loadedApplicationName(1), nullptr);
    EXPECT_NE(curDoc()->loadedApplicationName(0), nullptr);
}

TEST_F(ServicesContract, ReadsAVariableInAnyLetterCase)
{
    host->setVariable(L"LISPENABLED", RecordingValue::Short(0));
    TsResultBuffer value = {};
    EXPECT_EQ(tsedGetVar(L"LispEnabled", &value), TS_NORMAL);
    EXPECT_EQ(value.type, TS_SHORT);
    EXPECT_EQ(value.value.shortNumber, 0);
    host->setVariable(L"LISPENABLED", RecordingValue::Short(1));
    EXPECT_EQ(tsedGetVar(L"LISPENABLED", &value), TS_NORMAL);
    EXPECT_EQ(value.value.shortNumber, 1);
}

TEST_F(ServicesContract, HandsOverTheTextOfAVariable)
{
    host->setVariable(L"SEARCHPATH", RecordingValue::String(L"/a/\u00FC b"));
    TsResultBuffer value = {};
    ASSERT_EQ(tsedGetVar(L"SEARCHPATH", &value), TS_NORMAL);
    ASSERT_EQ(value.type, TS_STRING);
    EXPECT_EQ(value.next, nullptr);
    EXPECT_STREQ(value.value.string, L"/a/\u00FC b");
    delete[] value.value.string;
}

TEST_F(ServicesContract, LeavesTheResultAloneForAVariableThatIsMissing)
{
    TsResultBuffer value = {nullptr, TS_SHORT, {}};
    value.value.shortNumber = 7;
    EXPECT_EQ(tsedGetVar(L"CONTRACTNONE", &value), TS_ERROR);
    EXPECT_EQ(value.type, TS_SHORT);
    EXPECT_EQ(value.value.shortNumber, 7);
}
} // namespace
