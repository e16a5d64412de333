// The host that the contract tests run against. The tests see it through the SDK alone; what the SDK has no
// call for, a test asks for here. Whoever writes another host implements this class and links the tests.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "tests/support/recording/RecordingValue.h"

// What a compiled application does (modules/Behaviours.h).
enum class ContractModule
{
    kPlain,
    kRefusesToLoad,
    kRefusesToUnload,
    kLocksItself,
    kRegistersItself,
    kTellsItsName,
    kStaysMapped // does what kTellsItsName does; the system never takes its library out of the process
};

class HostUnderTest
{
public:
    HostUnderTest() = default;
    HostUnderTest(const HostUnderTest&) = delete;
    HostUnderTest& operator=(const HostUnderTest&) = delete;
    virtual ~HostUnderTest() = default; // ends the host

    // Files of the machine the host runs on. Names are relative to a folder of the test's own; the answer is
    // the full path.
    virtual std::wstring makeFile(const std::wstring& name) = 0;
    virtual std::wstring makeReadOnlyFile(const std::wstring& name) = 0;
    virtual std::wstring makePipe(const std::wstring& name) = 0;
    virtual std::wstring makeFolder(const std::wstring& name) = 0;
    virtual void enterFolder(const std::wstring& path) = 0;

    // A file that holds the texts, made so that `LoadLibrary` opens it by the path answered.
    virtual std::wstring makeResourceModule(const std::wstring& name,
                                            const std::map<unsigned, std::wstring>& texts) = 0;
    // The same with texts in several languages, none of which is the person's.
    virtual std::wstring makeTranslatedModule(const std::wstring& name,
                                              const std::vector<std::map<unsigned, std::wstring>>& texts) = 0;

    // A compiled application, not loaded yet.
    virtual std::wstring makeModule(const std::wstring& name, ContractModule behaviour) = 0;

    // A file on a web server that the host can reach; the answer is its URL.
    virtual std::wstring serve(const std::wstring& name) = 0;
    // The server has no such file any more.
    virtual void stopServing(const std::wstring& name) = 0;

    virtual void setVariable(const std::wstring& name, const RecordingValue& value) = 0;
    virtual void searchIn(const std::vector<std::wstring>& folders) = 0;

    // Loads a Lisp file without an error into the current document.
    virtual std::wstring loadLispFile(const std::wstring& name) = 0;

    // Types a command; false when the host knows none of that name.
    virtual bool type(const std::wstring& command) = 0;
    // Runs a script whose first line is a command, and the others what it asks for.
    virtual void typeScript(const std::vector<std::wstring>& lines) = 0;
    // Lets the host evaluate what Lisp is queued.
    virtual void becomeIdle() = 0;

    // A host without Lisp is told here what an expression prints, or (nothing) that it is an error. A host
    // with Lisp knows by itself.
    virtual void tellLisp(const std::wstring& expression, const std::optional<std::wstring>& prints) = 0;
    // Makes a Lisp function: a host with Lisp evaluates the definition, one without calls the stand-in.
    using Values = std::vector<RecordingValue>;
    using StandIn = std::function<std::optional<Values>(const Values& arguments)>;
    virtual void defineLisp(const std::wstring& name, const std::wstring& definition,
                            const StandIn& standIn) = 0;

    // Everything that the user has seen so far: the command line and, without a display, the boxes.
    virtual std::wstring seen() const = 0;
};

// A host as it is after its very first start, with no application loaded. One at a time.
std::unique_ptr<HostUnderTest> startHost();
