#include "tests/ui/e2e/Desktop.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <thread>

#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{
constexpr std::chrono::seconds kPatience{20};
constexpr std::chrono::milliseconds kBetweenLooks{50};
constexpr Point kDragSource = {80, 70};

[[noreturn]] void becomeWindowManager(const std::string& display)
{
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    setenv("DISPLAY", display.c_str(), 1);
    if (!std::freopen("/dev/null", "w", stderr))
        _exit(127);
    execlp("openbox", "openbox", "--sm-disable", static_cast<char*>(nullptr));
    _exit(127);
}

std::string place(Point point)
{
    return std::to_string(point.x) + " " + std::to_string(point.y);
}

std::string quoted(const std::string& text)
{
    return "'" + text + "'"; // no text of these tests has a quote in it
}
} // namespace

bool waitUntil(const std::function<bool()>& condition)
{
    const auto end = std::chrono::steady_clock::now() + kPatience;
    while (!condition())
    {
        if (std::chrono::steady_clock::now() > end)
            return false;
        std::this_thread::sleep_for(kBetweenLooks);
    }
    return true;
}

Desktop::Desktop()
{
    mWindowManager = fork();
    if (mWindowManager == 0)
        becomeWindowManager(display());
    const bool managed =
        waitUntil([this] { return !output("xprop -root _NET_SUPPORTING_WM_CHECK | grep window").empty(); });
    if (!managed)
        throw std::runtime_error("openbox does not start (Debian packages openbox, x11-utils)");
}

Desktop::~Desktop()
{
    kill(mWindowManager, SIGTERM);
    waitpid(mWindowManager, nullptr, 0);
}

std::string Desktop::output(const std::string& command) const
{
    const std::string whole = "DISPLAY=" + display() + " timeout 20 " + command + " 2>/dev/null";
    const std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(whole.c_str(), "r"), pclose);
    std::string text;
    char buffer[256];
    while (pipe && std::fgets(buffer, sizeof buffer, pipe.get()))
        text += buffer;
    return text;
}

int Desktop::xdotool(const std::string& arguments) const
{
    return std::system(("DISPLAY=" + display() + " timeout 30 xdotool " + arguments + " >/dev/null").c_str());
}

bool Desktop::isVisible(const std::string& title) const
{
    return !output("xdotool search --onlyvisible --name " + quoted("^" + title + "$")).empty();
}

bool Desktop::waitForWindow(const std::string& title) const
{
    const bool shown = waitUntil([&] { return isVisible(title); });
    // The window manager may still be placing it.
    Point last = originOf(title);
    return shown && waitUntil(
                        [&]
                        {
                            const Point now = originOf(title);
                            const bool settled = now.x == last.x && now.y == last.y;
                            last = now;
                            return settled;
                        });
}

bool Desktop::waitForWindowGone(const std::string& title) const
{
    return waitUntil([&] { return !isVisible(title); });
}

Point Desktop::originOf(const std::string& title) const
{
    const std::string name = quoted("^" + title + "$");
    std::istringstream geometry(output("sh -c \"xwininfo -id \\$(xdotool search --onlyvisible --name " +
                                       name + " | tail -1) | sed -n 's/.*Absolute upper-left [XY]: *//p'\""));
    Point origin;
    geometry >> origin.x >> origin.y;
    return origin;
}

void Desktop::press(Point point, int times) const
{
    std::string clicks;
    for (int click = 0; click < times; ++click)
        clicks += " mousedown 1 sleep 0.06 mouseup 1 sleep 0.04";
    xdotool("mousemove " + place(point) + " sleep 0.1" + clicks + " sleep 0.2");
}

void Desktop::clickToo(Point point) const
{
    xdotool("mousemove " + place(point) +
            " sleep 0.1 keydown Shift mousedown 1 sleep 0.1 mouseup 1 keyup Shift sleep 0.2");
}

void Desktop::choose(Point popUp, Point choice) const
{
    xdotool("mousemove " + place(popUp) + " sleep 0.1 mousedown 1 sleep 0.4 mousemove " + place(choice) +
            " sleep 0.3 mouseup 1 sleep 0.2");
}

void Desktop::key(const std::string& keys) const
{
    xdotool("key --delay 60 " + keys + " sleep 0.1");
}

void Desktop::dropFiles(const std::vector<std::filesystem::path>& files, Point target) const
{
    waitForWindowGone("Drag source"); // of the drop before, which is over when it has been taken
    std::string command = "DISPLAY=" + display() + " timeout 60 /usr/bin/python3 " DRAG_SOURCE;
    for (const auto& file : files)
        command += " " + quoted(file.string());
    std::system((command + " >/dev/null 2>&1 &").c_str());
    if (!waitForWindow("Drag source"))
        throw std::runtime_error(
            "the drag source does not start (Debian packages python3-gi, gir1.2-gtk-3.0)");
    xdotool("mousemove " + place(kDragSource) + " sleep 0.2 mousedown 1 sleep 0.2 mousemove " +
            place(kDragSource + Point{20, 20}) + " sleep 0.1 mousemove " +
            place(kDragSource + Point{70, 50}) + " sleep 0.1 mousemove " + place(target) +
            " sleep 0.3 mousemove " + place(target + Point{2, 0}) + " sleep 0.6 mouseup 1");
    waitForWindowGone("Drag source");
}

void Desktop::picture(const std::string& name) const
{
    std::filesystem::create_directories(PICTURES);
    output("import -window root " + quoted(std::string(PICTURES) + "/" + name + ".png"));
}
