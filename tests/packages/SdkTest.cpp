// What a module's author does with the packages, in folders outside of the tree.
#include <array>
#include <fstream>
#include <regex>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/packages/Packages.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
class Sdk : public testing::Test
{
protected:
    Sdk()
    {
        for (const char* package : {"tessel", "tessel-dev"})
            did("dpkg-deb -x '" + packageFile(package).string() + "' '" + root.string() + "'");
        session.startBy("exec '" + (root / "usr/bin/tessel").string() + "' \"$@\"");
    }

    // In the session's folder, with what was unpacked in the places of what is installed.
    CommandOutcome run(const std::string& command) const
    {
        const std::string usr = (root / "usr").string();
        return runCommand("cd '" + session.folder().path().string() + "' && export PATH='" + usr +
                          "/bin':\"$PATH\" CMAKE_PREFIX_PATH='" + usr + "' PKG_CONFIG_PATH='" + usr +
                          "/" LIBRARIES "/pkgconfig' && unset DISPLAY && " + command);
    }

    std::string did(const std::string& command) const
    {
        const auto outcome = run(command);
        EXPECT_EQ(outcome.status, 0) << command << "\n" << outcome.output;
        return outcome.output;
    }

    fs::path inFolder(const std::string& name) const { return session.folder() / name; }

    HostSession session;
    fs::path root = session.folder() / "installed";
};

std::string contentOf(const fs::path& file)
{
    std::ifstream stream(file);
    return {std::istreambuf_iterator<char>(stream), {}};
}

// The first code of that language in a document, without what fences it.
std::string firstCode(const std::string& document, const std::string& language)
{
    const std::string fence = "```" + language + "\n";
    const std::size_t start = document.find(fence);
    if (start == document.npos)
        return {};
    return document.substr(start + fence.size(), document.find("```", start + 1) - start - fence.size());
}
struct Kind
{
    std::string name;
    std::string extension;
    std::string typed;
};
const std::array kKinds = {Kind{"zmb", ".zmb", "MY-ZMB"}, Kind{"omp", ".omp", "MY-OMP"},
                           Kind{"bundle", ".bundle", "MY-BUNDLE"}, Kind{"lsp", ".qbc", "(my-lsp)"}};

const std::regex kThreeCommands("\n    (cmake -S .*)\n    (cmake --build .*)\n    (ctest .*)\n");
} // namespace

TEST_F(Sdk, IsFoundByCMakeWhichBuildsModulesOfEveryKindThatLoad)
{
    fs::copy(OUTSIDE_PROJECT, inFolder("project"), fs::copy_options::recursive);
    did("cmake -S project -B built -G Ninja && cmake --build built");
    const std::string outside = inFolder("built/outside.zmb").string();
    const std::string packed = inFolder("built/packed.bundle").string();
    const auto result = session.run({"LOAD " + inQuotes(outside), "OUTSIDE", "LOAD " + inQuotes(packed),
                                     "LOAD " + inQuotes(inFolder("built/objects.omp").string())});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: OUTSIDE\nHello from outside.\n"),
                                     HasSubstr("A text by its number.\nshapes.txt is there\n")));
    for (const std::string& module : {outside, packed + "/packed"})
    {
        EXPECT_EQ(did("nm --dynamic --defined-only --format=just-symbols '" + module + "'"),
                  "tsrxEntryPoint\n");
        EXPECT_THAT(did("readelf --notes '" + module + "'"), HasSubstr("Tessel")) << "the version of the SDK";
    }
}

TEST_F(Sdk, MakesTextsOfOneNameApartFromEachOther)
{
    const std::string code = firstCode(contentOf(root / "usr/share/doc/tessel-dev/host-guide.md"), "cpp");
    session.folder().write("project/hello.cpp", code);
    session.folder().write("project/CMakeLists.txt",
                           "cmake_minimum_required(VERSION 3.25)\n"
                           "project(p LANGUAGES CXX)\nfind_package(Tessel REQUIRED)\n"
                           "tessel_add_bundle(one TEXTS one/Texts.rc hello.cpp)\n"
                           "tessel_add_bundle(two TEXTS two/Texts.rc hello.cpp)\n");
    for (const std::string name : {"one", "two"})
        session.folder().write("project/" + name + "/Texts.rc",
                               "LANGUAGE 9, 1\nSTRINGTABLE\nBEGIN\n 1 \"" + name + "\"\nEND\n");
    did("cmake -S project -B built -G Ninja && cmake --build built");
    EXPECT_EQ(did("find built -name Texts.res | wc -l"), "2\n") << "both are made at the same time";
}

