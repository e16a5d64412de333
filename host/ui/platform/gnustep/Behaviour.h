// Where the toolkit is made to behave otherwise than it does by itself. Each is called once: the first before
// the application object is made, the others after it, before the first window.
#pragma once

namespace tessel::windowing
{
// Lets the programs that the toolkit starts for itself serve this one alone, and end when it does.
void keepHelperProgramsToTheSession();

// Takes files that are dragged here from other programs.
void acceptFileDrops();

// Takes what comes from the display in the order in which it came, and as soon as it has come.
void takeInputInItsOrder();

// Lets every window be closed by its frame: file panels are cancelled then, message boxes answered.
void makeWindowsClosable();

// Lets a window that opens right after another has closed get the keyboard.
void letNewWindowsHaveTheKeyboard();

// Keeps a modal window over the one that it came from, in its middle, and all of them within reach.
void keepModalWindowsInFront();

// Lets scrollers that hide by themselves come and go at any scale.
void keepScrollersSteady();

// Lets tables mark the gap between rows that is nearest to what is dragged, and nothing where no drop is
// taken.
void showWhereDropsLandInTables();

// Lets Escape close an open menu, and no key that is pressed meanwhile go to the window under it.
void letEscapeCloseMenus();

// Draws whole pixels again when a view asks for it, whose edges lie within pixels at some scales.
void drawWholePixels();

// Puts the inside of every window where its frame leaves room for it, at any scale.
void placeContentsOfWindows();
} // namespace tessel::windowing
