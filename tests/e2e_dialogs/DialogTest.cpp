#include "tests/e2e_dialogs/DialogTest.h"

#include <algorithm>
#include <cstdlib>

using testing::HasSubstr;

namespace
{
constexpr char kDragWindow[] = "Files to drag";

std::string asOnePart(const std::string& text)
{
    return "\"" + text + "\"";
}

std::vector<std::string> listCommands(const std::string& list, const std::string& count,
                                      const std::vector<std::string>& paths)
{
    const std::string set = std::string("REGISTRY SET ") + kDialogsKey + "\\" + list + " ";
    std::vector<std::string> commands = {set + count + " " + std::to_string(paths.size())};
    for (std::size_t index = 0; index < paths.size(); ++index)
        commands.push_back(set + std::to_string(index + 1) + list + " " + asOnePart(paths[index]));
    return commands;
}

std::string pictureOf(const std::string& step)
{
    const auto* test = testing::UnitTest::GetInstance()->current_test_info();
    std::string name = std::string(test->test_suite_name()) + "." + test->name() + "-" + step;
    std::ranges::replace(name, '/', '.'); // tests with parameters have one in their names
    return name;
}
} // namespace

DialogTest::DialogTest(DisplayKind kind) : mScreen(kind)
{
    mSession.set("DISPLAY", mScreen.display());
    // Where a host that is killed leaves something is gone with the test.
    mSession.set("TEMP", mSession.folder().path().string());
    std::filesystem::create_directories(files());
    setSetting("InitialPath", files().string());
}

std::string DialogTest::writeLisp(const std::string& name) const
{
    return mSession.folder().write("files/" + name, "(write-line \"" + name + " runs\")\n").string();
}

std::string DialogTest::copySample(const std::string& name) const
{
    std::filesystem::copy(std::filesystem::path(SAMPLES_FOLDER) / name, files() / name);
    return (files() / name).string();
}

std::vector<std::string> DialogTest::writeManyLisp(int count) const
{
    std::vector<std::string> paths;
    for (int number = 1; number <= count; ++number)
        paths.push_back(writeLisp("many" + std::to_string(number) + ".lsp"));
    return paths;
}

std::string DialogTest::writeBroken(const std::string& name) const
{
    return mSession.folder().write("files/" + name, "no module").string();
}

std::string DialogTest::runQuietly(const std::vector<std::string>& commands) const
{
    std::vector<std::string> arguments = {"--safe"};
    for (const auto& command : commands)
        arguments.insert(arguments.end(), {"-c", command});
    const auto result = mSession.start(arguments);
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    return result.output;
}

void DialogTest::setSetting(const std::string& name, const std::string& value) const
{
    runQuietly({std::string("REGISTRY SET ") + kSettingsKey + " " + name + " " + asOnePart(value)});
}

void DialogTest::setToolkitSetting(const std::string& name, const std::string& value) const
{
    mSession.folder().write(mSession.profile() / "toolkit/Defaults/NSGlobalDomain.plist",
                            "{ " + name + " = \"" + value + "\"; }\n");
}

void DialogTest::storeHistory(const std::vector<std::string>& paths) const
{
    runQuietly(listCommands("History", "NumHistory", paths));
}

void DialogTest::storeSuite(const std::vector<std::string>& paths) const
{
    runQuietly(listCommands("Startup", "NumStartup", paths));
}

std::string DialogTest::stored(const std::string& list) const
{
    const std::string command = std::string("REGISTRY LIST ") + kDialogsKey + "\\" + list;
    const std::string output = runQuietly({command});
    const std::string asked = command + "\n";
    return output.substr(std::min(output.size(), output.find(asked) + asked.size()));
}

std::string DialogTest::storedSetting(const std::string& name) const
{
    const std::string command = std::string("REGISTRY GET ") + kSettingsKey + " " + name;
    const std::string output = runQuietly({command});
    const std::string asked = command + "\n";
    return output.substr(std::min(output.size(), output.find(asked) + asked.size()));
}

