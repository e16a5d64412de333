// A display that nobody sees, for programs that open windows.
#pragma once

#include <string>

#include <sys/types.h>

struct DisplayKind
{
    int width = 1280;
    int height = 1024;
    int dotsPerInch = 96;
};

// Runs an X server of its own on a free display while the object lives.
class VirtualDisplay
{
public:
    // Throws std::runtime_error when the server does not start.
    explicit VirtualDisplay(DisplayKind kind = {});
    ~VirtualDisplay();
    VirtualDisplay(const VirtualDisplay&) = delete;
    VirtualDisplay& operator=(const VirtualDisplay&) = delete;

    // What DISPLAY is set to for its programs: ":5".
    const std::string& name() const { return mName; }
    pid_t server() const { return mServer; }

private:
    pid_t mServer = -1;
    std::string mName;
};
