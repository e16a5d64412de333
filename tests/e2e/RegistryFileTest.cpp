// What becomes of a session whose registry file is damaged, not writable, or shared between sessions.
#include <gmock/gmock.h>

#include <fstream>

#include <sys/stat.h>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"

using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;

namespace
{
constexpr char kSet[] = R"(REGISTRY SET Software\Trial "a name" "größe 100%s")";
constexpr char kGet[] = R"(REGISTRY GET software\TRIAL "A NAME")";
} // namespace

TEST(RegistryFile, KeepsFromOneSessionToTheNext)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    const auto result = session.run({kGet, R"(REGISTRY LIST Software\Trial)"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("\ngröße 100%s\n"), HasSubstr("a name = größe 100%s")));
}

TEST(RegistryFile, ForgetsWhatIsDeleted)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet, R"(REGISTRY DELETE Software\Trial "A Name")"}).exitStatus, 0);
    EXPECT_EQ(session.run({kGet}).exitStatus, 1);
    EXPECT_EQ(session.run({R"(REGISTRY DELETE Software\Trial)"}).exitStatus, 0);
    EXPECT_EQ(session.run({R"(REGISTRY LIST Software\Trial)"}).exitStatus, 1);
}

TEST(RegistryFile, ThatIsNoDatabaseIsToldAndLeftAlone)
{
    const HostSession session;
    const std::string content = "This is a letter, not a database. " + std::string(5000, 'x');
    session.folder().write("profile/registry.db", content);
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr((session.profile() / "registry.db").string()),
                                     HasSubstr("Command: VERSION\nTessel R21")));
    std::ifstream file(session.profile() / "registry.db", std::ios::binary);
    const std::string after{std::istreambuf_iterator<char>(file), {}};
    EXPECT_TRUE(after == content);
}

TEST(RegistryFile, MarkedReadOnlyIsReadAndKeepsWhatItHolds)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    ASSERT_EQ(chmod((session.profile() / "registry.db").c_str(), S_IRUSR), 0);
    const auto result = session.run({R"(REGISTRY SET Software\Trial "a name" new)", kGet});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, AllOf(HasSubstr("cannot be written. "), HasSubstr("\ngröße 100%s\n")));
}

