// SUITE and HISTORY: what the dialog keeps, on the command line of the real host.
#include <filesystem>
#include <sstream>

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <nlohmann/json.hpp>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using nlohmann::json;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kModrigWaits[] =
    "Modrig is unloaded. It is loaded again when MODRIG is typed, and the Lisp of "
    "the Startup Suite with it.\n";
constexpr char kNoWindow[] = "Tessel cannot open a window: there is no display.\n";

std::string historyOf(int entries)
{
    std::string file =
        "Windows Registry Editor Version 5.00\n\n"
        "[HKEY_CURRENT_USER\\Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History]\n"
        "\"NumHistory\"=\"" +
        std::to_string(entries) + "\"\n";
    for (int number = 1; number <= entries; ++number)
    {
        const std::string digits = std::to_string(number);
        file += "\"" + digits + "History\"=\"/nowhere/" + digits + ".lsp\"\n";
    }
    return file;
}

class ListCommands : public testing::Test
{
protected:
    // Runs one command in a session that loads nothing by itself; what is said after the echo of the command.
    std::string quietly(const std::string& command, int status = 0) const
    {
        const auto result = session.start({"--safe", "-c", command});
        EXPECT_EQ(result.exitStatus, status) << result.output;
        return afterEcho(result.output, command);
    }

    static std::string afterEcho(const std::string& output, const std::string& command)
    {
        const std::string before = kBanner + ("Command: " + command + "\n");
        EXPECT_TRUE(output.starts_with(before)) << output;
        return output.substr(std::min(before.size(), output.size()));
    }

