#include "host/lisp/CompilerProgram.h"

#include <cstdio>
#include <filesystem>
#include <iostream>
#include <sstream>
#include <string>
#include <system_error>

#include <CLI/CLI.hpp>

#include "host/lisp/CompiledLisp.h"
#include "host/lisp/LispFile.h"
#include "host/lisp/LispMachine.h"
#include "host/platform/PartFile.h"
#include "host/platform/ProductFolders.h"
#include "host/text/ProgramHelp.h"
#include "host/text/TerminalText.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
namespace fs = std::filesystem;

constexpr int kNotCompiled = 1;
constexpr int kUnusable = 2;

constexpr auto kCompilerAfterword =
    Sentence(L"Tessel loads the compiled file as it loads the source: (load \"FILE.qbc\"). "
             L"It is for the version of Lisp\n"
             L"that this host has. Status 0: compiled; 1: the file has an error or cannot be "
             L"read or written; 2: wrong\n"
             L"arguments.");

LispSurroundings terminal()
{
    LispSurroundings surroundings;
    surroundings.write = [](std::wstring_view text)
    {
        std::cout << toUtf8(forTerminal(text)) << std::flush;
    };
    surroundings.column = []
    {
        return std::size_t{0};
    };
    return surroundings;
}

Failure notWritten(const fs::path& output, const std::wstring& reason)
{
    return {translated(L"cannot write \"{}\": {}.", output, reason)};
}

// Whole or not at all: a build that is stopped midway must not leave a file that looks finished.
Result<> writeWhole(const fs::path& output, const std::string& bytes)
{
    auto done = replacePersonsFile(output, bytes);
    return done ? done : notWritten(output, done.sentence());
}

Result<> compileFile(const fs::path& input, const fs::path& output)
{
    std::error_code error;
    if (fs::equivalent(input, output, error))
        return Failure{translated(L"\"{}\" would be overwritten by its own byte code.", input)};
    const auto file = readLispFile(toWide(input.string()), true);
    if (!file)
        return Failure{cannotLoad(toWide(input.string()), file.sentence())};
    if (file->kind == LispFile::Kind::kCompiled)
        return Failure{translated(L"\"{}\" is compiled already.", input)};
    const auto lisp = LispMachine::start(terminal());
    if (!lisp)
        return lisp.failure();
    const auto byteCode = (*lisp)->compile(file->name, file->text);
    return byteCode ? writeWhole(output, packCompiledLisp(toUtf8(*byteCode))) : byteCode.failure();
}

Result<> compileGuarded(const fs::path& input, const fs::path& output)
{
    try
    {
        return compileFile(input, output);
    }
    catch (const std::exception& exception)
    {
        return Failure{toWide(exception.what())};
    }
}
} // namespace

int runCompilerProgram(int count, const char* const* arguments)
{
    usePersonsLanguage();
    CLI::App app(translatedInUtf8(L"Compiles a Lisp file for Tessel to byte code."), "tesselc");
    app.footer(translatedInUtf8(kCompilerAfterword));
    app.set_version_flag("--version", versionLine("tesselc, the Lisp compiler of Tessel R21"),
                         translatedInUtf8(L"Show the version and end"));
    std::string input;
    std::string output;
    app.add_option(translatedInUtf8(L"FILE"), input, translatedInUtf8(L"The Lisp file (.lsp)"))->required();
    app.add_option("-o,--output", output,
                   translatedInUtf8(L"The compiled file; otherwise FILE with the extension .qbc"));
    translateHelp(app);
    try
    {
        app.parse(count, arguments);
    }
    catch (const CLI::ParseError& outcome)
    {
        std::ostringstream text;
        const bool failed = app.exit(outcome, text, text) != 0;
        (failed ? std::cerr : std::cout) << toUtf8(forTerminal(toWide(text.str())));
        return failed ? kUnusable : 0;
    }
    const auto compiled =
        compileGuarded(input, output.empty() ? fs::path(input).replace_extension(".qbc") : fs::path(output));
    if (!compiled)
        std::cerr << "tesselc: " << toUtf8(forTerminal(compiled.sentence())) << '\n';
    return compiled ? 0 : kNotCompiled;
}
} // namespace tessel
