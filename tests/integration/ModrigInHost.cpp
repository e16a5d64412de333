#include "tests/integration/ModrigInHost.h"

#include <cstdlib>
#include <stdexcept>
#include <utility>

#include "host/text/Unicode.h"

std::wstring wide(const std::filesystem::path& path)
{
    return tessel::toWide(path.string());
}

ModrigInHost::ModrigInHost() : mFolderBefore(std::filesystem::current_path())
{
    // Without a display a message box is text, and nobody has to answer.
    unsetenv("DISPLAY");
    unsetenv("WAYLAND_DISPLAY");
    options.profileFolder = profile();
    options.safe = true; // the shipped bundle is another Modrig
    options.output = [this](std::string_view text)
    {
        mOutput += text;
    };
    static_cast<void>(ModrigUnderTest::messageLine()); // of an earlier test
    restart();
    loadModrig();
}

ModrigInHost::~ModrigInHost()
{
    end();
    std::filesystem::current_path(mFolderBefore); // the test's own is about to go
    ModrigUnderTest::playDialog({});
}

void ModrigInHost::restart()
{
    end();
    mOutput.clear();
    mHost = std::make_unique<tessel::Host>(options);
    if (!mHost->start())
        throw std::runtime_error("the host does not start: " + mOutput);
}

void ModrigInHost::loadModrig()
{
    if (!type(L"LOAD \"" + wide(MODRIG_UNDER_TEST) + L"\""))
        throw std::runtime_error("Modrig is not loaded: " + mOutput);
    const std::string loaded = std::string(MODRIG_UNDER_TEST) + " is loaded.\n";
    if (!mOutput.ends_with(loaded))
        throw std::runtime_error("the host does not say that Modrig is loaded: " + mOutput);
    mOutput.resize(mOutput.size() - loaded.size());
    // The list of loaded applications outlives the session, as the library does.
    dialog(ModrigUnderTest::populate);
}

bool ModrigInHost::tryDialog(const std::function<void()>& actions)
{
    ModrigUnderTest::playDialog(actions);
    const bool allWell = type(L"MODRIG");
    ModrigUnderTest::playDialog({});
    return allWell;
}

void ModrigInHost::dialog(const std::function<void()>& actions)
{
    if (!tryDialog(actions))
        throw std::runtime_error("MODRIG fails: " + mOutput);
}

std::filesystem::path ModrigInHost::module(const std::string& name) const
{
    const auto copy = folder / "modules" / name;
    if (std::filesystem::exists(copy))
        return copy;
    std::filesystem::create_directories(copy.parent_path());
    std::filesystem::copy(std::filesystem::path(FIXTURE_MODULES) / name, copy,
                          std::filesystem::copy_options::recursive);
    return copy;
}

std::string ModrigInHost::said()
{
    return std::exchange(mOutput, {});
}
