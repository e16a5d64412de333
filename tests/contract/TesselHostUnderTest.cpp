// The reference host, in this process, with its profile and the test's files in a throwaway folder.
#include <sys/stat.h>

#include <cstdlib>
#include <set>
#include <stdexcept>

#include "host/app/Host.h"
#include "host/text/Unicode.h"
#include "tests/contract/HostUnderTest.h"
#include "tests/support/HttpServer.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
namespace fs = std::filesystem;

fs::path toPath(const std::wstring& text)
{
    return tessel::toUtf8(text);
}

std::wstring toText(const fs::path& path)
{
    return tessel::toWide(path.string());
}

const char* libraryOf(ContractModule behaviour)
{
    switch (behaviour)
    {
    case ContractModule::kRefusesToLoad:
        return CONTRACT_MODULE_refusesToLoad;
    case ContractModule::kRefusesToUnload:
        return CONTRACT_MODULE_refusesToUnload;
    case ContractModule::kLocksItself:
        return CONTRACT_MODULE_locksItself;
    case ContractModule::kRegistersItself:
        return CONTRACT_MODULE_registersItself;
    case ContractModule::kTellsItsName:
        return CONTRACT_MODULE_tellsItsName;
    case ContractModule::kStaysMapped:
        return CONTRACT_MODULE_staysMapped;
    default:
        return CONTRACT_MODULE_plain;
    }
}

// A string of a resource script.
std::string quoted(const std::wstring& text)
{
    std::string result = "\"";
    for (const char character : tessel::toUtf8(text))
        result += character == '"' ? std::string("\"\"") : std::string(1, character);
    return result + "\"";
}

void run(const std::string& command)
{
    if (std::system((command + " >/dev/null").c_str()) != 0)
        throw std::runtime_error("failed: " + command);
}

class TesselHostUnderTest : public HostUnderTest
{
public:
    TesselHostUnderTest() : mHost(options())
    {
        if (!mHost.start())
            throw std::runtime_error("the host does not start: " + mOutput);
    }

    ~TesselHostUnderTest() override
    {
        mHost.end();
        fs::current_path(mFolderBefore); // the test's own is about to go
    }

    std::wstring makeFile(const std::wstring& name) override
    {
        return toText(mFolder.write(toPath(name), ""));
    }

    std::wstring makeReadOnlyFile(const std::wstring& name) override
    {
        const fs::path file = mFolder.write(toPath(name), "");
        fs::permissions(file, fs::perms::owner_read);
        return toText(file);
    }

