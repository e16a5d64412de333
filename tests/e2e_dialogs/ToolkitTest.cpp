// What the toolkit brings along: programs of its own, settings, complaints.
#include "tests/e2e_dialogs/DialogTest.h"
#include "tests/support/Content.h"

#include <fstream>
#include <iterator>

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr std::chrono::seconds kSoon{4};

class DialogToolkit : public DialogTest
{
protected:
    int helpers() const
    {
        int count = 0;
        const std::string own = "TEMP=" + (mSession.folder() / "tessel-").string();
        for (const auto& process : std::filesystem::directory_iterator("/proc"))
        {
            const std::string name = contentOf(process.path() / "comm");
            if ((name == "gpbs\n" || name == "gdnc\n") &&
                contentOf(process.path() / "environ").find(own) != std::string::npos)
                ++count;
        }
        return count;
    }
};
} // namespace

TEST_F(DialogToolkit, HasHelperProgramsThatEndWithTheSession)
{
    open();
    EXPECT_GE(helpers(), 1);
    closeAndEnd();
    EXPECT_TRUE(comesTrue([this] { return helpers() == 0; }, kSoon)) << helpers();
}

TEST_F(DialogToolkit, HasHelperProgramsThatEndWithASessionThatIsKilled)
{
    open();
    EXPECT_GE(helpers(), 1);
    mHost.reset();
    EXPECT_TRUE(comesTrue([this] { return helpers() == 0; }, kSoon)) << helpers();
}

TEST_F(DialogToolkit, ComplainsIntoALogOfTheProfile)
{
    mSession.folder().write("profile/toolkit/Defaults/NSGlobalDomain.plist",
                            "{ \"GNU-Debug\" = (NSScrollView); }\n"); // makes it talk
    open();
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, Not(HasSubstr("reflectScrolledClipView")));
    EXPECT_THAT(contentOf(mSession.profile() / "toolkit" / "log.txt"), HasSubstr("reflectScrolledClipView"));
}

TEST_F(DialogToolkit, ReadsItsSettingsInAProfileFolderWhoseNameIsNoText)
{
    mSession.nameProfile("profil\xE9");
    setSetting("InitialPath", files().string());
    setToolkitSetting("GSScaleFactor", "1.2");
    writeLisp("a.lsp");
    open();
    EXPECT_THAT(mScreen.sizeOf(mDialog), testing::StartsWith("900x"));
    press("Down");
    press("Return");
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("error of the toolkit")));
}

// A lock in the person's home, left by a program that was killed, would hold up every start.
TEST(ToolkitWithoutWindows, LocksItsSettingsInTheProfileFromTheFirstApplicationOn)
{
    const HostSession session;
    const auto settings = session.profile() / "toolkit/Defaults";
    std::filesystem::create_directories(settings); // where there is none, it locks nothing
    EXPECT_EQ(session.run({"APPS"}).exitStatus, 0);
    EXPECT_TRUE(std::filesystem::exists(settings / ".lck"));
}
