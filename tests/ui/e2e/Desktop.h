// A screen with a window manager, worked on by mouse and keyboard as a person would.
#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include <sys/types.h>

#include "tests/ui/support/VirtualDisplay.h"

struct Point
{
    int x = 0;
    int y = 0;
    Point operator+(Point other) const { return {x + other.x, y + other.y}; }
};

class Desktop
{
public:
    // Starts the screen and the window manager.
    Desktop();
    ~Desktop();
    Desktop(const Desktop&) = delete;
    Desktop& operator=(const Desktop&) = delete;

    const std::string& display() const { return mDisplay.name(); }

    // Whether a window with that title comes (goes) before the time is over.
    bool waitForWindow(const std::string& title) const;
    bool waitForWindowGone(const std::string& title) const;
    // The upper left corner of what is inside the window's frame.
    Point originOf(const std::string& title) const;

    // The mouse. A button is held down as long as a finger takes.
    void click(Point place) const { press(place, 1); }
    void doubleClick(Point place) const { press(place, 2); }
    // The same with Shift held down: what is clicked joins the selection.
    void clickToo(Point place) const;
    // Chooses from a pop-up: the button goes down on it and up on the choice.
    void choose(Point popUp, Point choice) const;
    // The keyboard: "Return", "alt+2", several separated by spaces.
    void key(const std::string& keys) const;
    // Drags files from a window of another program and drops them.
    void dropFiles(const std::vector<std::filesystem::path>& files, Point place) const;

    // Keeps a picture of the screen in the build folder.
    void picture(const std::string& name) const;

private:
    void press(Point place, int times) const;
    int xdotool(const std::string& arguments) const;
    std::string output(const std::string& command) const;
    bool isVisible(const std::string& title) const;

    VirtualDisplay mDisplay;
    pid_t mWindowManager = -1;
};

// Asks until the answer is yes or the time is over.
bool waitUntil(const std::function<bool()>& condition);
