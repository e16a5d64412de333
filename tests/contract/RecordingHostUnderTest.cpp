// The recording host, held to the same contract as a real one.
#include "tests/contract/HostUnderTest.h"
#include "tests/contract/modules/Behaviours.h"
#include "tests/support/RecordingHost.h"

namespace
{
constexpr const wchar_t* kFolder = L"/contract/";
constexpr const wchar_t* kServer = L"http://contract.test/";

RecordingLinker::EntryPoint entryPoint(ContractModule behaviour)
{
    using namespace contract_modules;
    switch (behaviour)
    {
    case ContractModule::kRefusesToLoad:
        return refusesToLoad;
    case ContractModule::kRefusesToUnload:
        return refusesToUnload;
    case ContractModule::kLocksItself:
        return locksItself;
    case ContractModule::kRegistersItself:
        return registersItself;
    case ContractModule::kTellsItsName:
    case ContractModule::kStaysMapped:
        return tellsItsName;
    default:
        return plain;
    }
}

class RecordingHostUnderTest final : public HostUnderTest
{
public:
    RecordingHostUnderTest()
    {
        recordingHost().reset();
        recordingHost().output.helpTopics = {{L"load_unload_applications_dialog"}};
        recordingHost().linker.loadOnlyKnown();
        setVariable(L"LISPENABLED", RecordingValue::Short(1));
    }

    std::wstring makeFile(const std::wstring& name) override
    {
        recordingHost().files.addFile(kFolder + name);
        return kFolder + name;
    }

    std::wstring makeReadOnlyFile(const std::wstring& name) override
    {
        recordingHost().files.addFile(kFolder + name, FILE_ATTRIBUTE_READONLY);
        return kFolder + name;
    }

    std::wstring makePipe(const std::wstring& name) override
    {
        recordingHost().files.addFile(kFolder + name, FILE_ATTRIBUTE_DEVICE);
        return kFolder + name;
    }

    std::wstring makeFolder(const std::wstring& name) override
    {
        recordingHost().files.addFolder(kFolder + name);
        return kFolder + name;
    }

    void enterFolder(const std::wstring& path) override { recordingHost().files.currentFolder = path; }

    std::wstring makeResourceModule(const std::wstring& name,
                                    const std::map<unsigned, std::wstring>& texts) override
    {
        recordingHost().resources.addModule(kFolder + name, texts);
        return kFolder + name;
    }

    std::wstring makeTranslatedModule(const std::wstring& name,
                                      const std::vector<std::map<unsigned, std::wstring>>& texts) override
    {
        std::map<unsigned, std::wstring> found;
        for (const auto& ofALanguage : texts)
            found.insert(ofALanguage.begin(), ofALanguage.end());
        return makeResourceModule(name, found);
    }

    std::wstring makeModule(const std::wstring& name, ContractModule behaviour) override
    {
        recordingHost().linker.setEntryPoint(kFolder + name, entryPoint(behaviour));
        if (behaviour == ContractModule::kStaysMapped)
            recordingHost().linker.keepMapped(kFolder + name);
        return kFolder + name;
    }

    std::wstring serve(const std::wstring& name) override
    {
        recordingHost().applicationServices.remotes[kServer + name] = {TS_FETCHED,
                                                                       kFolder + (L"copies/" + name)};
        return kServer + name;
    }

    void stopServing(const std::wstring& name) override
    {
        recordingHost().applicationServices.remotes.erase(kServer + name);
    }

    void setVariable(const std::wstring& name, const RecordingValue& value) override
    {
        recordingHost().variables.set(name, value);
    }

    void searchIn(const std::vector<std::wstring>& folders) override
    {
        recordingHost().files.searchFolders = folders;
    }

    std::wstring loadLispFile(const std::wstring& name) override
    {
        recordingHost().document.applications.push_back(kFolder + name);
        return kFolder + name;
    }

    bool type(const std::wstring& command) override { return recordingHost().commands.type(command); }

    void typeScript(const std::vector<std::wstring>& lines) override
    {
        recordingHost().questions.answers.assign(lines.begin() + 1, lines.end());
        recordingHost().questions.answers.emplace_back(); // the input ends
        recordingHost().commands.type(lines.front());
        recordingHost().questions.answers.clear();
    }

    void becomeIdle() override { recordingHost().lisp.runQueued(); }

    void tellLisp(const std::wstring& expression, const std::optional<std::wstring>& prints) override
    {
        recordingHost().lisp.setEvaluation(expression,
                                           [prints]
                                           {
                                               if (prints)
                                                   recordingHost().output.printed += *prints;
                                               else
                                                   recordingHost().output.say(L"Lisp error.");
                                           });
    }

    void defineLisp(const std::wstring& name, const std::wstring&, const StandIn& standIn) override
    {
        recordingHost().lisp.setFunction(name,
                                         [standIn](const Values& arguments)
                                         {
                                             std::optional<Values> values = standIn(arguments);
                                             if (!values)
                                                 recordingHost().output.say(L"Lisp error.");
                                             return values;
                                         });
    }

    std::wstring seen() const override
    {
        std::wstring all = recordingHost().output.printed;
        for (const std::wstring& box : recordingHost().output.boxTexts())
            all += L"Message: " + box + L"\n";
        return all;
    }
};
} // namespace

std::unique_ptr<HostUnderTest> startHost()
{
    return std::make_unique<RecordingHostUnderTest>();
}
