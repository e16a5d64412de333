// What Tessel says in a language of its own, in which every translated text stands between brackets ⟦ ⟧: what
// stands in plain letters outside of them nobody can translate.
#include <csignal>
#include <filesystem>
#include <regex>
#include <sstream>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

namespace
{
using testing::IsEmpty;
using Lines = std::vector<std::string>;

std::string without(std::string text, const std::string& what)
{
    return std::regex_replace(text, std::regex(what), "");
}

// Sentences are put into sentences.
std::string withoutTranslated(std::string text)
{
    for (std::size_t end = text.find("⟧"); end != text.npos; end = text.find("⟧"))
    {
        const std::size_t begin = text.rfind("⟦", end);
        if (begin == text.npos)
            return text;
        text.erase(begin, end - begin + std::string("⟧").size());
    }
    return text;
}

// What was typed, and what applications say.
bool isOfOthers(const std::string& line)
{
    return std::regex_search(line,
                             std::regex("^Command: |^  (SUITE|HISTORY) |^[A-Za-z0-9]+\\.zmb: message "));
}

// Names stay: of files, programs, options and profiles.
std::string withoutNames(std::string line)
{
    for (const char* name :
         {"Tessel R21, reference host for Modrig(, version [0-9.]+)?", "/[^ \"„“:;,()]+",
          "[a-z]+\\.(zmb|lsp|qbc|bundle)", "--?[a-z][a-z-]*", "tesselc", ": Tessel \\[", "^Default$"})
        line = without(line, name);
    return line;
}

// The lines with words of two small letters at least.
Lines plainLinesIn(const std::string& output)
{
    Lines plain;
    std::istringstream lines(withoutTranslated(output));
    for (std::string line; std::getline(lines, line);)
        if (!isOfOthers(line) && std::regex_search(withoutNames(line), std::regex("[a-z]{2}")))
            plain.push_back(line);
    return plain;
}

class Untranslated : public testing::Test
{
protected:
    Untranslated() { mSession.set("LC_ALL", "en_XA.UTF-8"); }

    std::string write(const std::string& name, const std::string& content)
    {
        return mSession.folder().write(name, content).string();
    }

    // By lines of a script: many cost one start.
    Lines plainLinesOf(const Lines& commands)
    {
        std::string script;
        for (const std::string& command : commands)
            script += command + "\n";
        return plainLinesIn(mSession.runScript(script).output);
    }

