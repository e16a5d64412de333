// The data of a drag from another program, by the X drag-and-drop protocol (XDND).
#pragma once

#include <string>

namespace tessel::windowing
{
// The list of URIs that the running drag offers, lines ended by CR LF (RFC 2483); empty when its source does
// not answer within a second or offers no such list.
std::string fetchDraggedUris();

// The X window that a drag has come to, from the event (an `XEvent`) that says so.
unsigned long windowEntered(const void* event);

// Tells other programs that the window takes drops by version 3 of the protocol, the oldest that they speak.
void announceDropTarget(unsigned long window);
} // namespace tessel::windowing