TEST(RegistryFile, KeepsWhatItHoldsWhenItMayNotGrow)
{
    HostSession session;
    session.alwaysWith({"--safe"}); // Modrig would write, too
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    session.startBy("ulimit -f 80; exec \"$0\" \"$@\""); // in blocks of 512 bytes
    const auto result = session.run({"REGISTRY SET Software\\Trial big " + std::string(100'000, 'x'), kGet});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                AllOf(HasSubstr((session.profile() / "registry.db").string()), HasSubstr("\ngröße 100%s\n")));
    session.startBy("exec \"$0\" \"$@\"");
    EXPECT_EQ(session.run({kGet}).exitStatus, 0);
}

TEST(RegistryFile, IsToldWhenItCannotBeMade)
{
    const HostSession session;
    session.folder().write("profile/registry.db/in the way", ""); // a folder of that name
    const auto result = session.run({kSet, "VERSION"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, AllOf(HasSubstr((session.profile() / "registry.db").string()),
                                     HasSubstr("Command: VERSION\nTessel R21")));
}

TEST(RegistryFile, ThatIsNoFileIsToldAsWhatItIs)
{
    const HostSession session;
    std::filesystem::create_directories(session.profile() / "registry.db");
    EXPECT_THAT(session.run({"VERSION"}).output,
                HasSubstr("registry.db cannot be used: it is a folder, not a file. It was left"));
    std::filesystem::remove(session.profile() / "registry.db");
    ASSERT_EQ(mkfifo((session.profile() / "registry.db").c_str(), 0600), 0);
    EXPECT_THAT(session.run({"VERSION"}).output,
                HasSubstr("registry.db cannot be used: it is not an ordinary file. It was left"));
}

TEST(RegistryFile, ThatIsNoFileGivesWayToTheCopy)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    const auto file = session.profile() / "registry.db";
    for (const bool isFolder : {true, false})
    {
        std::filesystem::remove(file);
        ASSERT_TRUE(isFolder ? std::filesystem::create_directory(file) : mkfifo(file.c_str(), 0600) == 0);
        const auto result = session.run({"REGISTRY RESTORE", kGet});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output,
                    AllOf(HasSubstr("REGISTRY RESTORE puts back the copy of 2"),
                          HasSubstr("kept as " + file.string() + ".damaged"), HasSubstr("\ngröße 100%s\n")));
        EXPECT_TRUE(std::filesystem::exists(file.string() + ".damaged"));
    }
}

// Once by the look at its opening; that what is read of it then is wrong too is no news.
TEST(RegistryFile, WithADamagedRowIsToldOnceAtAStart)
{
    const HostSession session;
    storeSuite(session, {fixtureModule("Good.zmb"), fixtureModule("Good.omp")});
    const auto file = session.profile() / "registry.db";
    std::string content = contentOf(file);
    ASSERT_NE(content.find("Good.zmb"), content.npos);
    for (auto at = content.find("Good.zmb"); at != content.npos; at = content.find("Good.zmb"))
        content[at] = 'F';
    session.folder().write("profile/registry.db", content);
    const std::string said = session.run({"VERSION"}).output;
    const std::string start = "The registry " + file.string() + " ";
    EXPECT_THAT(said, HasSubstr(start + "is damaged: the value \"1Startup\""));
    EXPECT_EQ(said.find(start), said.rfind(start)) << said;
    EXPECT_TRUE(contentOf(file) == content);
}

TEST(RegistryFile, LosesWhatAKilledSessionHasLeftOfItsCopy)
{
    const HostSession session;
    const auto part = session.folder().write("profile/.tessel-part-AbCdEf", "half a copy");
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    EXPECT_FALSE(std::filesystem::exists(part));
    const auto copy = session.profile() / "registry.db.sound";
    EXPECT_EQ(static_cast<unsigned>(std::filesystem::status(copy).permissions()), 0600u);
}

TEST(RegistryFile, ThatIsMissingIsRestoredWithoutMentionOfWhatStoodThere)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    std::filesystem::remove(session.profile() / "registry.db");
    const auto result = session.run({"REGISTRY RESTORE", kGet});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("was restored from the copy of 2"),
                                     ContainsRegex(":[0-9][0-9]\\. Start Tessel again: this session"),
                                     HasSubstr("\ngröße 100%s\n")));
}

TEST(RegistryFile, LeavesNoFilesBesideTheCopyThatIsPutBack)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    std::filesystem::remove(session.profile() / "registry.db");
    ASSERT_EQ(session.run({"REGISTRY RESTORE"}).exitStatus, 0);
    EXPECT_TRUE(std::filesystem::exists(session.profile() / "registry.db.sound"));
    for (const char* ending : {"-wal", "-shm"})
        EXPECT_FALSE(
            std::filesystem::exists(session.profile() / ("registry.db.sound" + std::string(ending))));
}

TEST(RegistryFile, ThatTakesNothingEndsItsSentencesOnce)
{
    const HostSession session;
    ASSERT_EQ(session.run({kSet}).exitStatus, 0);
    const auto file = session.profile() / "registry.db";
    ASSERT_EQ(chmod(file.c_str(), S_IRUSR), 0);
    const auto result = session.run({kSet, R"(REGISTRY DELETE Software\Trial)"});
    const std::string reason = " cannot be written. The registry " + file.string() +
                               " may only be read: what is stored there is used, and nothing new will be "
                               "stored.\n";
    EXPECT_THAT(result.output,
                AllOf(HasSubstr(std::string(kSet) + "\nThe registry key \"Software\\Trial\"" + reason),
                      HasSubstr("DELETE Software\\Trial\nThe registry key \"Software\\Trial\"" + reason)));
}

TEST(ProfileFolder, IsToldWhenItCannotBeMade)
{
    const HostSession session;
    session.folder().write("profile", "a file");
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr(session.profile().string()));
}

TEST(Profiles, CanBeChanged)
{
    const HostSession session;
    EXPECT_THAT(session.run({"PROFILE"}).output, HasSubstr("\nDefault\n"));
    EXPECT_EQ(session.run({"PROFILE \"Zweites Büro\""}).exitStatus, 0);
    EXPECT_THAT(session.run({"PROFILE"}).output, HasSubstr("\nZweites Büro\n"));
    EXPECT_EQ(session.run({R"(PROFILE a\b)"}).exitStatus, 1);
}
