#include "tests/support/ModuleTest.h"

#include <algorithm>

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"

namespace
{
constexpr unsigned kMessagesWithArgument[] = {ModrigMessages::kCannotLoadFile,
                                              ModrigMessages::kModuleLocked,
                                              ModrigMessages::kOneLoaded,
                                              ModrigMessages::kManyLoaded,
                                              ModrigMessages::kOneAddedToStartupSuite,
                                              ModrigMessages::kManyAddedToStartupSuite,
                                              ModrigMessages::kOneUnloaded,
                                              ModrigMessages::kManyUnloaded,
                                              ModrigMessages::kListNotStored,
                                              ModrigMessages::kFilterNotStored,
                                              ModrigMessages::kOneRemovedFromHistory,
                                              ModrigMessages::kManyRemovedFromHistory,
                                              ModrigMessages::kTooManyFiles,
                                              ModrigMessages::kLoadFailed,
                                              ModrigMessages::kUrlNotFetched,
                                              ModrigMessages::kTemporaryInternetFile,
                                              ModrigMessages::kAlreadyLoaded,
                                              ModrigMessages::kDialogFailed};

RecordingResources::Texts TestTexts()
{
    RecordingResources::Texts texts = {
        {ModrigMessages::kOpenPanelTitle, L"Load"},
        {ModrigMessages::kStartupSuitePanelTitle, L"Add"},
        {ModrigMessages::kLispPrompt, L"Command:"},
        {ModrigMessages::kCommandGroup, L"GROUP"},
        {ModrigMessages::kCommandGlobalName, L"GLOBALNAME"},
        {ModrigMessages::kCommandLocalName, L"LOCALNAME"},
        {ModrigMessages::kAllApplicationsFilter, L"R%d %s|*.bundle;*.exe;*.LSP"},
        {ModrigMessages::kBundleFilter, L"Bundles|*.bundle"},
    };
    for (const unsigned id : kMessagesWithArgument)
        texts[id] = L"[" + std::to_wstring(id) + L"] %s";
    return texts;
}
} // namespace

void ModuleTest::SetUp()
{
    host().reset();
    recordingDialog().reset();
    for (CStringList* list : {&gLoadedAppList, &gStartupList, &gHistoryList})
        list->RemoveAll();
    gbOrreryLoaded = false;
    hModrigRes = nullptr;
    CTemporaryResourceOverride::m_hInstanceDefault = nullptr;
    host().resources.addModule(kResourceModuleName, TestTexts());
    host().resources.current = host().resources.load(kResourceModuleName);
}

void ModuleTest::TearDown()
{
    CTemporaryResourceOverride::ReleaseDefaultResource();
}

std::wstring Message(unsigned id, const std::wstring& argument)
{
    return L"[" + std::to_wstring(id) + L"] " + argument;
}

std::vector<std::wstring> Texts(const CStringList& list)
{
    std::vector<std::wstring> texts;
    for (const CStdStr& text : list)
        texts.push_back(text.Text());
    return texts;
}

void Fill(CStringList& list, std::initializer_list<const wchar_t*> texts)
{
    for (const wchar_t* text : texts)
        list.AddTail(text);
}

std::wstring LongPath(std::size_t length, const std::wstring& tail)
{
    constexpr std::size_t kFolderLength = 200;
    std::wstring path;
    while (path.size() + tail.size() + kFolderLength < length)
        path += L"/" + std::wstring(kFolderLength - 1, L'f');
    return path + L"/" + std::wstring(length - path.size() - tail.size() - 2, L'g') + L"/" + tail;
}

std::vector<std::wstring> WithoutBookkeeping(const std::vector<std::wstring>& journal)
{
    std::vector<std::wstring> kept = journal;
    std::erase_if(kept,
                  [](const std::wstring& entry)
                  {
                      static constexpr const wchar_t* kNames[] = {L"Reg",      L"tsReg",      L"tsudReg",
                                                                  L"tsdbHost", L"tsedGetVar", L"AfxGet"};
                      return std::any_of(std::begin(kNames), std::end(kNames),
                                         [&entry](const wchar_t* name) { return entry.starts_with(name); });
                  });
    return kept;
}
