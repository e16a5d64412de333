#include <array>
#include <fstream>
#include <iterator>

#include <gmock/gmock.h>

#include <sys/stat.h>

#include "host/lisp/CompilerProgram.h"
#include "tests/host/lisp/LispSession.h"
#include "tests/support/TemporaryFolder.h"

using testing::AnyOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace
{
constexpr char kApplication[] = "(defmacro twice (x) `(* 2 ,x))\n"
                                "(defun double (x) (twice x))\n"
                                "(defvar *size* \"größe\")\n"
                                "(write-line *size*)\n";

struct CompilerRun
{
    int status;
    std::string output;
    std::string errors;
};

CompilerRun tesselc(std::vector<std::string> arguments)
{
    arguments.insert(arguments.begin(), "tesselc");
    std::vector<const char*> pointers;
    for (const auto& argument : arguments)
        pointers.push_back(argument.c_str());
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    const int status = tessel::runCompilerProgram(static_cast<int>(pointers.size()), pointers.data());
    std::string output = testing::internal::GetCapturedStdout();
    return {status, output, testing::internal::GetCapturedStderr()};
}

std::string bytesOf(const std::filesystem::path& path)
{
    std::ifstream stream(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

class LispCompiler : public testing::Test
{
protected:
    std::string write(const std::string& name, std::string_view content)
    {
        return folder.write(name, content).string();
    }
    std::string compile(const std::string& name, std::string_view content)
    {
        const auto source = write(name + ".lsp", content);
        const auto run = tesselc({source});
        EXPECT_EQ(run.status, 0) << run.errors;
        return (folder / (name + ".qbc")).string();
    }
    static std::string load(const std::string& path) { return "(load \"" + path + "\")"; }

    TemporaryFolder folder;
};
} // namespace

TEST_F(LispCompiler, MakesAFileThatDoesWhatTheSourceDoes)
{
    const auto compiled = compile("app", kApplication);
    LispSession session;
    EXPECT_EQ(session.value(load(compiled)), "T");
    EXPECT_EQ(session.output(), "größe\n");
    EXPECT_EQ(session.value("(double 21)"), "42");
    EXPECT_EQ(session.value("(twice 4)"), "8");
    EXPECT_THAT(session.documentNames(), ElementsAre(compiled));
}

TEST_F(LispCompiler, TakesClassesStructuresClosuresAndPackages)
{
    const auto compiled =
        compile("app", "(defpackage \"APP\" (:use \"CL\"))\n(in-package \"APP\")\n"
                       "(defstruct point x y)\n(defclass circle () ((r :initform 3 :reader r)))\n"
                       "(defmethod area ((c circle)) (* 3 (r c) (r c)))\n"
                       "(let ((count 0)) (defun next () (incf count)))\n"
                       "(defconstant +table+ '(1 \"a\" #\\b 2.5d0 1/3 #c(1 2) :key #(1 2)))\n");
    LispSession session;
    session.value(load(compiled));
    EXPECT_EQ(session.value("(app::point-x (app::make-point :x 7))"), "7");
    EXPECT_EQ(session.value("(app::area (make-instance 'app::circle))"), "27");
    EXPECT_EQ(session.value("(list (app::next) (app::next))"), "(1 2)");
    EXPECT_EQ(session.value("app::+table+"), "(1 \"a\" #\\b 2.5d0 1/3 #C(1 2) :KEY #(1 2))");
    EXPECT_EQ(session.value("(package-name *package*)"), "\"TESSEL-USER\"");
}

TEST_F(LispCompiler, DoesNotRunTheFileItself)
{
    const auto run = tesselc({write("app.lsp", "(write-line \"now\")")});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.output + run.errors, "");
}

TEST_F(LispCompiler, KeepsTheLinesForErrors)
{
    const auto compiled = compile("app", "(defun a () 1)\n\n(unknown\n 1)\n");
    LispSession session;
    EXPECT_EQ(session.error(load(compiled)), compiled + ":3: The function UNKNOWN is undefined.");
    EXPECT_THAT(session.documentNames(), IsEmpty());
}

TEST_F(LispCompiler, IsIndependentOfWhereTheSourceLies)
{
    const auto first = compile("app", kApplication);
    EXPECT_EQ(bytesOf(first).find(folder.path().string()), std::string::npos);
}

TEST_F(LispCompiler, WritesWhereItIsTold)
{
    const auto source = write("app.lsp", kApplication);
    const auto target = (folder / "other.bin.qbc").string();
    EXPECT_EQ(tesselc({source, "-o", target}).status, 0);
    EXPECT_TRUE(std::filesystem::exists(target));
    EXPECT_FALSE(std::filesystem::exists(folder / "app.qbc"));
}

TEST_F(LispCompiler, NamesTheLineOfAnErrorAndWritesNothing)
{
    const auto source = write("bad.lsp", "(defun a () 1)\n(defun b ()\n");
    const auto run = tesselc({source});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.errors, "tesselc: " + source + ":2: The form that begins here is never closed.\n");
    EXPECT_FALSE(std::filesystem::exists(folder / "bad.qbc"));
}

