#include "tests/ui/e2e/DialogByHand.h"

namespace fs = std::filesystem;

void DialogByHand::SetUp()
{
    mDesktop = std::make_unique<Desktop>();
    mSession = std::make_unique<HostSession>();
    fs::create_directories(folder());
    store(kSettingsKey, "InitialPath", folder());
    mSession->set("DISPLAY", mDesktop->display());
}

void DialogByHand::TearDown()
{
    if (HasFailure() && mTerminal)
    {
        picture(std::string("failed-") + testing::UnitTest::GetInstance()->current_test_info()->name());
        std::puts(mTerminal->screen().c_str());
    }
    mTerminal.reset();
}

fs::path DialogByHand::sample(const std::string& name)
{
    fs::copy(fs::path(SAMPLES_FOLDER) / name, folder() / name, fs::copy_options::recursive);
    return folder() / name;
}

fs::path DialogByHand::lispFile(const std::string& name)
{
    return mSession->folder().write("work/" + name, "(princ \"" + name + " runs\")");
}

fs::path DialogByHand::brokenModule(const std::string& name)
{
    return mSession->folder().write("work/" + name, "no module");
}

void DialogByHand::store(const std::string& key, const std::string& name, const std::string& data)
{
    const auto result =
        mSession->start({"--safe", "-c", "REGISTRY SET " + key + " " + name + " \"" + data + "\""});
    ASSERT_EQ(result.exitStatus, 0) << result.output;
}

std::string DialogByHand::stored(const std::string& key, const std::string& name)
{
    const std::string output = mSession->start({"--safe", "-c", "REGISTRY GET " + key + " " + name}).output;
    const auto answer = output.find('\n', output.find("REGISTRY GET")) + 1;
    return output.substr(answer, output.find('\n', answer) - answer);
}

void DialogByHand::storeHistory(const std::vector<fs::path>& files)
{
    const std::string key = std::string(kModuleKey) + R"(\History)";
    store(key, "NumHistory", std::to_string(files.size()));
    for (std::size_t index = 0; index < files.size(); ++index)
        store(key, std::to_string(index + 1) + "History", files[index].string());
}

void DialogByHand::startHost()
{
    mTerminal = std::make_unique<HostTerminal>(*mSession);
    ASSERT_TRUE(says("Command: ")) << mTerminal->screen();
}

void DialogByHand::type(const std::string& command)
{
    mTerminal->type(command + "\r");
}

void DialogByHand::quit()
{
    type("QUIT");
    EXPECT_EQ(mTerminal->waitForEnd(), 0);
    mTerminal.reset();
}

void DialogByHand::openDialog()
{
    type("MODRIG");
    ASSERT_TRUE(mDesktop->waitForWindow(kDialogTitle)) << mTerminal->screen();
    mDialog = mDesktop->originOf(kDialogTitle);
}

void DialogByHand::closeDialog()
{
    mDesktop->key("Escape");
    ASSERT_TRUE(mDesktop->waitForWindowGone(kDialogTitle));
    ASSERT_TRUE(says("Command: ")) << mTerminal->screen();
}

void DialogByHand::answerAlert(const std::string& name)
{
    ASSERT_TRUE(mDesktop->waitForWindow(kAlertTitle)) << mTerminal->screen();
    picture(name);
    mDesktop->key("Return");
    ASSERT_TRUE(mDesktop->waitForWindowGone(kAlertTitle));
}
