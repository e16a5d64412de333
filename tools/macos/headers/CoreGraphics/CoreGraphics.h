// What host/ui/platform/cocoa uses of CoreGraphics: declarations enough for compiling it elsewhere.
#pragma once

extern "C" const struct __CFDictionary* CGSessionCopyCurrentDictionary();
