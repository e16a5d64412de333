// A virtual display with a window manager, and the hands and eyes of a person in front of it.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "tests/dialogs/support/VirtualDisplay.h"
#include "tests/e2e_dialogs/Program.h"
#include "tests/support/TemporaryFolder.h"

// A place in a window, from its left and its upper edge.
struct Place
{
    int x = 0;
    int y = 0;
};

class Screen
{
public:
    explicit Screen(DisplayKind kind = {});

    const std::string& display() const { return mDisplay.name(); }
    std::vector<std::string> environment() const;

    // The visible window with this title; empty when there is none.
    std::string window(const std::string& title) const;
    std::string waitForWindow(const std::string& title) const;
    // The visible window with this title that is not the known one.
    std::string waitForAnotherWindow(const std::string& title, const std::string& known) const;
    // Until the window manager has given the keyboard to the window.
    bool waitUntilActive(const std::string& window) const;
    bool waitUntilGone(const std::string& title) const;
    // The visible window with this title when it has the keyboard; empty when that does not come to be.
    std::string waitForActive(const std::string& title) const;

    // Presses and releases the mouse button, slowly enough for the toolkit.
    void click(const std::string& window, Place place) const;
    // Presses and releases it at once, as touch pads do for a tap.
    void tap(const std::string& window, Place place) const;
    // Presses the button and keeps it down: a menu stays open.
    void press(const std::string& window, Place place) const;
    void clickHolding(const std::string& key, const std::string& window, Place place) const;
    void doubleClick(const std::string& window, Place place) const;
    // Presses at one place and releases at another, with time for the drag to be noticed on the way.
    void drag(const std::string& fromWindow, Place from, const std::string& toWindow, Place to) const;
    // The same in two steps, to look at what is shown while the mouse hovers.
    void dragOver(const std::string& fromWindow, Place from, const std::string& toWindow, Place to) const;
    void moveOn(const std::string& window, Place to) const;
    void letGo() const;

    // Opens the menu of a place, by the other button, which is kept down, or clicked.
    void holdMenuOpenAt(const std::string& window, Place place) const;
    void openMenuAt(const std::string& window, Place place) const;
    void letGoOfMenu() const;
    // Opens the menu of a place, by the other button, and lets go over one of its items: so far to the right
    // and below.
    void chooseFromMenuAt(const std::string& window, Place place, Place item) const;
    // Opens a menu and lets go over one of its items.
    void choose(const std::string& window, Place menu, Place item) const;

    void key(const std::string& name) const;
    void text(const std::string& text) const;
    // The button in the title bar of a window of this width.
    void clickCloseButton(const std::string& window, int width) const;

    // What the desktop tells its programs: lines of X resources.
    void setResource(const std::string& lines) const;

    // Width and height of the window's inside: "750x770".
    std::string sizeOf(const std::string& window) const;

    // What the window tells the desktop: the value of a property, as xprop prints it; empty when it has none.
    std::string property(const std::string& window, const std::string& name) const;
    // Whether the one window is nearer to the user.
    bool isOver(const std::string& upper, const std::string& lower) const;
    // The middle of the window's inside, on the screen.
    Place middleOf(const std::string& window) const;
    void minimize(const std::string& window) const;

    // A picture of the whole screen.
    void shoot(const std::string& name) const;
    // What a piece of the window around the place looks like: equal as long as no pixel of it changes.
    std::string look(const std::string& window, Place place) const;
    // The colour of a piece of the window, from its left and its upper edge; "several" when it has more.
    std::string colourOf(const std::string& window, Place corner, int width, int height) const;

private:
    std::vector<std::string> windows(const std::string& title) const;
    std::string run(const std::string& command) const;

    TemporaryFolder mFolder;
    VirtualDisplay mDisplay;
    std::unique_ptr<Program> mWindowManager;
};