void DialogTest::open()
{
    mHost = std::make_unique<Program>(mSession.commandLine({}), mSession.environment(),
                                      mSession.folder() / "output.txt");
    openAgain();
}

void DialogTest::openWithHistory(const std::vector<std::string>& paths)
{
    storeHistory(paths);
    setSetting("LastTab", "1");
    open();
}

void DialogTest::openAgain()
{
    mHost->type("MODRIG");
    mDialog = mScreen.waitForActive(kDialog);
    ASSERT_FALSE(mDialog.empty()) << mHost->output();
    shoot("opened");
}

std::string DialogTest::closeAndEnd()
{
    EXPECT_TRUE(mScreen.waitUntilActive(mDialog)) << "another window has the keyboard";
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    return end();
}

std::string DialogTest::end()
{
    mHost->type("APPS");
    mHost->type("QUIT");
    EXPECT_TRUE(mHost->endsByItself()) << mHost->output();
    return mHost->output();
}

void DialogTest::press(const std::string& key, int times) const
{
    for (int time = 0; time < times; ++time)
        mScreen.key(key);
}

bool DialogTest::changes(Place place, const std::string& before) const
{
    return comesTrue([&] { return look(place) != before; });
}

void DialogTest::loadFile(int row, const std::string& name) const
{
    click(places::file(row));
    click(places::kLoad);
    EXPECT_TRUE(prints(wasLoaded(name)));
}

void DialogTest::loadBroken(int row) const
{
    click(places::file(row));
    click(places::kLoad);
    ASSERT_FALSE(mScreen.waitForWindow(kMessageBox).empty());
}

std::string DialogTest::openMessageBox()
{
    writeBroken();
    open();
    loadBroken(0);
    const std::string box = mScreen.waitForActive(kMessageBox);
    EXPECT_FALSE(box.empty());
    return box;
}

void DialogTest::openSuite()
{
    click(places::kContents);
    mSuite = mScreen.waitForActive(kSuiteDialog);
    ASSERT_FALSE(mSuite.empty());
    shoot("suite");
}

void DialogTest::typeName(const std::string& name) const
{
    click(places::kName);
    mScreen.text(name);
}

void DialogTest::TearDown()
{
    if (HasFailure())
        mScreen.shoot(pictureOf("failed"));
}

void DialogTest::shoot(const std::string& step) const
{
    if (std::getenv("MODRIG_STEP_PICTURES"))
        mScreen.shoot(pictureOf(step));
}

bool DialogTest::prints(const std::string& text) const
{
    return comesTrue([&] { return mHost->output().find(text) != std::string::npos; });
}

void DialogTest::dismissMessageBox() const
{
    ASSERT_FALSE(mScreen.waitForActive(kMessageBox).empty()) << "no message box";
    shoot("message-box");
    mScreen.key("Return");
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
}

std::unique_ptr<Program> DialogTest::dragSource(const std::vector<std::string>& paths) const
{
    std::vector<std::string> arguments = {"/usr/bin/python3", DRAG_SOURCE};
    arguments.insert(arguments.end(), paths.begin(), paths.end());
    return std::make_unique<Program>(arguments, mScreen.environment(), mSession.folder() / "drag.txt");
}

std::string DialogTest::dragWindow() const
{
    return mScreen.waitForWindow(kDragWindow);
}

void DialogTest::dragFiles(const std::vector<std::string>& paths, Place place,
                           const std::function<void()>& effect) const
{
    const auto source = dragSource(paths);
    const std::string window = dragWindow();
    ASSERT_FALSE(window.empty()) << source->output();
    mScreen.drag(window, kDragButton, mDialog, place);
    shoot("dropped");
    effect();
}

std::string wasLoaded(const std::string& name)
{
    return name + " was loaded.\n";
}

std::string listedIn(const std::string& name, const std::filesystem::path& folder)
{
    std::string line = "  " + name;
    line.resize(std::max<std::size_t>(line.size(), 26), ' ');
    return line + " " + folder.string();
}
