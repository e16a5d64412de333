// Loaded in front of the system's libraries: presses Ctrl-C at moments that no person meets twice. PRESS_WHEN
// in the environment says at which: "read" when typed text is there and not taken yet, as the terminal does
// it: the text is gone; "run" when the line was taken and joins the typed history.
#include <cstdlib>
#include <string>
#include <string_view>

#include <csignal>
#include <dlfcn.h>
#include <poll.h>
#include <sys/file.h>
#include <termios.h>
#include <unistd.h>

namespace
{
template <class Function>
Function original(const char* name)
{
    return reinterpret_cast<Function>(dlsym(RTLD_NEXT, name));
}

bool isTime(std::string_view moment)
{
    static bool isOver = false;
    const char* when = std::getenv("PRESS_WHEN");
    if (isOver || !when || when != moment)
        return false;
    isOver = true;
    return true;
}

bool isHistory(int file)
{
    std::string path(4096, '\0');
    const ssize_t length =
        readlink(("/proc/self/fd/" + std::to_string(file)).c_str(), path.data(), path.size());
    path.resize(length > 0 ? static_cast<std::size_t>(length) : 0);
    return path.ends_with("/history");
}
} // namespace

extern "C" __attribute__((visibility("default"))) int poll(pollfd* sources, nfds_t count, int time)
{
    const int ready = original<int (*)(pollfd*, nfds_t, int)>("poll")(sources, count, time);
    if (ready > 0 && (sources[0].revents & POLLIN) != 0 && isatty(sources[0].fd) && isTime("read"))
    {
        tcflush(sources[0].fd, TCIFLUSH);
        raise(SIGINT);
    }
    return ready;
}

extern "C" __attribute__((visibility("default"))) int flock(int file, int operation) noexcept
{
    if (isHistory(file) && isTime("run"))
        raise(SIGINT);
    return original<int (*)(int, int)>("flock")(file, operation);
}
