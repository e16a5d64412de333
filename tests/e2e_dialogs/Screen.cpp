#include "tests/e2e_dialogs/Screen.h"

#include <cstdio>
#include <filesystem>
#include <ios>
#include <iterator>
#include <sstream>
#include <stdexcept>

#include <unistd.h>

#include "tests/e2e_dialogs/Waiting.h"

namespace
{
// The window manager's close button, from the right edge of the window.
constexpr int kCloseButtonInward = 11;

// The piece of a window that is looked at: the inside of a button, and no more than a row of a table.
constexpr int kLookWidth = 60;
constexpr int kLookHeight = 16;

constexpr char kPress[] = " mousedown 1 sleep 0.12 mouseup 1 ";

std::string moveTo(const std::string& window, Place place)
{
    return " mousemove --window " + window + " " + std::to_string(place.x) + " " + std::to_string(place.y) +
           " ";
}

std::string inShellQuotes(const std::string& text)
{
    std::string result = "'";
    for (const char character : text)
        result += character == '\'' ? std::string("'\\''") : std::string(1, character);
    return result + "'";
}
} // namespace

Screen::Screen(DisplayKind kind) : mDisplay(kind)
{
    mWindowManager = std::make_unique<Program>(std::vector<std::string>{"openbox"}, environment(),
                                               mFolder / "window-manager.txt");
    // It tells so on the root window when it is ready.
    if (!comesTrue([this]
                   { return run("xprop -root _NET_SUPPORTING_WM_CHECK").find("# 0x") != std::string::npos; }))
        throw std::runtime_error("openbox does not start (Debian package openbox)");
    std::filesystem::create_directories(SCREENSHOTS);
}

std::vector<std::string> Screen::environment() const
{
    std::vector<std::string> variables = {"DISPLAY=" + display(), "HOME=" + mFolder.path().string(),
                                          "LC_ALL=C.UTF-8"};
    for (char** variable = environ; *variable; ++variable)
        if (std::string(*variable).starts_with("PATH="))
            variables.emplace_back(*variable);
    return variables;
}

std::string Screen::run(const std::string& command) const
{
    FILE* output = popen(("DISPLAY=" + display() + " " + command + " 2>/dev/null").c_str(), "r");
    if (!output)
        throw std::runtime_error("cannot run " + command);
    std::string text;
    char piece[256];
    while (fgets(piece, sizeof piece, output))
        text += piece;
    pclose(output);
    return text;
}

std::vector<std::string> Screen::windows(const std::string& title) const
{
    std::istringstream lines(run("xdotool search --onlyvisible --name '^" + title + "$'"));
    return {std::istream_iterator<std::string>(lines), {}};
}

std::string Screen::window(const std::string& title) const
{
    const auto found = windows(title);
    return found.empty() ? std::string() : found.front();
}

std::string Screen::waitForAnotherWindow(const std::string& title, const std::string& known) const
{
    std::vector<std::string> found;
    comesTrue(
        [&]
        {
            found = windows(title);
            std::erase(found, known);
            return !found.empty();
        });
    return found.empty() ? std::string() : found.front();
}

std::string Screen::waitForWindow(const std::string& title) const
{
    std::string found;
    comesTrue([&] { return !(found = window(title)).empty(); });
    return found;
}

bool Screen::waitUntilActive(const std::string& window) const
{
    return comesTrue([&] { return run("xdotool getactivewindow") == window + "\n"; });
}

std::string Screen::waitForActive(const std::string& title) const
{
    const std::string found = waitForWindow(title);
    return !found.empty() && waitUntilActive(found) ? found : std::string();
}

bool Screen::waitUntilGone(const std::string& title) const
{
    return comesTrue([&] { return window(title).empty(); });
}

void Screen::click(const std::string& window, Place place) const
{
    run("xdotool" + moveTo(window, place) + kPress);
}

void Screen::tap(const std::string& window, Place place) const
{
    run("xdotool" + moveTo(window, place) + "mousedown 1 mouseup 1");
}

void Screen::holdMenuOpenAt(const std::string& window, Place place) const
{
    run("xdotool" + moveTo(window, place) + "mousedown 3 sleep 0.4");
}

void Screen::openMenuAt(const std::string& window, Place place) const
{
    holdMenuOpenAt(window, place);
    letGoOfMenu();
}

void Screen::letGoOfMenu() const
{
    run("xdotool mouseup 3 sleep 0.4");
}

void Screen::chooseFromMenuAt(const std::string& window, Place place, Place item) const
{
    holdMenuOpenAt(window, place);
    run("xdotool" + moveTo(window, {place.x + item.x, place.y + item.y}) + "sleep 0.4 mouseup 3");
}

void Screen::press(const std::string& window, Place place) const
{
    run("xdotool" + moveTo(window, place) + "mousedown 1 sleep 0.4");
}

void Screen::clickHolding(const std::string& key, const std::string& window, Place place) const
{
    run("xdotool keydown " + key + moveTo(window, place) + kPress + "keyup " + key);
}

void Screen::doubleClick(const std::string& window, Place place) const
{
    run("xdotool" + moveTo(window, place) + kPress + "sleep 0.05" + kPress);
}