    std::wstring makePipe(const std::wstring& name) override
    {
        const fs::path pipe = mFolder / toPath(name);
        if (mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR) != 0)
            throw std::runtime_error("there can be no pipe: " + pipe.string());
        return toText(pipe);
    }

    std::wstring makeFolder(const std::wstring& name) override
    {
        const fs::path folder = mFolder / toPath(name);
        fs::create_directories(folder);
        return toText(folder);
    }

    void enterFolder(const std::wstring& path) override { fs::current_path(toPath(path)); }

    std::wstring makeResourceModule(const std::wstring& name,
                                    const std::map<unsigned, std::wstring>& texts) override
    {
        return makeTranslatedModule(name, {texts});
    }

    std::wstring makeTranslatedModule(const std::wstring& name,
                                      const std::vector<std::map<unsigned, std::wstring>>& texts) override
    {
        // Languages of the south of Africa, from the largest number to the smallest.
        static constexpr unsigned kLanguages[] = {54, 53, 52};
        std::string script;
        for (std::size_t i = 0; i < texts.size(); ++i)
        {
            script += "LANGUAGE " + std::to_string(kLanguages[i]) + ", 1\nSTRINGTABLE\nBEGIN\n";
            for (const auto& [id, text] : texts[i])
                script += std::to_string(id) + " " + quoted(text) + "\n";
            script += "END\n";
        }
        mFolder.write("texts.rc", script);
        const fs::path module = mFolder / toPath(name);
        // Relative names: an absolute one can be read as an option.
        const std::string inFolder = "cd " + mFolder.path().string() + " && ";
        run(inFolder + RESOURCE_COMPILER " /no-preprocess /C 65001 /FO texts.res texts.rc");
        run(inFolder + RESOURCE_LINKER " /dll /noentry /machine:x64 /implib:texts.lib /out:" +
            toPath(name).string() + " texts.res");
        return toText(module);
    }

    std::wstring makeModule(const std::wstring& name, ContractModule behaviour) override
    {
        const fs::path module = mFolder / toPath(name);
        fs::copy_file(libraryOf(behaviour), module);
        return toText(module);
    }

    std::wstring serve(const std::wstring& name) override
    {
        mServed.insert(tessel::toUtf8(L"/" + name));
        return mServer.url(L"/" + name);
    }

    void stopServing(const std::wstring& name) override { mServed.erase(tessel::toUtf8(L"/" + name)); }

    void setVariable(const std::wstring& name, const RecordingValue& value) override
    {
        const std::wstring text = value.type == TS_STRING ? value.text : std::to_wstring(value.number);
        if (!mHost.run(L"SETVAR " + name + L" \"" + text + L"\""))
            throw std::runtime_error("a variable cannot be set: " + mOutput);
    }

    void searchIn(const std::vector<std::wstring>& folders) override
    {
        std::wstring path;
        for (const std::wstring& folder : folders)
            path += folder + L";";
        setVariable(L"SEARCHPATH", RecordingValue::String(path));
    }

    std::wstring loadLispFile(const std::wstring& name) override
    {
        const std::wstring file = toText(mFolder.write(toPath(name), "(setq contract-loaded t)\n"));
        if (!mHost.run(L"LOAD \"" + file + L"\""))
            throw std::runtime_error("a Lisp file cannot be loaded: " + mOutput);
        return file;
    }

    bool type(const std::wstring& command) override { return mHost.run(command); }

    void typeScript(const std::vector<std::wstring>& lines) override
    {
        std::string script;
        for (const std::wstring& line : lines)
            script += tessel::toUtf8(line) + "\n";
        const std::wstring file = toText(mFolder.write("answers.script", script));
        mHost.run(L"SCRIPT \"" + file + L"\""); // a line that answers nothing may be no command
    }

    // Any line will do: what is queued is evaluated after it.
    void becomeIdle() override { mHost.run(L"(princ)"); }

    void tellLisp(const std::wstring&, const std::optional<std::wstring>&) override {}

    void defineLisp(const std::wstring&, const std::wstring& definition, const StandIn&) override
    {
        if (!mHost.run(definition))
            throw std::runtime_error("a Lisp function cannot be defined: " + mOutput);
    }

    std::wstring seen() const override { return tessel::toWide(mOutput); }

private:
    tessel::HostOptions options()
    {
        // Without a display a message box and a page of the help book are text, and nobody has to answer.
        unsetenv("DISPLAY");
        unsetenv("WAYLAND_DISPLAY");
        return {.profileFolder = mFolder / "profile",
                .safe = true, // the product's own plug-ins stay out of the way
                .output = [this](std::string_view text)
                {
                    mOutput += text;
                }};
    }

    HttpServer::Answer answerTo(const std::string& target) const
    {
        const bool isServed = mServed.contains(target);
        return {httpAnswer(isServed ? "200 OK" : "404 Not Found", target), "", {}};
    }

    fs::path mFolderBefore = fs::current_path();
    TemporaryFolder mFolder;
    std::string mOutput;
    tessel::Host mHost;
    std::set<std::string> mServed; // changed only between requests
    HttpServer mServer{[this](const std::string& target)
                       {
                           return answerTo(target);
                       }};
};
} // namespace

std::unique_ptr<HostUnderTest> startHost()
{
    return std::make_unique<TesselHostUnderTest>();
}
