// What a person can do about a registry that is damaged: each sentence names a way out that is there.
#include <gmock/gmock.h>

#include <fstream>

#include "tests/e2e/Applications.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kSet[] = R"(REGISTRY SET Software\Trial name first)";
constexpr char kGet[] = R"(REGISTRY GET Software\Trial name)";
constexpr char kList[] = R"(REGISTRY LIST Software\Trial)";
constexpr std::size_t kVersionAt = 63; // the last byte of the version in the file's head

class Rescue : public testing::Test
{
protected:
    Rescue()
    {
        session.alwaysWith({"--safe"});
        EXPECT_EQ(session.run({kSet}).exitStatus, 0);
    }

    fs::path file() const { return session.profile() / "registry.db"; }
    fs::path beside(const std::string& ending) const { return file().string() + ending; }

    static void changeByte(const fs::path& path, std::size_t at, char byte)
    {
        std::fstream stream(path, std::ios::in | std::ios::out | std::ios::binary);
        stream.seekp(static_cast<std::streamoff>(at));
        stream.put(byte);
    }

    // Another value than the one whose checksum stands beside it.
    static void damage(const fs::path& path)
    {
        const std::string content = contentOf(path);
        changeByte(path, content.find("first"), 'w');
    }

    std::string said(const std::vector<std::string>& commands = {"VERSION"}, int status = 0) const
    {
        const auto result = session.run(commands);
        EXPECT_EQ(result.exitStatus, status) << result.output;
        return result.output;
    }

    HostSession session;
};
} // namespace

TEST_F(Rescue, WithoutACopyIsAnEmptyRegistry)
{
    damage(file());
    const std::string damaged = contentOf(file());
    fs::remove(beside(".sound"));
    EXPECT_THAT(said(),
                HasSubstr("is damaged: the value \"name\" in \"Software\\Trial\" is not what was stored "
                          "there. It was left as it is, and nothing will be stored. There is no copy of "
                          "an earlier state. REGISTRY RESET sets it aside and begins with an empty one."));
    EXPECT_THAT(
        said({"REGISTRY RESET", kSet}, 1),
        AllOf(HasSubstr("The registry " + file().string() + " is empty now; what stood there is kept as " +
                        file().string() +
                        ".damaged. Start Tessel again: this session stores nothing more.\n"),
              HasSubstr("cannot be written. Nothing is stored in the registry " + file().string() +
                        " before Tessel is started again, since another one was put in its place.\n")));
    EXPECT_EQ(contentOf(beside(".damaged")), damaged);
    EXPECT_THAT(said({kSet, kGet}), AllOf(HasSubstr("\nfirst\n"), Not(HasSubstr("The registry"))));
}

TEST_F(Rescue, DoesNotPromiseACopyThatIsDamagedItself)
{
    damage(file());
    damage(beside(".sound"));
    const std::string copy = contentOf(beside(".sound"));
    EXPECT_THAT(said(),
                AllOf(HasSubstr(" Its copy " + beside(".sound").string() +
                                " is of no use: the value \"name\" in \"Software\\Trial\" is not what was "
                                "stored there. REGISTRY RESET sets both aside and begins with an empty one."),
                      Not(HasSubstr("RESTORE"))));
    EXPECT_THAT(said({"REGISTRY RESET"}), HasSubstr("is empty now"));
    EXPECT_EQ(contentOf(beside(".sound.damaged")), copy);
    EXPECT_THAT(said({kSet}), Not(HasSubstr("The registry")));
}

TEST_F(Rescue, DoesNotPromiseACopyThatIsAFolder)
{
    damage(file());
    fs::remove(beside(".sound"));
    fs::create_directory(beside(".sound"));
    EXPECT_THAT(said(), HasSubstr("is of no use: it is a folder, not a file. REGISTRY RESET sets both"));
    EXPECT_THAT(said({"REGISTRY RESET"}), HasSubstr("is empty now"));
    EXPECT_THAT(said({kSet}), Not(HasSubstr("The registry")));
    EXPECT_THAT(said(), Not(HasSubstr("The registry")));
}

TEST_F(Rescue, ResetsNothingThatIsSoundOrHasASoundCopy)
{
    EXPECT_THAT(said({"REGISTRY RESET"}, 1), HasSubstr("is not known to be damaged; it was left as it is."));
    damage(file());
    const std::string damaged = contentOf(file());
    EXPECT_THAT(
        said({"REGISTRY RESET"}, 1),
        ContainsRegex("registry.db was left as it is: REGISTRY RESTORE puts back the copy of 2[-0-9]* "
                      "[0-9]*:[0-9]*\\.\n"));
    EXPECT_EQ(contentOf(file()), damaged);
}

TEST_F(Rescue, KeepsWhatWasKeptBefore)
{
    session.folder().write("profile/registry.db.damaged-2-wal", "somebody's");
    std::vector<std::string> damaged;
    for (const char* kept : {".damaged", ".damaged-3"})
    {
        damage(file());
        damaged.push_back(contentOf(file()));
        changeByte(file(), contentOf(file()).size() - 1, static_cast<char>('a' + damaged.size()));
        damaged.back() = contentOf(file());
        EXPECT_THAT(said({"REGISTRY RESTORE"}), HasSubstr("is kept as " + beside(kept).string() + ". Start"));
        EXPECT_EQ(contentOf(beside(kept)), damaged.back());
    }
    EXPECT_EQ(contentOf(beside(".damaged")), damaged.front());
    EXPECT_EQ(contentOf(beside(".damaged-2-wal")), "somebody's");
}

