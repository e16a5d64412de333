#include "host/lisp/CompilerProgram.h"

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <string>
#include <system_error>

#include <CLI/CLI.hpp>

#include "host/lisp/CompiledLisp.h"
#include "host/lisp/LispFile.h"
#include "host/lisp/LispMachine.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
namespace fs = std::filesystem;

constexpr int kNotCompiled = 1;
constexpr int kWrongArguments = 2;

constexpr char kAfterword[] = "Tessel loads the compiled file as it loads the source: (load \"FILE.qbc\"). "
                              "It is for the version of Lisp\n"
                              "that this host has. Status 0: compiled; 1: the file has an error or cannot be "
                              "read or written; 2: wrong\n"
                              "arguments.";

int fail(const std::string& sentence)
{
    std::cerr << "tesselc: " << sentence << '\n';
    return kNotCompiled;
}

LispSurroundings terminal()
{
    LispSurroundings surroundings;
    surroundings.write = [](std::wstring_view text)
    {
        std::cout << toUtf8(text) << std::flush;
    };
    surroundings.column = []
    {
        return std::size_t{0};
    };
    return surroundings;
}

// Whole or not at all: a build that is stopped midway must not leave a file that looks finished.
int writeWhole(const fs::path& output, const std::string& bytes)
{
    const fs::path part = output.string() + ".part";
    errno = 0;
    std::ofstream stream(part, std::ios::binary);
    stream << bytes;
    stream.close();
    std::error_code error(stream.fail() ? errno : 0, std::generic_category());
    if (!error)
        fs::rename(part, output, error);
    if (!error)
        return 0;
    std::error_code ignored; // what went wrong first is what is told
    fs::remove(part, ignored);
    return fail("cannot write \"" + output.string() + "\": " + error.message() + ".");
}

int compileFile(const fs::path& input, const fs::path& output)
{
    std::error_code error;
    if (fs::equivalent(input, output, error))
        return fail("\"" + input.string() + "\" would be overwritten by its own byte code.");
    const LispFile file = readLispFile(toWide(input.string()), true);
    if (file.kind == LispFile::Kind::kCompiled)
        return fail("\"" + input.string() + "\" is compiled already.");
    if (file.kind != LispFile::Kind::kSource)
        return fail(toUtf8(file.text));
    LispMachine lisp(terminal());
    const LispAnswer answer = lisp.compile(file.name, file.text);
    if (!answer.ok)
        return fail(toUtf8(answer.text));
    return writeWhole(output, packCompiledLisp(toUtf8(answer.text)));
}

int compileGuarded(const fs::path& input, const fs::path& output)
{
    try
    {
        return compileFile(input, output);
    }
    catch (const std::exception& exception)
    {
        return fail(exception.what());
    }
}
} // namespace

int runCompilerProgram(int count, const char* const* arguments)
{
    CLI::App app("Compiles a Lisp file for Tessel to byte code.", "tesselc");
    app.footer(kAfterword);
    std::string input;
    std::string output;
    app.add_option("FILE", input, "The Lisp file (.lsp)")->required();
    app.add_option("-o,--output", output, "The compiled file; otherwise FILE with the extension .qbc");
    try
    {
        app.parse(count, arguments);
    }
    catch (const CLI::ParseError& outcome)
    {
        return app.exit(outcome) == 0 ? 0 : kWrongArguments;
    }
    return compileGuarded(input,
                          output.empty() ? fs::path(input).replace_extension(".qbc") : fs::path(output));
}
} // namespace tessel