TEST_F(Sdk, PutsModulesWhereTheyAreLookedForWhateverTheProjectIsSetTo)
{
    session.folder().write(
        "project/CMakeLists.txt",
        "cmake_minimum_required(VERSION 3.25)\nproject(p LANGUAGES CXX)\n"
        "find_package(Tessel REQUIRED)\nenable_testing()\n"
        "tessel_add_module(hello FOLDER here hello.cpp)\n"
        "tessel_add_bundle(packed FOLDER here TEXTS packed.rc hello.cpp)\n"
        "tessel_add_lisp(lisp FOLDER here lisp.lsp)\n"
        "foreach(module hello packed)\n"
        "tessel_add_test(${module} MODULE ${module} TYPES HELLO SHOWS Hello.)\nendforeach()\n"
        "tessel_add_test(lisp MODULE lisp SHOWS compiled)\n");
    session.folder().write("project/hello.cpp",
                           firstCode(contentOf(root / "usr/share/doc/tessel-dev/host-guide.md"), "cpp"));
    session.folder().write("project/packed.rc", "LANGUAGE 9, 1\nSTRINGTABLE\nBEGIN\n 1 \"one\"\nEND\n");
    session.folder().write("project/lisp.lsp", "(write-line \"compiled\")\n");
    did("cmake -S project -B built -G 'Ninja Multi-Config' -DCMAKE_DEBUG_POSTFIX=d");
    did("cmake --build built --config Debug");
    EXPECT_THAT(did("ctest --test-dir built -C Debug"),
                HasSubstr("100% tests passed, 0 tests failed out of 3"));
    EXPECT_EQ(did("ls -A built/here built/here/packed.bundle"),
              "built/here:\nhello.zmb\nlisp.qbc\npacked.bundle\n\n"
              "built/here/packed.bundle:\nResources\npacked\n");
}

TEST_F(Sdk, RunsTheTestsOfAProject)
{
    fs::copy(OUTSIDE_PROJECT, inFolder("project"), fs::copy_options::recursive);
    did("cmake -S project -B built -G Ninja && cmake --build built");
    const std::string tested = run("ctest --test-dir built --output-on-failure").output;
    EXPECT_THAT(tested,
                AllOf(HasSubstr("60% tests passed, 2 tests failed out of 5"),
                      HasSubstr("This is not shown: Hello from inside."), HasSubstr("Tessel ended with 1")));
}

TEST_F(Sdk, FindsAMisspeltFunctionWhenTheModuleIsBuilt)
{
    fs::copy(OUTSIDE_PROJECT, inFolder("project"), fs::copy_options::recursive);
    session.folder().write("project/Outside.cpp",
                           "#include <tessel/tsrx.h>\nTESSEL_API int tsutPrimtf();\n"
                           "extern \"C\" TESSEL_EXPORT int tsrxEntryPoint(unsigned, void*)\n"
                           "{ return tsutPrimtf(); }\n");
    const auto built = run("cmake -S project -B built -G Ninja && cmake --build built");
    EXPECT_NE(built.status, 0);
    EXPECT_THAT(built.output, HasSubstr("undefined reference to `tsutPrimtf()'"));
}

TEST_F(Sdk, TestsAModuleWithoutAHostAndAHostByItsContract)
{
    fs::copy(OUTSIDE_PROJECT, inFolder("sdk"), fs::copy_options::recursive);
    fs::copy(KIT_PROJECT, inFolder("kit"), fs::copy_options::recursive);
    did("cmake -S kit -B built -G Ninja && cmake --build built -j 2");
    const std::string tested = run("ctest --test-dir built --output-on-failure").output;
    EXPECT_THAT(tested, AllOf(HasSubstr(", 1 tests failed out of "), HasSubstr("not given back to the host"),
                              HasSubstr("contract.QuestionsContract.TakesNumbers")));
}

TEST_F(Sdk, NamesTheLineOfATextThatCannotBeRead)
{
    fs::copy(OUTSIDE_PROJECT, inFolder("project"), fs::copy_options::recursive);
    const auto wrong = [this](const std::string& lines)
    {
        const auto script =
            session.folder().write("project/OutsideRes.rc", "LANGUAGE 9, 1\n\nSTRINGTABLE\nBEGIN\n" + lines);
        const auto built =
            run("cmake -S project -B built -G Ninja && cmake --build built --target packed_texts");
        EXPECT_NE(built.status, 0);
        const std::size_t place = built.output.find(script.string() + ":");
        return place == built.output.npos ? built.output
                                          : built.output.substr(place + script.string().size(), 30);
    };
    EXPECT_THAT(wrong(" 1 \"one\"\n 2 two\n 3 \"three\"\nEND\n"), HasSubstr(":6: error: expected string"));
    EXPECT_THAT(wrong(" 1 \"one\"\n 2 \"[;]\"\n 1 \"\u00FCber\"\nEND\n"), HasSubstr(":7: error: Multiple"));
    EXPECT_THAT(wrong(" 1 \"one\"\n 2 \"two\n 3 \"three\"\nEND\n"), HasSubstr(":6: error: String literal"));
    EXPECT_THAT(wrong(" 1 \"one\"\n"), HasSubstr(":5: error: expected"));
}