    json asJson(const std::string& command) const
    {
        const auto result = session.start({"--safe", "-c", command + " --json"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        return json::parse(result.output);
    }

    std::vector<std::string> pathsIn(const std::string& name) const
    {
        std::vector<std::string> paths;
        const json list = asJson(name + " LIST");
        for (const auto& file : list["files"])
            paths.push_back(file["path"]);
        return paths;
    }
    std::vector<std::string> suite() const { return pathsIn("SUITE"); }
    std::vector<std::string> history() const { return pathsIn("HISTORY"); }

    std::string write(const std::string& name) const
    {
        return session.folder().write(name, "(princ \"" + name + " runs\")\n").string();
    }

    HostSession session;
    const std::string first = write("first.lsp");
    const std::string second = write("second.lsp");
    const std::string third = write("third.lsp");
};
} // namespace

TEST_F(ListCommands, TellOfEmptyLists)
{
    EXPECT_EQ(quietly("SUITE LIST"), "There is nothing in the Startup Suite.\n");
    EXPECT_EQ(quietly("history list"), "There is nothing in the History list.\n");
    EXPECT_EQ(quietly("SUITE CLEAR"), "There is nothing in the Startup Suite.\n");
    EXPECT_EQ(asJson("SUITE LIST"), json({{"list", "suite"}, {"files", json::array()}}));
}

TEST_F(ListCommands, KeepAStartupSuiteThatTheNextStartLoads)
{
    EXPECT_EQ(quietly("SUITE ADD " + first), "first.lsp was added to the Startup Suite.\n");
    EXPECT_EQ(quietly("SUITE ADD " + second + " " + sample("primes.zmb")),
              "2 applications were added to the Startup Suite.\n");
    EXPECT_EQ(quietly("SUITE LIST"),
              "1  " + first + "\n2  " + second + "\n3  " + sample("primes.zmb") + "\n");
    const auto started = session.run({"APPS"});
    EXPECT_THAT(started.output, HasSubstr(listed(first, "Lisp") + listed(second, "Lisp")));
    EXPECT_THAT(started.output, HasSubstr(listed(sample("primes.zmb"))));
}

TEST_F(ListCommands, MoveAnEntryToAPlace)
{
    quietly("SUITE ADD " + first + " " + second + " " + third);
    EXPECT_EQ(quietly("SUITE MOVE " + third + " 1"), "third.lsp is in place 1 of the Startup Suite now.\n");
    EXPECT_THAT(suite(), ElementsAre(third, first, second));
    EXPECT_EQ(quietly("SUITE MOVE " + third + " 2"), "third.lsp is in place 2 of the Startup Suite now.\n");
    EXPECT_THAT(suite(), ElementsAre(first, third, second));
    for (const std::string place : {"0", "4", "-1", "one", "1x", "99999999999"})
        EXPECT_EQ(quietly("SUITE MOVE " + first + " " + place, 1),
                  "“" + place + "” is no place in the Startup Suite: its places are 1 to 3.\n");
    EXPECT_THAT(suite(), ElementsAre(first, third, second));
}

TEST_F(ListCommands, RemoveEntriesAsAWholeOrNotAtAll)
{
    quietly("SUITE ADD " + first + " " + second + " " + third);
    EXPECT_EQ(quietly("SUITE REMOVE " + first + " /nowhere.lsp", 1),
              "“/nowhere.lsp” is not in the Startup Suite.\n");
    EXPECT_THAT(suite(), ElementsAre(first, second, third));
    EXPECT_EQ(quietly("SUITE REMOVE " + third), "third.lsp was removed from the Startup Suite.\n");
    EXPECT_EQ(quietly("SUITE REMOVE " + first + " " + second),
              "2 applications were removed from the Startup Suite.\n");
    EXPECT_TRUE(suite().empty());
}

TEST_F(ListCommands, ClearAList)
{
    quietly("HISTORY ADD " + first + " " + second);
    EXPECT_EQ(quietly("HISTORY CLEAR"), "2 entries were removed from the History list.\n");
    EXPECT_EQ(asJson("HISTORY LIST")["files"], json::array());
}

TEST_F(ListCommands, KeepTheHistoryByItself)
{
    EXPECT_EQ(quietly("HISTORY ADD " + first), "first.lsp was added to the History list.\n");
    EXPECT_EQ(quietly("HISTORY ADD " + second + " " + third),
              "2 applications were added to the History list.\n");
    EXPECT_EQ(quietly("HISTORY REMOVE " + first), "first.lsp was removed from the History list.\n");
    EXPECT_EQ(quietly("HISTORY LIST"), "1  " + second + "\n2  " + third + "\n");
    EXPECT_TRUE(suite().empty());
    EXPECT_THAT(quietly("HISTORY MOVE " + second + " 1", 1), HasSubstr("Usage: HISTORY LIST"));
}

TEST_F(ListCommands, KnowAFileAsTheModuleDoes)
{
    quietly("SUITE ADD " + first);
    std::string inCapitals = first;
    inCapitals.replace(inCapitals.rfind("first"), 5, "FIRST");
    EXPECT_EQ(quietly("SUITE ADD " + first), "first.lsp was added to the Startup Suite.\n")
        << "it is there already";
    EXPECT_THAT(suite(), ElementsAre(first));
    const auto object = session.folder() / "a/gears.omp";
    std::filesystem::create_directories(object.parent_path());
    std::filesystem::copy_file(sample("gears.omp"), object);
    quietly("SUITE ADD " + object.string());
    quietly("SUITE ADD " + sample("gears.omp"));
    EXPECT_THAT(suite(), ElementsAre(first, object.string())) << "an object-database module goes by its name";
    quietly("SUITE REMOVE " + inCapitals);
    EXPECT_THAT(suite(), ElementsAre(object.string()));
}

TEST_F(ListCommands, TakeFilesFromTheCurrentFolder)
{
    const auto result = session.start({"--safe", "-c", "CD " + session.folder().path().string(), "-c",
                                       "SUITE ADD first.lsp ./second.lsp", "-c", "SUITE REMOVE first.lsp"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(suite(), ElementsAre(second));
}

TEST_F(ListCommands, HaveOneEntryForAFileHoweverItsPathIsTyped)
{
    const std::string folder = session.folder().path().string();
    const std::string name = session.folder().path().filename().string();
    session.set("HOME", folder);
    const std::vector<std::string> ways = {
        "~/first.lsp", folder + "//first.lsp",     folder + "/./first.lsp", folder + "/none/../first.lsp",
        "first.lsp",   "../" + name + "/first.lsp"};
    for (const std::string& way : ways)
    {
        const auto result = session.start({"--safe", "-c", "CD " + folder, "-c", "SUITE ADD " + way, "-c",
                                           "HISTORY ADD " + way, "-c", "SUITE MOVE " + way + " 1"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(suite(), ElementsAre(first)) << way;
        EXPECT_THAT(history(), ElementsAre(first)) << way;
        const auto removed = session.start(
            {"--safe", "-c", "CD " + folder, "-c", "SUITE REMOVE " + way, "-c", "HISTORY REMOVE " + way});
        EXPECT_EQ(removed.exitStatus, 0) << removed.output;
        EXPECT_TRUE(suite().empty()) << way;
        EXPECT_TRUE(history().empty()) << way;
    }
}

TEST_F(ListCommands, CountAFileThatIsTypedTwiceOnce)
{
    const std::string inAnotherWay = "/." + first;
    EXPECT_EQ(quietly("HISTORY ADD " + first + " " + inAnotherWay),
              "first.lsp was added to the History list.\n");
    EXPECT_EQ(quietly("HISTORY REMOVE " + inAnotherWay + " " + first),
              "first.lsp was removed from the History list.\n");
    EXPECT_TRUE(history().empty());
}

TEST_F(ListCommands, KeepALinkAsItWasTyped)
{
    const auto link = session.folder() / "link.lsp";
    std::filesystem::create_symlink(first, link);
    quietly("SUITE ADD " + first + " " + link.string());
    EXPECT_THAT(suite(), ElementsAre(first, link.string()));
}

TEST_F(ListCommands, SayThatANumberNamesNoEntry)
{
    quietly("SUITE ADD " + first + " " + second);
    const std::string hint =
        "“1” is a number, and entries are named by their files: type the path that stands "
        "at that place in the Startup Suite.\n";
    EXPECT_EQ(quietly("SUITE REMOVE 1", 1), hint);
    EXPECT_EQ(quietly("SUITE MOVE 1 2", 1), hint);
    EXPECT_THAT(quietly("HISTORY REMOVE 7", 1), HasSubstr("place in the History list.\n"));
    EXPECT_THAT(suite(), ElementsAre(first, second));
}

TEST_F(ListCommands, SayThatANameWithBlanksIsTypedInQuotes)
{
    const std::string blanks = write("my gear box.lsp");
    const auto hint = [](const std::string& path)
    {
        return "\nA name with blanks in it is typed in quotes: \"" + path + "\"\n";
    };
    const std::string part = blanks.substr(0, blanks.find(" gear"));
    for (const char* list : {"SUITE", "HISTORY"})
        EXPECT_EQ(quietly(std::string(list) + " ADD " + first + " " + blanks + " " + second, 1),
                  notOfAType(part) + hint(blanks));
    EXPECT_TRUE(suite().empty());
    quietly("SUITE ADD " + first + " " + inQuotes(blanks));
    std::filesystem::remove(blanks); // entries need not be there any more
    EXPECT_EQ(quietly("SUITE REMOVE " + first + " " + blanks, 1),
              "“" + part + "” is not in the Startup Suite." + hint(blanks));
    EXPECT_THAT(quietly("SUITE REMOVE " + blanks + "x", 1), Not(HasSubstr("quotes")));
    EXPECT_THAT(suite(), ElementsAre(first, blanks));
}

TEST_F(ListCommands, SayThatNoFileWasNamed)
{
    quietly("SUITE ADD " + first);
    for (const char* command :
         {"SUITE ADD \"\"", "SUITE REMOVE \"\"", "SUITE MOVE \"\" 1", "HISTORY ADD \"\""})
        EXPECT_EQ(quietly(command, 1), "No file is named: there is nothing between the quotes.\n") << command;
    EXPECT_THAT(suite(), ElementsAre(first));
}

// Before and after the application is loaded that has them, in every language.
TEST_F(ListCommands, OfferTheirEntriesToTheTabKey)
{
    struct Said
    {
        const char* language;
        const char* removed;
        const char* added;
        const char* moved;
        const char* forgotten;
    };
    for (const Said& said : {Said{"C.UTF-8", "second.lsp was removed", "second.lsp was added",
                                  "second.lsp is in place 1", "third.lsp was removed"},
                             Said{"de_DE.UTF-8", "second.lsp wurde aus", "second.lsp wurde zur",
                                  "second.lsp steht jetzt auf", "third.lsp wurde aus"}})
    {
        quietly("SUITE CLEAR");
        quietly("SUITE ADD " + first + " " + second);
        quietly("HISTORY ADD " + third);
        session.set("LC_ALL", said.language);
        HostTerminal terminal(session, {"--safe"});
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type("SUITE REMOVE \t\t");
        EXPECT_TRUE(terminal.shows(first + "  " + second + "\r\n")) << terminal.screen();
        terminal.type("s\t\r");
        EXPECT_TRUE(terminal.shows(said.removed)) << terminal.screen();
        terminal.type("SUITE ADD " + session.folder().path().string() + "/sec\t\r");
        EXPECT_TRUE(terminal.shows(said.added)) << terminal.screen();
        terminal.type("SUITE MOVE sec\t1\r");
        EXPECT_TRUE(terminal.shows(said.moved)) << terminal.screen();
        terminal.type("HISTORY REMOVE \t\r");
        EXPECT_TRUE(terminal.shows(said.forgotten)) << terminal.screen();
        EXPECT_EQ(terminal.quit(), 0);
        session.set("LC_ALL", "C.UTF-8");
    }
}

TEST_F(ListCommands, RefuseWhatCannotBeLoadedAndChangeNothing)
{
    const std::string text = session.folder().write("notes.txt", "").string();
    const std::string bare = session.folder().write("bare", "").string();
    const std::string missing = (session.folder() / "missing.lsp").string();
    EXPECT_EQ(quietly("SUITE ADD " + first + " " + missing, 1), "“" + missing + "” is not there.\n");
    EXPECT_EQ(quietly("SUITE ADD " + first + " " + text, 1), notOfAType(text) + "\n");
    EXPECT_EQ(quietly("SUITE ADD " + bare, 1), notOfAType(bare) + "\n");
    EXPECT_TRUE(suite().empty());
}

TEST_F(ListCommands, RefuseWhatIsCalledLikeAnApplicationAndIsNone)
{
    const std::string folder = (session.folder() / "folder.lsp").string();
    const std::string pipe = (session.folder() / "pipe.omp").string();
    const std::string device = (session.folder() / "device.lsp").string();
    const std::string bundle = session.folder().write("file.Bundle", "").string();
    std::filesystem::create_directory(folder);
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    std::filesystem::create_symlink("/dev/null", device);
    for (const std::string list : {"SUITE", "HISTORY"})
    {
        EXPECT_EQ(quietly(list + " ADD " + first + " " + folder, 1),
                  "“" + folder + "” is a folder and no application.\n");
        for (const std::string& path : {pipe, device})
            EXPECT_EQ(quietly(list + " ADD " + path, 1),
                      "“" + path + "” is no application: it is not an ordinary file.\n");
        EXPECT_EQ(quietly(list + " ADD " + bundle, 1),
                  "“" + bundle + "” is no application: it is a file, and a bundle is a folder.\n");
    }
    EXPECT_TRUE(suite().empty());
    EXPECT_TRUE(history().empty());
    EXPECT_EQ(quietly("SUITE ADD " + sample("moon.bundle")), "moon.bundle was added to the Startup Suite.\n");
}

TEST_F(ListCommands, RemoveAndMoveEntriesThatHaveBecomeFolders)
{
    quietly("SUITE ADD " + first + " " + second);
    std::filesystem::remove(second);
    std::filesystem::create_directory(second);
    EXPECT_EQ(quietly("SUITE MOVE " + second + " 1"), "second.lsp is in place 1 of the Startup Suite now.\n");
    EXPECT_EQ(quietly("SUITE REMOVE " + second), "second.lsp was removed from the Startup Suite.\n");
    EXPECT_THAT(suite(), ElementsAre(first));
}

TEST_F(ListCommands, TakeNoMoreThanFiftyFilesAtOnce)
{
    std::string fifty = "SUITE ADD";
    for (int count = 0; count < 50; ++count)
        fifty += " " + first;
    EXPECT_EQ(quietly(fifty + " " + second, 1),
              "No more than 50 files can be taken at once. None of the 51 was added to the Startup Suite.\n");
    EXPECT_TRUE(suite().empty());
    quietly(fifty);
    EXPECT_THAT(suite(), ElementsAre(first));
}

TEST_F(ListCommands, AddToAListOfManyEntries)
{
    Paths many;
    for (int number = 1; number <= 3000; ++number)
        many.push_back("/nowhere/" + std::to_string(number) + ".lsp");
    quietly("REGISTRY IMPORT " + session.folder().write("many.reg", suiteInFile(many)).string());
    quietly("SUITE ADD " + first);
    many.push_back(first);
    EXPECT_EQ(suite(), many);
}

TEST_F(ListCommands, TellWhenTheyAreTypedWrongly)
{
    const std::string usage = "Usage: SUITE LIST [--json]\n       SUITE ADD file... [--json]\n"
                              "       SUITE REMOVE entry... [--json]\n"
                              "       SUITE MOVE entry place [--json]\n       SUITE CLEAR [--json]\n";
    const std::vector<std::string> wrong = {
        "SUITE",        "SUITE GROW",      "SUITE LIST " + first, "SUITE ADD",
        "SUITE REMOVE", "SUITE CLEAR all", "SUITE MOVE " + first, "SUITE --json LIST"};
    for (const std::string& command : wrong)
        EXPECT_EQ(quietly(command, 1), usage) << command;
}

TEST_F(ListCommands, AreToldOfByHelpBeforeAndAfterTheyAreLoaded)
{
    for (const char* language : {"C.UTF-8", "de_DE.UTF-8"})
    {
        session.set("LC_ALL", language);
        const auto result =
            session.start({"--safe", "-c", "HELP --json", "-c", "HISTORY LIST --json", "-c", "HELP --json"});
        std::istringstream lines(result.output);
        std::string before;
        std::string after;
        std::getline(lines, before);
        std::getline(lines, after);
        std::getline(lines, after);
        EXPECT_EQ(json::parse(before), json::parse(after)) << language;
        EXPECT_THAT(before, HasSubstr("\"SUITE\""));
    }
    EXPECT_THAT(session.start({"--safe", "-c", "HELP"}).output,
                HasSubstr("Zeigt und ändert den Verlauf von Modrig"));
    session.set("LC_ALL", "C.UTF-8");
    EXPECT_THAT(session.start({"--safe", "-c", "HELP"}).output,
                HasSubstr("Shows and changes the History list of Modrig"));
}

TEST_F(ListCommands, SpeakThePersonsLanguage)
{
    session.set("LC_ALL", "de_AT.UTF-8");
    EXPECT_THAT(session.start({"--safe", "-c", "SUITE LIST"}).output,
                HasSubstr("Es steht nichts in der Startgruppe.\n"));
    const auto refused = session.start({"--safe", "-c", "HISTORY REMOVE " + first});
    EXPECT_THAT(refused.output, HasSubstr("„" + first + "“ steht nicht im Verlauf.\n"));
    EXPECT_THAT(session.start({"--safe", "-c", "HISTORY LIST"}).output,
                HasSubstr("\nEs steht nichts im Verlauf.\n"));
}

TEST_F(ListCommands, AreNotLoadedBeforeTheyAreTyped)
{
    putOffModrig(session);
    EXPECT_EQ(session.run({"APPS"}).output,
              std::string(kBanner) + "Command: APPS\nNo application is loaded.\n");
}

TEST_F(ListCommands, ShowEntriesThatAreNotThere)
{
    quietly("SUITE ADD " + first + " " + second);
    std::filesystem::remove(second);
    EXPECT_EQ(quietly("SUITE LIST"), "1  " + first + "\n2  " + second + "  (not there)\n");
    EXPECT_EQ(asJson("SUITE LIST")["files"],
              json::array({{{"place", 1}, {"path", first}, {"isThere", true}, {"isLaidDown", false}},
                           {{"place", 2}, {"path", second}, {"isThere", false}, {"isLaidDown", false}}}));
    EXPECT_EQ(quietly("SUITE REMOVE " + second), "second.lsp was removed from the Startup Suite.\n");
}

TEST_F(ListCommands, AnswerEveryChangeAsJson)
{
    EXPECT_EQ(asJson("HISTORY ADD " + first)["files"][0]["path"], first);
    EXPECT_EQ(asJson("HISTORY REMOVE " + first), json({{"list", "history"}, {"files", json::array()}}));
}

TEST_F(ListCommands, WriteNamesThatAreNoTextAsJson)
{
    const std::string odd = "odd \xE9 \"q\" \\ \t\x1B[31m größe.lsp";
    const std::string path = write(odd);
    const auto result = session.start({"--safe", "-c", "HISTORY ADD " + inQuotes(path)});
    ASSERT_EQ(result.exitStatus, 0) << result.output;
    const std::string listed = asJson("HISTORY LIST")["files"][0]["path"];
    EXPECT_TRUE(listed.ends_with("odd \U0010FEE9 \"q\" \\ \t\x1B[31m größe.lsp")) << listed;
}

TEST_F(ListCommands, BelongToTheCurrentProfile)
{
    quietly("SUITE ADD " + first);
    const auto other =
        session.start({"--safe", "-c", "PROFILE Other", "-c", "SUITE LIST", "-c", "SUITE ADD " + second});
    EXPECT_THAT(other.output, HasSubstr("There is nothing in the Startup Suite.\n"));
    EXPECT_THAT(suite(), ElementsAre(second));
    quietly("PROFILE Default");
    EXPECT_THAT(suite(), ElementsAre(first));
}

// Modrig holds what it has read: it is taken out of service, and reads the list again.
TEST_F(ListCommands, HaveModrigReadTheListAgainWhichIsLoaded)
{
    quietly("SUITE ADD " + sample("primes.zmb"));
    session.run({}); // Modrig makes its record
    const auto result = session.run({"SUITE ADD " + sample("gears.omp"),
                                     "SUITE REMOVE " + sample("primes.zmb"), "SUITE LIST", "MODRIG", "APPS"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output,
                HasSubstr("gears.omp was added to the Startup Suite.\n" + std::string(kModrigWaits)));
    EXPECT_THAT(result.output,
                HasSubstr("primes.zmb was removed from the Startup Suite.\nCommand: SUITE LIST\n1  " +
                          sample("gears.omp") + "\nCommand: MODRIG\nGears:"));
    EXPECT_THAT(result.output, HasSubstr(kNoWindow));
    EXPECT_THAT(result.output, HasSubstr(listed(modrigBundle())));
    EXPECT_THAT(suite(), ElementsAre(sample("gears.omp")));
}

TEST_F(ListCommands, BringModrigBackThatNoCommandWouldBring)
{
    const auto result = session.run({"SUITE ADD " + sample("primes.zmb"), "MODRIG"});
    EXPECT_EQ(result.output,
              kBanner + ("Command: SUITE ADD " + sample("primes.zmb") + "\n" + kPrimes +
                         "primes.zmb was added to the Startup Suite.\nCommand: MODRIG\n" + kNoWindow));
}

TEST_F(ListCommands, LeaveModrigLoadedWhenNothingChanges)
{
    quietly("SUITE ADD " + sample("primes.zmb"));
    session.run({});
    const auto result = session.run({"SUITE ADD " + sample("primes.zmb"), "SUITE LIST", "APPS"});
    EXPECT_THAT(result.output, Not(HasSubstr("Modrig is unloaded")));
    EXPECT_THAT(result.output, HasSubstr(listed(modrigBundle())));
}

TEST_F(ListCommands, KeepTheRecordOfModrigInStep)
{
    quietly("SUITE ADD " + sample("primes.zmb"));
    session.run({});
    const std::string reasons = std::string("REGISTRY GET ") + kRecordKey + " LoadReasons";
    EXPECT_EQ(quietly(reasons), "6\n");
    quietly("SUITE CLEAR");
    EXPECT_EQ(quietly(reasons), "4\n");
    EXPECT_THAT(session.run({"APPS"}).output, HasSubstr("No application is loaded."));
    quietly("SUITE ADD " + first);
    EXPECT_EQ(quietly(reasons), "6\n");
    EXPECT_EQ(quietly(std::string("REGISTRY LIST ") + kRecordKey + "\\Commands"), "MODRIG = MODRIG\n");
    EXPECT_THAT(session.run({"APPS"}).output, HasSubstr(listed(first, "Lisp")));
}

TEST_F(ListCommands, ChangeNothingWhileAnotherTesselWorksWithTheProfile)
{
    quietly("SUITE ADD " + first);
    HostTerminal other(session);
    ASSERT_TRUE(other.awaitPrompt());
    EXPECT_EQ(
        quietly("SUITE ADD " + second, 1),
        "Another Tessel works with this profile, and would put back what it has read once its dialog is "
        "closed: the Startup Suite stays as it is. End the other Tessel first.\n");
    EXPECT_THAT(suite(), ElementsAre(first)) << "to look is no change";
    EXPECT_EQ(other.quit(), 0);
    EXPECT_EQ(quietly("SUITE ADD " + second), "second.lsp was added to the Startup Suite.\n");
}

TEST_F(ListCommands, ChangeNothingThatTheAdministratorHasLaidDown)
{
    session.alwaysWith({"--layout-dir", (session.folder() / "layout").string()});
    layOutSuite(session, "policy/suite.reg", first);
    const std::string stays = "The administrator has laid down the Startup Suite in " +
                              (session.folder() / "layout/policy/suite.reg").string() +
                              ": it stays as it is.\n";
    EXPECT_EQ(quietly("SUITE LIST"), "1  " + first + "  (laid down by the administrator)\n");
    EXPECT_EQ(asJson("SUITE LIST")["files"][0]["isLaidDown"], true);
    EXPECT_EQ(quietly("SUITE REMOVE " + first, 1), stays);
    EXPECT_EQ(quietly("SUITE CLEAR", 1), stays);
    EXPECT_EQ(quietly("SUITE ADD " + second, 1), stays);
    EXPECT_EQ(quietly("SUITE ADD " + first), "first.lsp was added to the Startup Suite.\n");
    EXPECT_EQ(quietly("HISTORY ADD " + second), "second.lsp was added to the History list.\n");
    session.alwaysWith({});
    EXPECT_TRUE(suite().empty()) << "nothing was stored under it";
}

TEST_F(ListCommands, ChangeWhatIsOnlyADefault)
{
    session.alwaysWith({"--layout-dir", (session.folder() / "layout").string()});
    layOutSuite(session, "suite.reg", first);
    quietly("SUITE ADD " + second);
    EXPECT_THAT(suite(), ElementsAre(first, second));
    quietly("SUITE REMOVE " + first);
    EXPECT_THAT(suite(), ElementsAre(second));
    quietly("SUITE CLEAR");
    EXPECT_TRUE(suite().empty());
}

// Wherever the limit is met: while the list is written, or at the end of the command.
TEST_F(ListCommands, DoNotSayThatALongListIsRemovedWhereThatCannotBeStored)
{
    constexpr int kMany = 300;
    constexpr int kPage = 8; // of the store, in what `ulimit` counts
    constexpr int kEnough = 30 * kPage;
    quietly("REGISTRY IMPORT " + session.folder().write("long.reg", historyOf(kMany)).string());
    int limit = 0;
    for (bool stored = false; !stored && limit < kEnough;)
    {
        limit += kPage;
        session.startBy("ulimit -f " + std::to_string(limit) + "; exec \"$0\" \"$@\"");
        const auto result = session.start({"--safe", "-c", "HISTORY CLEAR"});
        stored = result.exitStatus == 0;
        EXPECT_EQ(result.output.find("were removed") != result.output.npos, stored) << limit << result.output;
    }
    session.startBy("exec \"$0\" \"$@\"");
    EXPECT_GT(limit, 3 * kPage);
    EXPECT_LT(limit, kEnough);
    EXPECT_TRUE(history().empty());
}

TEST_F(ListCommands, FailWhenTheRegistryCannotBeWritten)
{
    quietly("SUITE ADD " + first);
    const auto file = session.profile() / "registry.db";
    std::filesystem::permissions(file, std::filesystem::perms::owner_read);
    const auto result = session.start({"--safe", "-c", "SUITE ADD " + second, "-c", "SUITE LIST"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("SUITE ADD " + second +
                          "\nA list of applications could not be stored in the registry. Changes "
                          "made since it was last stored may be lost.\n"));
    EXPECT_THAT(result.output, HasSubstr("Command: SUITE LIST\n1  " + first + "\n"));
    EXPECT_THAT(result.output, Not(HasSubstr("2  ")));
}
