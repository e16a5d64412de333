// Two hosts of one person, on one display: what serves the windows of the one is not the other's to take
// away.
#include <filesystem>

#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace fs = std::filesystem;

namespace
{
class TwoHostsOnOneDisplay : public DialogTest
{
protected:
    // The first host stays in mHost until it ends; from then on the hands are on the second.
    void openBoth()
    {
        open();
        openTheSecond();
    }

    void openTheSecond()
    {
        mFirst = std::move(mHost);
        const std::string first = mDialog;
        mHost = std::make_unique<Program>(mSession.commandLine({}), mSession.environment(),
                                          mSession.folder() / "second.txt");
        mHost->type("MODRIG");
        mDialog = mScreen.waitForAnotherWindow(kDialog, first);
        ASSERT_FALSE(mDialog.empty()) << mHost->output();
        ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    }

    void endTheFirst()
    {
        mFirst->signal(SIGTERM);
        EXPECT_EQ(mFirst->waitForEnd(), 128 + SIGTERM) << mFirst->output();
        ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
        shoot("first-has-ended");
    }

    std::string clipboard() const
    {
        Program reader({"/usr/bin/python3", CLIPBOARD}, mScreen.environment(),
                       mSession.folder() / "clipboard.txt");
        EXPECT_TRUE(reader.endsByItself());
        return reader.output();
    }

    void expectAGoodEnd()
    {
        EXPECT_THAT(closeAndEnd(), AllOf(Not(HasSubstr("error of the toolkit")), Not(HasSubstr("threw")),
                                         HasSubstr("QUIT")));
    }

    std::vector<std::string> whatSessionsLeft() const
    {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(mSession.folder().path()))
            if (entry.path().filename().string().starts_with("tessel-"))
                names.push_back(entry.path().filename());
        return names;
    }

    std::unique_ptr<Program> mFirst;
};
} // namespace

TEST_F(TwoHostsOnOneDisplay, CopyAndPasteInTheSecondAfterTheFirstHasEnded)
{
    openBoth();
    typeName("a name");
    press("ctrl+a");
    press("ctrl+c");
    EXPECT_TRUE(comesTrue([this] { return clipboard() == "a name\n"; })) << clipboard();
    endTheFirst();
    press("ctrl+a");
    press("ctrl+c");
    EXPECT_EQ(clipboard(), "a name\n");
    const Program other({"/usr/bin/python3", CLIPBOARD, (files() / "b.lsp").string()}, mScreen.environment(),
                        mSession.folder() / "other.txt");
    ASSERT_TRUE(comesTrue([&] { return other.output() == "copied\n"; })) << other.output();
    writeLisp("b.lsp");
    press("ctrl+v");
    shoot("pasted");
    press("Return");
    EXPECT_TRUE(prints(wasLoaded("b.lsp"))) << mHost->output();
    expectAGoodEnd();
}

TEST_F(TwoHostsOnOneDisplay, DropFilesOnTheSecondAfterTheFirstHasEnded)
{
    const std::string file = writeLisp("a.lsp");
    openBoth();
    endTheFirst();
    dragFiles({file}, places::tableRow(0), [this] { EXPECT_TRUE(prints(wasLoaded("a.lsp"))); });
    expectAGoodEnd();
}

TEST_F(TwoHostsOnOneDisplay, CloseTheSecondAfterTheFirstWasKilled)
{
    openBoth();
    typeName("a name");
    press("ctrl+a");
    press("ctrl+c");
    mFirst.reset();
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    expectAGoodEnd();
}

TEST_F(TwoHostsOnOneDisplay, CopyFromTheFirstToTheSecond)
{
    writeLisp("a.lsp");
    open();
    typeName((files() / "a.lsp").string());
    press("ctrl+a");
    press("ctrl+c");
    openTheSecond();
    click(places::kName);
    press("ctrl+v");
    shoot("pasted");
    press("Return");
    EXPECT_TRUE(prints(wasLoaded("a.lsp"))) << mHost->output();
    endTheFirst();
    expectAGoodEnd();
}

// A session that is killed cannot clean up; the next one does.
TEST_F(TwoHostsOnOneDisplay, LeaveNoTemporaryFiles)
{
    open();
    EXPECT_EQ(whatSessionsLeft().size(), 1U);
    mHost.reset();
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    open();
    EXPECT_EQ(whatSessionsLeft().size(), 1U);
    closeAndEnd();
    EXPECT_THAT(whatSessionsLeft(), IsEmpty());
}