TEST_F(Sdk, RefusesWhatItsFunctionsDoNotTake)
{
    const std::string start =
        "cmake_minimum_required(VERSION 3.25)\nproject(p LANGUAGES CXX)\nfind_package(Tessel REQUIRED)\n";
    session.folder().write("kind/CMakeLists.txt", start + "tessel_add_module(a KIND bmz A.cpp)\n");
    EXPECT_THAT(run("cmake -S kind -B built").output,
                HasSubstr("tessel_add_module(a): KIND is zmb or omp, and not bmz"));
    session.folder().write("none/CMakeLists.txt", start + "tessel_add_bundle(a IDENTIFIER a.b)\n");
    EXPECT_THAT(run("cmake -S none -B built2").output, HasSubstr("The module a is given no source files"));
}

TEST_F(Sdk, LetsTheGuidesFirstModuleBeBuiltInTenLinesByTwoCommands)
{
    const std::string guide = contentOf(root / "usr/share/doc/tessel-dev/host-guide.md");
    const std::string code = firstCode(guide, "cpp");
    EXPECT_EQ(std::ranges::count(code, '\n'), 10) << code;
    session.folder().write("hello.cpp", code);
    std::smatch commands;
    ASSERT_TRUE(std::regex_search(guide, commands, std::regex("\n    (g\\+\\+ .*)\n    (tessel .*)\n")));
    did(commands[1]);
    EXPECT_THAT(did("echo HELLO | HOME=\"$PWD\" " + commands[2].str()), HasSubstr("\nHello.\n"));
}

TEST_F(Sdk, WritesAProjectOfEveryKindThatBuildsPassesItsTestAndLoads)
{
    for (const Kind& kind : kKinds)
    {
        const std::string name = "my-" + kind.name;
        const std::string told = did("umask 022 && tessel-new-module " + name + " " + kind.name);
        EXPECT_EQ(fs::status(inFolder(name)).permissions(), fs::perms(0755));
        const std::string built = name + "/build/" + name + kind.extension;
        std::smatch commands;
        ASSERT_TRUE(std::regex_search(told, commands, kThreeCommands)) << told;
        EXPECT_THAT(told, HasSubstr("\n    tessel " + built + "\n"));
        did(commands[1].str() + " -G Ninja && " + commands[2].str());
        EXPECT_THAT(did(commands[3]), HasSubstr("100% tests passed, 0 tests failed out of 1\n"));
        const auto result = session.run({"LOAD " + inQuotes(inFolder(built).string()), kind.typed});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output, AllOf(HasSubstr("\n" + name + ": type " + kind.typed + ".\n"),
                                         HasSubstr("\nHello from " + name + ".\n")));
    }
}

TEST_F(Sdk, RefusesNamesThatNoProjectCanHave)
{
    for (const char* name : {"''", "1st", "a/b", "'a b'", "../a", "-a", "ä", "'a\nb'", "Test", "help",
                             "aaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaaa"})
    {
        const auto refused = run(std::string("tessel-new-module ") + name + " zmb");
        EXPECT_EQ(refused.status, 2) << name;
        EXPECT_THAT(refused.output,
                    testing::ContainsRegex("^tessel-new-module: (the name|there is no option)"));
    }
    EXPECT_EQ(
        run("tessel-new-module quit zmb").output,
        "tessel-new-module: the name \"quit\" cannot be taken: Tessel has a command QUIT of its own.\n");
    EXPECT_EQ(run("tessel-new-module Apps bundle").status, 2);
    EXPECT_EQ(run("tessel-new-module List lsp").output,
              "tessel-new-module: the name \"List\" cannot be taken: Lisp has a List of its own.\n");
    EXPECT_EQ(run("tessel-new-module quit lsp").status, 2);
    EXPECT_EQ(run("tessel-new-module hello xyz").output,
              "tessel-new-module: the kind is bundle, zmb, omp or lsp, and not \"xyz\".\n");
    EXPECT_EQ(run("tessel-new-module hello").status, 2);
    EXPECT_EQ(did("ls"), "home\ninstalled\n") << "nothing is left behind";
}

TEST_F(Sdk, LeavesAFolderThatIsThereAlreadyAsItIs)
{
    session.folder().write("hello/mine", "mine");
    fs::create_symlink("nowhere", inFolder("link"));
    const auto refused = run("tessel-new-module hello zmb");
    EXPECT_EQ(refused.status, 1);
    EXPECT_EQ(refused.output,
              "tessel-new-module: \"hello\" is here already and is left as it is; take another "
              "name or another folder.\n");
    EXPECT_EQ(run("tessel-new-module link zmb").status, 1);
    EXPECT_EQ(did("ls -A . hello"), ".:\nhello\nhome\ninstalled\nlink\n\nhello:\nmine\n");
}
