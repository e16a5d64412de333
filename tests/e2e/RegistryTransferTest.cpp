// Parts of the registry that go to files and come back, as a person types it.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::Not;

namespace
{
const std::string kBegin = "Windows Registry Editor Version 5.00\n\n";

class RegistryTransfer : public testing::Test
{
protected:
    void expectWell(const HostResult& result, const std::string& sentence = {})
    {
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output, HasSubstr(sentence));
    }
    // What the command answers.
    std::string answer(const std::string& command)
    {
        const std::string output = session.run({command}).output;
        const std::string typed = "Command: " + command + "\n";
        return output.substr(output.find(typed) + typed.size());
    }
    void expectRefused(const std::string& command, const std::string& sentence)
    {
        const HostResult result = session.run({command});
        EXPECT_EQ(result.exitStatus, 1) << result.output;
        EXPECT_THAT(result.output, HasSubstr(sentence));
    }

    HostSession session;
    const fs::path file = session.folder() / "some settings.reg";
    const std::string quotedFile = "\"" + file.string() + "\"";
};
} // namespace

TEST_F(RegistryTransfer, TakesATreeToAnotherProfileAsItWas)
{
    expectWell(session.run({"REGISTRY SET Software\\My", "REGISTRY SET Software\\My second 2",
                            "REGISTRY SET Software\\My first \"C:\\a b\"",
                            "REGISTRY SET Software\\My\\Zz x y", "REGISTRY SET Software\\My\\Aa \"\" unnamed",
                            "REGISTRY SET Software\\My\\Aa\\Deep z \"\""}));
    for (const std::string form : {"", " UTF8"})
    {
        session.nameProfile("profile");
        expectWell(session.run({"REGISTRY EXPORT Software\\My " + quotedFile + form}),
                   "Exported to " + file.string() + ": 4 keys with 5 values.\n");
        session.nameProfile("other" + form);
        expectWell(session.run({"REGISTRY IMPORT " + quotedFile}),
                   "Imported from " + file.string() + ": 4 keys with 5 values.\n");
        EXPECT_EQ(answer("REGISTRY LIST Software\\My"), "[Zz]\n[Aa]\nsecond = 2\nfirst = C:\\a b\n");
        EXPECT_EQ(answer("REGISTRY LIST Software\\My\\Aa"), "[Deep]\n(unnamed) = unnamed\n");
        EXPECT_EQ(answer("REGISTRY LIST Software\\My\\Aa\\Deep"), "z = \n");
    }
}

TEST_F(RegistryTransfer, TakesEverythingFromTheRoot)
{
    expectWell(session.run({"REGISTRY SET Top a b", "REGISTRY EXPORT \"\" " + quotedFile + " utf-8"}));
    EXPECT_THAT(contentOf(file), HasSubstr("\r\n[HKEY_CURRENT_USER]\r\n\r\n"));
    EXPECT_THAT(contentOf(file), HasSubstr("\r\n[HKEY_CURRENT_USER\\Top]\r\n\"a\"=\"b\"\r\n"));
}

TEST_F(RegistryTransfer, ChangesAndRemovesWhatTheFileNames)
{
    session.folder().write(
        file.filename(),
        kBegin + "[-HKCU\\Old]\n[-HKCU\\NeverThere]\n[HKCU\\My]\n\"a\"=\"new\"\n\"b\"=-\n\"c\"=-\n");
    expectWell(session.run({"REGISTRY SET Old\\Below x y", "REGISTRY SET My A old", "REGISTRY SET My b old",
                            "REGISTRY SET My kept 1", "REGISTRY IMPORT " + quotedFile}));
    EXPECT_THAT(answer("REGISTRY LIST"), Not(HasSubstr("Old")));
    EXPECT_EQ(answer("REGISTRY LIST My"), "A = new\nkept = 1\n");
}

TEST_F(RegistryTransfer, OfAStartupSuiteIsLoadedAtTheNextStartWhateverModrigWasContentWith)
{
    const std::string command = "REGISTRY EXPORT " + std::string(kSuiteKey) + " " + quotedFile;
    storeSuite(session, {sample("hilbert.lsp")});
    expectWell(session.run({command}));
    storeSuite(session, {});
    expectWell(session.run({"APPS"}));
    expectWell(session.run({"APPS"}), "No application is loaded.\n");
    expectWell(session.run({"REGISTRY IMPORT " + quotedFile}));
    expectWell(session.run({"APPS"}), listed(sample("hilbert.lsp"), "Lisp"));
}

TEST_F(RegistryTransfer, ChangesNothingFromAFileThatIsDamaged)
{
    session.folder().write(file.filename(), kBegin + "[HKCU\\My]\n\"a\"=\"new\"\n\"b\"=dword:1\n");
    expectRefused("REGISTRY IMPORT " + quotedFile, "The file " + file.string() +
                                                       " is not imported: in line 5 a value stands that is "
                                                       "no text, and the registry holds texts alone.\n");
    EXPECT_THAT(session.run({"REGISTRY LIST My"}).output, HasSubstr("does not exist"));
}