TEST_F(Rescue, IsNotStoppedByAFolderWithTheNameOfWhatIsKept)
{
    damage(file());
    fs::create_directory(beside(".damaged"));
    EXPECT_THAT(
        said({"REGISTRY RESTORE", kGet}),
        AllOf(HasSubstr("is kept as " + beside(".damaged-2").string() + "."), HasSubstr("\nfirst\n")));
    EXPECT_TRUE(fs::is_empty(beside(".damaged")));
}

TEST_F(Rescue, KnowsARegistryWhoseVersionIsDamaged)
{
    for (const char version : {'\0', '\x82', '\3'})
    {
        changeByte(file(), kVersionAt, version);
        EXPECT_THAT(said({"REGISTRY RESTORE", kGet}),
                    AllOf(HasSubstr("its version is damaged"),
                          HasSubstr("REGISTRY RESTORE puts back the copy of 2"),
                          HasSubstr("was restored from the copy of 2"), HasSubstr("\nfirst\n"),
                          Not(HasSubstr("belongs to another program"))));
    }
}

TEST_F(Rescue, LeavesAFileOfAnotherProgramToAPerson)
{
    fs::remove(file());
    ASSERT_EQ(runSql(file(), "CREATE TABLE contact(name TEXT); INSERT INTO contact VALUES('Ada')"), "");
    const std::string foreign = contentOf(file());
    EXPECT_THAT(said(),
                HasSubstr("cannot be used: it belongs to another program. It was left as it is, and nothing "
                          "will be stored. REGISTRY RESTORE puts back the copy of 2"));
    fs::remove(beside(".sound"));
    EXPECT_THAT(
        said({"REGISTRY RESET"}, 1),
        AllOf(HasSubstr(
                  "it belongs to another program. It was left as it is, and nothing will be stored. Move "
                  "that file elsewhere, or name another folder by --profile-dir, and start Tessel again."),
              HasSubstr("is not known to be damaged; it was left as it is.")));
    EXPECT_EQ(contentOf(file()), foreign);
}

TEST_F(Rescue, LeavesARegistryOfANewerTesselToIt)
{
    fs::remove(beside(".sound"));
    changeByte(file(), kVersionAt, '\3');
    EXPECT_THAT(
        said(),
        HasSubstr("cannot be used: it was written by a newer Tessel. It was left as it is, and nothing "
                  "will be stored. Use that Tessel, or name another folder by --profile-dir, and start "
                  "Tessel again.\n"));
}

// Every read in turn, from the first page to the look at all of them.
TEST_F(Rescue, DoesNotCallADiskThatDoesNotAnswerDamage)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    int told = 0;
    for (int read = 1; read <= 12; ++read)
    {
        session.set("MODRIG_FAULT", "pread " + std::to_string(read) + " once");
        const std::string output = session.run({kGet}).output;
        EXPECT_THAT(output, AllOf(Not(HasSubstr("damaged")), Not(HasSubstr("malformed")),
                                  Not(HasSubstr("error code"))))
            << read;
        told += output.find(": Input/output error. ") != output.npos &&
                output.find("If that does not help: REGISTRY RESTORE puts back the copy of 2") != output.npos;
    }
    EXPECT_GT(told, 5);
}

TEST_F(Rescue, RestoresWhatADiskDoesNotGiveBack)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    session.set("MODRIG_FAULT", "pread 5 once");
    EXPECT_THAT(session.run({"REGISTRY RESTORE", kGet}).output,
                AllOf(HasSubstr("was restored from the copy of 2"), HasSubstr("\nfirst\n")));
}

TEST_F(Rescue, DoesNotCallMissingWhatItMayNotAskFor)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    for (int call = 1; call <= 12; ++call)
        for (const char* duration : {" once", " ever"})
        {
            session.set("MODRIG_FAULT", "stat " + std::to_string(call) + duration);
            EXPECT_THAT(session.run({kGet}).output,
                        AllOf(Not(HasSubstr("missing")), Not(HasSubstr("There is no copy"))))
                << call << duration;
        }
}

TEST_F(Rescue, TellsDamageOfPagesInOneLine)
{
    std::string bytes = contentOf(file());
    bytes.replace(bytes.size() - 4096, 4096, std::string(4096, '\xA5'));
    session.folder().write("profile/registry.db", bytes);
    EXPECT_THAT(said(), AllOf(ContainsRegex("registry.db is damaged: [^\n]*\\. It was left as it is"),
                              Not(HasSubstr("***"))));
}

TEST_F(Rescue, CallsAKeyDamagedWhoseRowsAre)
{
    const std::string thatKey = "\nThe registry key \"Software\\Trial\" cannot be read";
    const std::string isDamaged = ". The registry " + file().string() + " is damaged: ";
    damage(file());
    const std::string value =
        "the value \"name\" in \"Software\\Trial\" is not what was stored there. It was";
    EXPECT_THAT(said({kGet}, 1), HasSubstr(thatKey + isDamaged + value));
    EXPECT_THAT(said({kList}, 1), HasSubstr(thatKey + " to its end" + isDamaged + value));
    ASSERT_EQ(runSql(file(), "UPDATE key SET name='Trail' WHERE name='Trial'"), "");
    for (const char* command : {kList, kGet, R"(REGISTRY DELETE Software\Trial)"})
        EXPECT_THAT(said({command}, 1), AllOf(HasSubstr(thatKey + isDamaged +
                                                        "the key \"Trail\" in \"Software\" is not what was"),
                                              Not(HasSubstr("does not exist"))))
            << command;
}
