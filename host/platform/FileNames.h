// What the platform's Objective-C libraries make of the names of files.
#pragma once

namespace tessel
{
// From now on they name every file as the host does, those too whose names are no text; each of them is
// reached by its path as a string (see wcharToNSString). To call it again does nothing more.
void nameEveryFile();
} // namespace tessel