    HostSession mSession;
};

TEST_F(Untranslated, IsFoundWhereThereIsSuch)
{
    EXPECT_THAT(plainLinesIn("⟦á ⟦ß⟧ /a/plain/path⟧: ~\nCommand: LOAD\n"), IsEmpty());
    EXPECT_THAT(plainLinesIn("⟦á⟧ is plain\n"), testing::ElementsAre(" is plain"));
    mSession.alwaysWith({"--safe"});
    EXPECT_THAT(mSession.run({"SETVAR NONE"}).output, testing::HasSubstr("⟦Théré îš ñø vår"));
}

TEST_F(Untranslated, IsNothingOfHelpAndSettings)
{
    mSession.alwaysWith({"--safe"});
    EXPECT_THAT(plainLinesOf({"HELP",
                              "? LOAD",
                              "HELP REGISTRY",
                              "HELP QUIT",
                              "HELP NOSUCH",
                              "HELP LOD",
                              "HELP MODRIG",
                              "VERSION",
                              "CD",
                              "CD /nowhere/at/all",
                              "CD a b",
                              "LOD",
                              "QQQQQQQQ",
                              "SETVAR",
                              "SETVAR NONE",
                              "SETVAR NONE 1",
                              "SETVAR LISPENABLED 7",
                              "SETVAR TESSELVERSION R1",
                              "SETVAR a b c",
                              "PROFILE",
                              "PROFILE a\\b",
                              "PROFILE a b",
                              "SCRIPT /none.scr",
                              "SCRIPT",
                              "QUIT"}),
                IsEmpty());
    EXPECT_THAT(plainLinesIn(mSession.start({"--help"}).output), IsEmpty());
    EXPECT_THAT(plainLinesIn(mSession.start({"--verbose", "-c", "VERSION"}).output), IsEmpty());
    EXPECT_THAT(plainLinesIn(mSession.start({"--log", "/none/log", "-c", "VERSION"}).output), IsEmpty());
    const std::string itself = write("itself.scr", "");
    write("itself.scr", "SCRIPT " + itself + "\n");
    EXPECT_THAT(plainLinesOf({"SCRIPT " + itself}), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfTheRegistry)
{
    mSession.alwaysWith({"--safe"});
    const std::string head = "Windows Registry Editor Version 5.00\n";
    Lines commands = {"REGISTRY",
                      "REGISTRY LIST None",
                      "REGISTRY GET None it",
                      "REGISTRY DELETE None",
                      "REGISTRY SET Here NAME DATA",
                      "REGISTRY SET Here \"\" DATA",
                      "REGISTRY LIST Here",
                      "REGISTRY DELETE Here none",
                      "REGISTRY EXPORT Here " + (mSession.folder() / "here.reg").string(),
                      "REGISTRY EXPORT None " + (mSession.folder() / "none.reg").string(),
                      "REGISTRY EXPORT Here " + write("taken.txt", "text"),
                      "REGISTRY IMPORT /none.reg",
                      "REGISTRY RESTORE",
                      "REGISTRY RESET"};
    int number = 0;
    for (const std::string& wrong :
         {std::string("text"), head + "[HKCU", head + "[HKLM\\A]", head + "[-HKCU]", head + "\"a\"=\"b\"",
          head + "[HKCU\\A]\n\"a\"=1", head + "[HKCU\\A]\n\"a", head + "[HKCU\\A]\n\"a\"=\"b",
          head + "[HKCU\\A]\n\"a\" \"b\"", head + "[HKCU\\A]\n\"a\"=\"b\" c", head + "[HKCU\\A]\nabc",
          head + "[HKCU\\A]\n\"a\\b\"=\"b\"",
          std::string("\xFF\xFE"
                      "a")})
        commands.push_back("REGISTRY IMPORT " + write(std::to_string(++number) + ".reg", wrong));
    EXPECT_THAT(plainLinesOf(commands), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfADamagedRegistry)
{
    mSession.alwaysWith({"--safe"});
    EXPECT_THAT(plainLinesOf({"REGISTRY SET Here NAME DATA"}), IsEmpty());
    write("profile/registry.db", "no registry at all, but long enough to be looked at as one");
    EXPECT_THAT(plainLinesOf({"REGISTRY SET Here NAME DATA", "REGISTRY GET Here NAME", "REGISTRY RESET"}),
                IsEmpty());
    EXPECT_THAT(plainLinesOf({"REGISTRY RESTORE", "REGISTRY RESET"}), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfApplications)
{
    mSession.alwaysWith({"--safe"});
    const std::string lisp = write("good.lsp", "(+ 1 1)");
    const std::string folder = write("folder.zmb/file", "");
    Lines commands = {"LOAD",
                      "LOAD a b",
                      "LOAD /none.zmb",
                      "LOAD ftp://host/file",
                      "LOAD http://[/file",
                      "LOAD " + write("text.zmb", "text"),
                      "LOAD " + write("cut.zmb", "\x7F"
                                                 "ELF"),
                      "LOAD " + lisp,
                      "LOAD /none.lsp",
                      "LOAD " + write("open.lsp", "\n(car"),
                      "LOAD " + write("text.qbc", "text"),
                      "LOAD " + write("file.bundle", ""),
                      "UNLOAD /none.zmb",
                      "UNLOAD " + lisp,
                      "APPS",
                      "DISABLE /none.zmb",
                      "DISABLE /",
                      "DISABLE " + write("a.txt", ""),
                      "DISABLE " + lisp,
                      "DISABLE " + folder,
                      "APPS",
                      "ENABLE /none.zmb",
                      "ENABLE " + lisp,
                      "BISECT",
                      "BISECT GOOD",
                      "BISECT START",
                      "BISECT STOP",
                      "BISECT SO"};
    for (const char* name :
         {"Good.zmb", "NoEntry.zmb", "Answers3.zmb", "LocksItself.zmb", "RefusesToUnload.zmb", "Throws.zmb",
          "ThrowsNumber.zmb", "ThrowsInMapping.zmb", "ThrowsAtUnload.zmb"})
    {
        commands.push_back("LOAD " + inQuotes(fixtureModule(name)));
        commands.push_back("UNLOAD " + inQuotes(fixtureModule(name)));
    }
    EXPECT_THAT(plainLinesOf(commands), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfLisp)
{
    mSession.alwaysWith({"--safe"});
    EXPECT_THAT(plainLinesOf({"(/ 1 0)", "(quit)", "(load \"/none\")", "(read-from-string \"(\")",
                              "(defun f () (1+ (f)))", "(f)", "(qz-unload-rpk \"X\")", "(car"}),
                IsEmpty());
    mSession.alwaysWith({});
    const auto compiler = std::filesystem::path(TESSEL_PROGRAM).parent_path() / "tesselc";
    mSession.startBy("'" + compiler.string() + "' --help; '" + compiler.string() + "' /none.lsp; '" +
                     compiler.string() + "' " + write("a.lsp", "(car") + " # ");
    EXPECT_THAT(plainLinesIn(mSession.run({}).output), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfWhatEndsTheHostAndOfSearches)
{
    putOffModrig(mSession);
    const std::string bad = deadly(mSession, "segv");
    mSession.alwaysWith({"--safe"});
    const auto ended = mSession.run({"LOAD " + inQuotes(bad)});
    EXPECT_EQ(ended.exitStatus, -SIGSEGV);
    EXPECT_THAT(plainLinesIn(ended.output), IsEmpty());
    mSession.alwaysWith({});
    EXPECT_THAT(plainLinesOf({"APPS", "BISECT START", "ENABLE " + inQuotes(bad)}), IsEmpty());
}

TEST_F(Untranslated, IsNothingOfRights)
{
    mSession.alwaysWith({"--safe"});
    EXPECT_THAT(plainLinesOf({"VERSION"}), IsEmpty());
    std::filesystem::permissions(mSession.profile(), std::filesystem::perms::all);
    EXPECT_THAT(plainLinesOf({"VERSION"}), IsEmpty());
    mSession.set("HOME", "");
    mSession.alwaysWith({});
    mSession.startBy("exec \"$0\" -c VERSION # ");
    EXPECT_THAT(plainLinesIn(mSession.run({}).output), IsEmpty());
}
} // namespace