TEST_F(RegistryTransfer, SaysWhyAFileIsNotRead)
{
    expectRefused("REGISTRY IMPORT " + quotedFile,
                  "The file " + file.string() + " is not imported: No such file");
    fs::create_directory(file);
    expectRefused("REGISTRY IMPORT " + quotedFile, "is not imported: it is ");
    expectRefused("REGISTRY EXPORT \"\" " + quotedFile, "is not exported to " + file.string() + ": it is ");
}

TEST_F(RegistryTransfer, DoesNotReplaceAFileOfAnotherKind)
{
    session.folder().write(file.filename(), "my notes");
    expectRefused("REGISTRY EXPORT \"\" " + quotedFile,
                  "another file stands there, which is no registry file.\n");
    EXPECT_EQ(contentOf(file), "my notes");
    expectRefused("REGISTRY EXPORT No\\Such " + quotedFile,
                  "The registry key \"No\\Such\" is not exported to " + file.string() +
                      ": there is no such key.\n");
}

TEST_F(RegistryTransfer, TakesNoKeyThatLiesTooDeepToBeRemovedAgain)
{
    const auto importBelow = [this](int depth)
    {
        std::string key = "[HKCU\\Deep";
        for (int level = 1; level < depth; ++level)
            key += "\\a";
        session.folder().write(file.filename(), kBegin + key + "]\n\"a\"=\"b\"\n");
        return "REGISTRY IMPORT " + quotedFile;
    };
    expectRefused(importBelow(513), "is not imported: in line 3 a key lies below more than 511 others.\n");
    expectWell(session.run({importBelow(512)}));
    expectWell(session.run({"REGISTRY DELETE Deep"}));
    EXPECT_THAT(answer("REGISTRY LIST"), Not(HasSubstr("Deep")));
}

// What is laid out for everybody is to be read by everybody.
TEST_F(RegistryTransfer, WritesAFileThatOthersMayReadAsTheyMayAllThatThePersonWrites)
{
    const auto rightsAfterExportWith = [this](const std::string& mask)
    {
        session.startBy("umask " + mask + " && exec \"$0\" \"$@\"");
        expectWell(session.run({"REGISTRY SET My a b", "REGISTRY EXPORT My " + quotedFile}));
        return static_cast<unsigned>(fs::status(file).permissions());
    };
    EXPECT_EQ(rightsAfterExportWith("022"), 0644u);
    EXPECT_EQ(rightsAfterExportWith("077"), 0644u) << "as the file that stood there";
    fs::remove(file);
    EXPECT_EQ(rightsAfterExportWith("077"), 0600u);
}

TEST_F(RegistryTransfer, LeavesTheFilesOfOthersInTheFolderAlone)
{
    const auto others = session.folder().write(".part-1 of a download", "somebody's");
    expectWell(session.run({"REGISTRY SET My a b", "REGISTRY EXPORT My " + quotedFile}));
    EXPECT_TRUE(fs::exists(others));
}

TEST_F(RegistryTransfer, StoresNothingInARegistryThatMayOnlyBeRead)
{
    expectWell(session.run({"REGISTRY SET My a old"}));
    session.folder().write(file.filename(), kBegin + "[HKCU\\My]\n\"a\"=\"new\"\n");
    fs::permissions(session.profile() / "registry.db", fs::perms::owner_read);
    session.startBoundByRights();
    const auto result = session.run({"REGISTRY IMPORT " + quotedFile});
    EXPECT_EQ(result.exitStatus, 1) << result.output;
    EXPECT_THAT(result.output, HasSubstr("is not imported: "));
}

// Twenty thousand values in one transaction.
TEST_F(RegistryTransfer, TakesManyValuesAtOnce)
{
    std::string text = kBegin + "[HKCU\\Many]\n";
    for (int number = 0; number < 20000; ++number)
        text += "\"value" + std::to_string(number) + "\"=\"/a/path/of/an/application/tool" +
                std::to_string(number) + "\"\n";
    session.folder().write(file.filename(), text);
    expectWell(session.run({"REGISTRY IMPORT " + quotedFile}), "1 key with 20000 values.\n");
    EXPECT_EQ(answer("REGISTRY GET Many value19999"), "/a/path/of/an/application/tool19999\n");
}

TEST_F(RegistryTransfer, IsToldItsUsageWhenSomethingIsMissing)
{
    for (const std::string command :
         {"REGISTRY EXPORT My", "REGISTRY EXPORT My x.reg UTF32", "REGISTRY IMPORT"})
        expectRefused(command, "EXPORT key file [UTF8]\n       REGISTRY IMPORT file");
}
