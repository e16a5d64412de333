// What a person with German as their language reads about applications and Lisp.
#include <csignal>
#include <filesystem>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

namespace
{
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;

class GermanPerson : public testing::Test
{
protected:
    GermanPerson()
    {
        mSession.set("LC_ALL", "");
        mSession.set("LANG", "de_DE.UTF-8");
    }

    std::string reads(const std::vector<std::string>& commands) const
    {
        return mSession.run(commands).output;
    }

    HostSession mSession;
};

TEST_F(GermanPerson, ReadsWhyAnApplicationWasNotLoadedAndHowManyAtTheStart)
{
    const std::string other = mSession.folder().write("other.zmb", "not a library").string();
    const std::string cut = mSession.folder()
                                .write("cut.zmb", "\x7F"
                                                  "ELF")
                                .string();
    EXPECT_THAT(reads({"LOAD " + other}), HasSubstr("\nDie Anwendung „" + other +
                                                    "“ wurde nicht geladen: keine dynamische Bibliothek.\n"));
    storeSuite(mSession, {other});
    EXPECT_THAT(reads({}), HasSubstr("1 Anwendung konnte nicht geladen werden:\n  " + other + ": "));
    storeSuite(mSession, {other, cut});
    EXPECT_THAT(reads({}), AllOf(HasSubstr("2 Anwendungen konnten nicht geladen werden:\n  " + other + ": "),
                                 HasSubstr("\n  " + cut + ": die Datei ist unvollständig.\n")));
}

TEST_F(GermanPerson, ReadsWhyAnApplicationStays)
{
    const std::string locked = fixtureModule("LocksItself.zmb");
    EXPECT_THAT(reads({"LOAD " + locked, "UNLOAD " + locked}),
                HasSubstr("Die Anwendung „" + locked + "“ wurde nicht entladen: sie ist gesperrt.\n"));
}

TEST_F(GermanPerson, ReadsWhatEndedTheLastSessionAndWhyItIsKeptOut)
{
    const std::string deed = "am [.0-9]+ [:0-9]+ beendet.*, während ihr Einsprungpunkt lief "
                             "\\(aus der Startgruppe geladen\\): Speicherfehler \\(SIGSEGV\\)";
    const std::string bad = deadly(mSession, "segv");
    storeSuite(mSession, {bad});
    EXPECT_THAT(reads({}), HasSubstr("Die Anwendung „" + bad +
                                     "“ hat Tessel beendet, während ihr "
                                     "Einsprungpunkt lief: Speicherfehler (SIGSEGV).\n"));
    EXPECT_THAT(reads({}), AllOf(ContainsRegex("Die Anwendung „" + bad + "“ hat Tessel " + deed + "\\. "),
                                 HasSubstr("; der nächste lässt sie noch einmal zu.\n")));
    EXPECT_EQ(mSession.run({}).exitStatus, -SIGSEGV);
    EXPECT_THAT(reads({}), HasSubstr("Sie wird nicht mehr von selbst geladen, bis Sie sie "));
    EXPECT_THAT(reads({"APPS"}),
                AllOf(ContainsRegex("Die Anwendung „" + bad +
                                    "“ wurde nicht geladen: ferngehalten, weil sie Tessel " + deed + "\\.\n"),
                      ContainsRegex("segv.zmb .* ferngehalten, weil sie Tessel " + deed + "\n")));
}

TEST_F(GermanPerson, ReadsHowTheSearchForACulpritGoes)
{
    const auto write = [this](const std::string& name)
    {
        return mSession.folder().write(name, "()").string();
    };
    storeSuite(mSession, {write("a.lsp"), write("b.lsp"), write("c.lsp")});
    EXPECT_THAT(reads({"BISECT START"}),
                HasSubstr("BISECT sucht unter 3 Anwendungen; höchstens 3 Starts sind "
                          "noch nötig. Starten Sie Tessel erneut.\n"));
    EXPECT_THAT(reads({}), HasSubstr("BISECT hält bei diesem Start 2 von 3 Verdächtigen fern:\n"));
    EXPECT_THAT(reads({"BISECT BAD"}),
                HasSubstr("1 Anwendung ist noch verdächtig; höchstens 1 Start ist noch "
                          "nötig. Starten Sie Tessel erneut.\n"));
}

TEST_F(GermanPerson, ReadsWhatIsWrongInTheHostsWordsAndInThoseOfLisp)
{
    const std::string file = mSession.folder().write("open.lsp", "\n(car").string();
    EXPECT_THAT(
        reads({"(/ 1 0)", "(car 5)", "LOAD " + file, "APPS", "(quit)", "(defun f () (1+ (f)))", "(f)"}),
        AllOf(HasSubstr("\nDivision durch null.\n"), HasSubstr("\nIn function CAR, the value of"),
              HasSubstr("open.lsp:2: Der Ausdruck, der hier beginnt, wird nirgends geschlossen.\n"),
              HasSubstr(" Zeile 2: Der Ausdruck, der hier beginnt, wird nirgends geschlossen.\n"),
              HasSubstr("\nLisp kann den Host nicht beenden; geben Sie dazu QUIT ohne Klammern ein.\n"),
              HasSubstr("\nStapelüberlauf: Die Rekursion ist endlos oder zu tief.\n")));
    EXPECT_THAT(reads({"LOAD none.lsp", "(load \"" + mSession.folder().path().string() + "\")"}),
                HasSubstr("“ kann nicht geladen werden: ein Ordner.\n"));
}
TEST_F(GermanPerson, ReadsTheHelpOfTheCompilerAndWhatItRefuses)
{
    const auto compiler = std::filesystem::path(TESSEL_PROGRAM).parent_path() / "tesselc";
    mSession.startBy("'" + compiler.string() + "' --help; '" + compiler.string() + "' .");
    EXPECT_THAT(
        reads({}),
        AllOf(HasSubstr("Übersetzt eine Lisp-Datei für Tessel in Bytecode.\nAufruf: tesselc [OPTIONEN] "
                        "DATEI\n\nArgumente:\n  DATEI TEXT ERFORDERLICH "),
              HasSubstr("\nOptionen:\n  -h,--help                   Zeigt diese Hilfe und endet\n"),
              HasSubstr("\ntesselc: „.“ kann nicht geladen werden: ein Ordner.\n")));
}
} // namespace