void Screen::drag(const std::string& fromWindow, Place from, const std::string& toWindow, Place to) const
{
    dragOver(fromWindow, from, toWindow, to);
    letGo();
}

void Screen::moveOn(const std::string& window, Place to) const
{
    run("xdotool" + moveTo(window, to) + "sleep 0.2 mousemove_relative 1 1 sleep 0.3");
}

void Screen::letGo() const
{
    run("xdotool mouseup 1");
}

void Screen::dragOver(const std::string& fromWindow, Place from, const std::string& toWindow, Place to) const
{
    const auto step = [](int pixels)
    {
        return " sleep 0.1 mousemove_relative " + std::to_string(pixels) + " " + std::to_string(pixels);
    };
    run("xdotool" + moveTo(fromWindow, from) + "sleep 0.2 mousedown 1 sleep 0.2" + step(20) + step(30) +
        moveTo(toWindow, to) + "sleep 0.3" + step(2) + " sleep 0.5");
}

void Screen::choose(const std::string& window, Place menu, Place item) const
{
    run("xdotool" + moveTo(window, menu) + "mousedown 1 sleep 0.4" + moveTo(window, item) +
        "sleep 0.2 mouseup 1 sleep 0.2");
}

void Screen::key(const std::string& name) const
{
    run("xdotool key " + name);
}

void Screen::text(const std::string& text) const
{
    run("xdotool type --delay 15 " + inShellQuotes(text));
}

void Screen::clickCloseButton(const std::string& window, int width) const
{
    run("xdotool" + moveTo(window, {width - kCloseButtonInward, 0}) + "mousemove_relative -- 0 -11" + kPress);
}

void Screen::setResource(const std::string& lines) const
{
    run("xprop -root -format RESOURCE_MANAGER 8s -set RESOURCE_MANAGER " + inShellQuotes(lines));
}

std::string Screen::sizeOf(const std::string& window) const
{
    const std::string geometry = run("xdotool getwindowgeometry " + window);
    const std::string label = "Geometry: ";
    const std::size_t start = geometry.find(label);
    return start == std::string::npos
               ? std::string()
               : geometry.substr(start + label.size(), geometry.find('\n', start) - start - label.size());
}

std::string Screen::property(const std::string& window, const std::string& name) const
{
    const std::string line = run("xprop -notype -id " + window + " " + name);
    for (const std::string& start : {name + " = ", name + ": "})
        if (line.starts_with(start))
            return line.substr(start.size(), line.find('\n') - start.size());
    return {};
}

bool Screen::isOver(const std::string& upper, const std::string& lower) const
{
    const std::string fromBelow = run("xprop -root _NET_CLIENT_LIST_STACKING") + ",";
    const auto place = [&](const std::string& window)
    {
        std::ostringstream hexadecimal;
        hexadecimal << " 0x" << std::hex << std::stoul(window);
        return fromBelow.find(hexadecimal.str());
    };
    return place(upper) != std::string::npos && place(lower) < place(upper);
}

Place Screen::middleOf(const std::string& window) const
{
    int left = 0;
    int top = 0;
    int width = 0;
    int height = 0;
    const std::string report = run("xwininfo -id " + window);
    const auto number = [&](const std::string& label, int& value)
    {
        if (const std::size_t place = report.find(label); place != std::string::npos)
            value = std::stoi(report.substr(place + label.size()));
    };
    number("Absolute upper-left X:", left);
    number("Absolute upper-left Y:", top);
    number("Width:", width);
    number("Height:", height);
    return {left + width / 2, top + height / 2};
}

void Screen::minimize(const std::string& window) const
{
    run("xdotool windowminimize " + window);
}

void Screen::shoot(const std::string& name) const
{
    run("import -window root " + inShellQuotes(std::string(SCREENSHOTS) + "/" + name + ".png"));
}

std::string Screen::look(const std::string& window, Place place) const
{
    const std::string piece = std::to_string(kLookWidth) + "x" + std::to_string(kLookHeight) + "+" +
                              std::to_string(place.x - kLookWidth / 2) + "+" +
                              std::to_string(place.y - kLookHeight / 2);
    const std::string pixels = "import -window " + window + " -crop " + piece + " -depth 8 rgb:-";
    const std::string sum = run("sh -c '" + pixels + " | sha256sum'");
    static const std::string kNothing = run("sha256sum /dev/null");
    if (sum.empty() || sum.substr(0, sum.find(' ')) == kNothing.substr(0, kNothing.find(' ')))
        throw std::runtime_error("cannot look at the window (Debian package imagemagick)");
    return sum;
}

std::string Screen::colourOf(const std::string& window, Place corner, int width, int height) const
{
    const std::string piece = std::to_string(width) + "x" + std::to_string(height) + "+" +
                              std::to_string(corner.x) + "+" + std::to_string(corner.y);
    const std::string found = run("import -window " + window + " -crop " + piece + " miff:- | convert - " +
                                  "-format '%k %[pixel:p{0,0}]' info:");
    if (found.empty())
        throw std::runtime_error("cannot look at the window (Debian package imagemagick)");
    return found.starts_with("1 ") ? found.substr(2) : "several";
}