TEST_F(LispCompiler, TellsWhyItCannotReadOrWrite)
{
    const auto source = write("app.lsp", kApplication);
    EXPECT_THAT(tesselc({(folder / "missing.lsp").string()}).errors, HasSubstr("No such file or directory."));
    const auto run = tesselc({source, "-o", (folder / "missing" / "app.qbc").string()});
    EXPECT_EQ(run.status, 1);
    EXPECT_THAT(run.errors, HasSubstr("cannot write \""));
    EXPECT_THAT(tesselc({source, "-o", source}).errors, HasSubstr("would be overwritten"));
    EXPECT_EQ(bytesOf(source), kApplication);
    EXPECT_THAT(tesselc({compile("app", kApplication), "-o", (folder / "again.qbc").string()}).errors,
                HasSubstr("is compiled already."));
}

TEST_F(LispCompiler, WritesIntoNoFileThatStandsBesideItsOutput)
{
    const auto other = write("other", "somebody else's");
    for (const char* name : {"app.qbc.part", ".part-1", "app.qbc"})
        std::filesystem::create_symlink(other, folder / name);
    EXPECT_TRUE(
        std::filesystem::is_regular_file(std::filesystem::symlink_status(compile("app", kApplication))));
    EXPECT_EQ(bytesOf(other), "somebody else's");
    for (const auto& entry : std::filesystem::directory_iterator(folder.path()))
        EXPECT_THAT(entry.path().filename().string(),
                    AnyOf("app.lsp", "app.qbc", "app.qbc.part", "other", ".part-1"));
}

TEST_F(LispCompiler, MakesFilesThatOthersMayReadAsIsUsual)
{
    const mode_t before = umask(022);
    const auto compiled = compile("app", kApplication);
    umask(before);
    EXPECT_EQ(static_cast<unsigned>(std::filesystem::status(compiled).permissions()), 0644u);
}

TEST_F(LispCompiler, ShowsControlCharactersAsEscapes)
{
    const auto run = tesselc({"/nowhere/\x1b]0;taken\x07.lsp"});
    EXPECT_EQ(run.status, 1);
    EXPECT_THAT(run.errors, HasSubstr("/nowhere/\\x1B]0;taken\\x07.lsp"));
    EXPECT_THAT(tesselc({"a.lsp", "--\x1b]0;taken\x07"}).errors, HasSubstr("\\x1B]0;taken\\x07"));
    EXPECT_THAT(
        tesselc({write("app.lsp",
                       "(eval-when (:compile-toplevel :load-toplevel :execute) (princ (code-char 27)))")})
            .output,
        Not(HasSubstr("\x1b")));
}

TEST_F(LispCompiler, RefusesWrongArgumentsAndExplainsItself)
{
    EXPECT_EQ(tesselc({}).status, 2);
    EXPECT_EQ(tesselc({"a.lsp", "b.lsp"}).status, 2);
    const auto help = tesselc({"--help"});
    EXPECT_EQ(help.status, 0);
    EXPECT_THAT(help.output, HasSubstr("Compiles a Lisp file"));
}

TEST_F(LispCompiler, MakesFilesThatLispRefusesWhenAnyByteIsDamaged)
{
    const auto compiled = compile("app", "(write-line \"loaded\")");
    const auto whole = bytesOf(compiled);
    LispSession session;
    for (std::size_t at = 0; at < whole.size(); ++at)
    {
        std::string damaged = whole;
        damaged[at] = static_cast<char>(~damaged[at]);
        write("app.qbc", damaged);
        EXPECT_THAT(session.error(load(compiled)),
                    AnyOf(HasSubstr("it is not compiled Lisp."), HasSubstr("it is damaged."),
                          HasSubstr("it is cut short."),
                          HasSubstr("it was compiled for another version of Lisp")))
            << at;
    }
    for (std::size_t length = 0; length < whole.size(); ++length)
    {
        write("app.qbc", whole.substr(0, length));
        session.error(load(compiled));
    }
    EXPECT_EQ(session.output(), "");
    EXPECT_THAT(session.documentNames(), IsEmpty());
    write("app.qbc", whole);
    session.value(load(compiled));
    EXPECT_EQ(session.output(), "loaded\n");
}

TEST_F(LispCompiler, MakesFilesThatAHostWithoutRemovingRefuses)
{
    const auto compiled = compile("app", kApplication);
    LispSession session(false);
    EXPECT_EQ(session.error(load(compiled)),
              "Cannot load \"" + compiled + "\": this host does not load compiled Lisp.");
    EXPECT_EQ(session.value(load(write("app.lsp", "1"))), "T");
}
