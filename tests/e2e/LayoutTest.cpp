// What an administrator lays out for everybody who starts Tessel on a machine.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

namespace
{
class Layout : public testing::Test
{
protected:
    Layout()
    {
        session.alwaysWith({"--layout-dir", (session.folder() / "layout").string()});
        std::filesystem::create_directories(session.folder() / "layout");
    }

    std::string apps() { return session.run({"APPS"}).output; }

    HostSession session;
};
} // namespace

TEST_F(Layout, OfASuiteIsLoadedByEverybody)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp"))) << "and at the second start";
    session.nameProfile("another");
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
}

TEST_F(Layout, GivesWayToAPersonsOwnSuite)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    storeSuite(session, {sample("calendar.qbc")});
    EXPECT_THAT(apps(), EndsWith(listed(sample("calendar.qbc"), "Lisp")));
    EXPECT_THAT(apps(), Not(HasSubstr("hilbert.lsp")));
}

TEST_F(Layout, ThatIsPolicyStandsBeforeAPersonsOwnSuite)
{
    layOutSuite(session, "policy/suite.reg", sample("hilbert.lsp"));
    storeSuite(session, {sample("calendar.qbc")});
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
    EXPECT_THAT(apps(), Not(HasSubstr("calendar.qbc")));
}

TEST_F(Layout, ThatIsPolicyCannotBeTakenOutAndThePersonIsTold)
{
    layOutSuite(session, "policy/suite.reg", sample("hilbert.lsp"));
    const std::string key = kSuiteKey;
    const auto file = (session.folder() / "layout/policy/suite.reg").string();
    const auto removed = session.run({"REGISTRY DELETE " + key + " 1Startup"});
    EXPECT_EQ(removed.exitStatus, 1);
    EXPECT_THAT(removed.output,
                HasSubstr("has the value \"1Startup\" from the administrator, which stays.\n"));
    EXPECT_THAT(session.run({"REGISTRY DELETE " + key}).output,
                HasSubstr("is laid out by the administrator and stays.\n"));
    EXPECT_THAT(session.run({"REGISTRY SET " + key + " NumStartup 0"}).output,
                HasSubstr("\nValues of \"" + key + "\" are laid down by the administrator, in " + file +
                          ": what is changed in them does not count.\n"));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
    EXPECT_THAT(session.run({"REGISTRY LIST " + key}).output,
                EndsWith("NumStartup = 1    (from " + file + ")\n1Startup = " + sample("hilbert.lsp") +
                         "    (from " + file + ")\n"));
}

TEST_F(Layout, OfASuiteIsLoadedAgainAfterItWasOutOfReach)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
    const auto layout = session.folder() / "layout";
    const auto away = session.folder() / "away";
    std::filesystem::rename(layout, away);
    std::filesystem::create_directories(layout);
    EXPECT_THAT(apps(), EndsWith("Command: APPS\n" + listed(modrigBundle())));
    EXPECT_THAT(apps(), EndsWith("Command: APPS\nNo application is loaded.\n"));
    std::filesystem::remove(layout);
    std::filesystem::rename(away, layout);
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp"))) << "and at the start after that";
}

TEST_F(Layout, ThatIsPolicyReachesWhoHasEmptiedTheirSuite)
{
    storeSuite(session, {sample("calendar.qbc")});
    apps();
    storeSuite(session, {});
    apps();
    EXPECT_THAT(apps(), EndsWith("Command: APPS\nNo application is loaded.\n"));
    layOutSuite(session, "policy/suite.reg", sample("hilbert.lsp"));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
}

TEST_F(Layout, OfASuiteIsLoadedOnceItsProfileIsTheCurrentOne)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    for (int start = 0; start < 2; ++start)
        session.run({"PROFILE empty"});
    ASSERT_THAT(apps(), EndsWith("Command: APPS\nNo application is loaded.\n"));
    session.run({"PROFILE Default"});
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
}

TEST_F(Layout, IsNotLookedAtForAProfileThatIsTheCurrentOneAlready)
{
    storeSuite(session, {sample("calendar.qbc")});
    apps();
    storeSuite(session, {});
    apps();
    ASSERT_THAT(apps(), EndsWith("Command: APPS\nNo application is loaded.\n"));
    session.run({"PROFILE DEFAULT"});
    EXPECT_THAT(apps(), EndsWith("Command: APPS\nNo application is loaded.\n"));
}

// In a safe session nothing of it was loaded; only the layout knows the whole path.
TEST_F(Layout, OfASuiteIsKnownToDisableByItsNames)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    session.alwaysWith({"--layout-dir", (session.folder() / "layout").string(), "--safe"});
    const auto disabled = session.run({"DISABLE hilbert.lsp"});
    EXPECT_EQ(disabled.exitStatus, 0) << disabled.output;
    EXPECT_THAT(disabled.output, HasSubstr(sample("hilbert.lsp")));
}

TEST_F(Layout, ThatIsDamagedIsToldAtEveryStartAndDoesNotCount)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    const auto file = session.folder().write("layout/zz.reg", "damaged");
    EXPECT_THAT(apps(),
                HasSubstr("\nThe values for everybody in " + file.string() + " do not count: in line 1 "));
    EXPECT_THAT(apps(), EndsWith(listed(sample("hilbert.lsp"), "Lisp")));
}

TEST_F(Layout, ThatIsABottomlessKeyDoesNotCountAndHarmsNothing)
{
    std::string key = "[HKCU\\Deep";
    for (int level = 0; level < 200000; ++level)
        key += "\\a";
    session.folder().write("layout/deep.reg", "Windows Registry Editor Version 5.00\n\n" + key + "]\n");
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("deep.reg do not count: in line 3 a key lies below more than"));
}

TEST_F(Layout, InAFolderThatCannotBeReadIsToldAndDoesNotCount)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    const auto layout = session.folder() / "layout";
    session.startBoundByRights();
    for (const auto& folder : {layout / "policy", layout})
    {
        std::filesystem::create_directories(folder);
        std::filesystem::permissions(folder, std::filesystem::perms::none);
        EXPECT_THAT(apps(), HasSubstr("\nThe values for everybody in " + folder.string() +
                                      " do not count: Permission denied.\n"));
        std::filesystem::permissions(folder, std::filesystem::perms::owner_all);
    }
}

TEST(LayoutFolder, ThatIsToBeTriedHasToBeThere)
{
    const HostSession session;
    const auto file = session.folder().write("a.reg", "").string();
    for (const std::string& folder : {file, (session.folder() / "none").string()})
    {
        const auto refused = session.start({"--layout-dir", folder, "-c", "VERSION"});
        EXPECT_EQ(refused.exitStatus, 2) << folder;
        EXPECT_THAT(refused.output, HasSubstr("--layout-dir: " + folder + " is no folder\n"));
    }
}

TEST_F(Layout, IsNotPartOfWhatAPersonExports)
{
    layOutSuite(session, "suite.reg", sample("hilbert.lsp"));
    const auto file = session.folder() / "mine.reg";
    const auto exported = session.run({"REGISTRY EXPORT " + std::string(kSuiteKey) + " " + file.string()});
    EXPECT_THAT(exported.output, HasSubstr("there is no such key.\n"));
}
