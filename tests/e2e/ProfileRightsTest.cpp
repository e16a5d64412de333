// Whose profile it is.
#include <gmock/gmock.h>

#include <sys/stat.h>
#include <unistd.h>

#include "tests/e2e/Applications.h"

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::Not;

namespace
{
mode_t rightsOf(const fs::path& path)
{
    struct stat status = {};
    EXPECT_EQ(stat(path.c_str(), &status), 0) << path;
    return status.st_mode & 07777;
}

class ProfileRights : public testing::Test
{
protected:
    // Starts a host on a profile that is there already and can be used with these rights.
    std::string outputWith(mode_t rights)
    {
        fs::create_directories(session.profile());
        chmod(session.profile().c_str(), rights);
        const auto result = session.run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_EQ(rightsOf(session.profile()), rights) << "they are the person's to change";
        return result.output;
    }

    std::string notSafe(const std::string& reason) const
    {
        return "The profile folder " + session.profile().string() + " is not safe: " + reason +
               " and so decide what Tessel loads. This puts it right: chmod 700 " +
               session.profile().string() + "\n";
    }

    // What a start says when others may enter the folder, and something in it has these rights.
    std::string outputWithInside(const std::string& name, mode_t rights, mode_t rightsOfFolder = 0755)
    {
        const auto kept = session.folder().write("one.lsp", "").string();
        EXPECT_EQ(session.run({"DISABLE " + kept}).exitStatus, 0);
        chmod((session.profile() / name).c_str(), rights);
        std::string output = outputWith(rightsOfFolder);
        EXPECT_EQ(rightsOf(session.profile() / name), rights) << "they are the person's to change";
        return output;
    }

    std::string notSafeInside(const std::string& name, const std::string& reason) const
    {
        return (session.profile() / name).string() + " is not safe: " + reason +
               " and so decide what Tessel loads. This puts it right: chmod " +
               (name == "applications" ? "700 " : "600 ") + (session.profile() / name).string() + "\n";
    }

    HostSession session;
};
} // namespace

TEST_F(ProfileRights, OfANewOneAreThePersonsAlone)
{
    session.startBy("umask 0; exec \"$0\" \"$@\"");
    ASSERT_EQ(session.run({"VERSION"}).exitStatus, 0);
    EXPECT_EQ(rightsOf(session.profile()), 0700u);
}

TEST_F(ProfileRights, OfThePersonsOwnFolderAreTheirsAlone)
{
    session.startBy("umask 0; shift 2; exec \"$0\" \"$@\"");
    ASSERT_EQ(session.run({"VERSION"}).exitStatus, 0);
    EXPECT_EQ(rightsOf(session.folder() / "home/.local/share/Tessel"), 0700u);
}

TEST_F(ProfileRights, OfOthersToWriteAreTold)
{
    EXPECT_THAT(outputWith(0770), HasSubstr(notSafe("other users may write to it")));
    EXPECT_THAT(outputWith(0707), HasSubstr(notSafe("other users may write to it")));
}

TEST_F(ProfileRights, OfOthersToReadAreNoReasonForASentence)
{
    EXPECT_THAT(outputWith(0755), Not(HasSubstr("not safe")));
}

TEST_F(ProfileRights, OfAnotherUserAreTold)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "only the administrator can give a folder away";
    fs::create_directories(session.profile());
    ASSERT_EQ(chown(session.profile().c_str(), 12345, 12345), 0);
    EXPECT_THAT(outputWith(0755),
                HasSubstr("is not safe: it belongs to another user, who could change what Tessel loads.\n"));
}

TEST_F(ProfileRights, ThatLetNobodyIntoTheFolderOfApplicationsAreToldOnce)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "only the administrator can be somebody without rights";
    constexpr uid_t kSomebody = 12345;
    const auto applications = session.profile() / "applications";
    fs::create_directories(applications);
    for (const auto& path : {session.folder().path(), session.profile(), applications})
        ASSERT_EQ(chown(path.c_str(), kSomebody, kSomebody), 0);
    chmod(applications.c_str(), 0);
    session.startBy("exec setpriv --reuid 12345 --regid 12345 --clear-groups \"$0\" \"$@\"");
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.output,
              kBanner +
                  ("The folder " + applications.string() +
                   " cannot be entered: what ends Tessel cannot be remembered, and nothing is kept out in "
                   "this session. This puts it right: chmod 700 " +
                   applications.string() + "\nCommand: VERSION\n" + kVersionLine));
}

TEST_F(ProfileRights, AreAskedOfTheRegistryInIt)
{
    EXPECT_THAT(outputWithInside("registry.db", 0666),
                HasSubstr("The registry " + notSafeInside("registry.db", "other users may write to it")));
}

TEST_F(ProfileRights, AreAskedOfTheFolderOfTheKeptOutApplications)
{
    EXPECT_THAT(outputWithInside("applications", 0777),
                HasSubstr("The folder " + notSafeInside("applications", "other users may write to it")));
}

TEST_F(ProfileRights, AreAskedOfTheListOfTheKeptOutApplications)
{
    EXPECT_THAT(
        outputWithInside("applications/kept-out", 0620),
        HasSubstr("The file " + notSafeInside("applications/kept-out", "other users may write to it")));
}

TEST_F(ProfileRights, OfFilesThatNobodyElseReachesAreNoReasonForASentence)
{
    EXPECT_THAT(outputWithInside("registry.db", 0666, 0700), Not(HasSubstr("not safe")));
}

TEST_F(ProfileRights, AreAskedOfTheFolderBehindALink)
{
    fs::create_directories(session.folder() / "elsewhere");
    chmod((session.folder() / "elsewhere").c_str(), 0777);
    fs::create_directory_symlink(session.folder() / "elsewhere", session.profile());
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("elsewhere is not safe: other users may write to it"));
}
