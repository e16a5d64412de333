// Preloaded into a program, makes system calls on a registry's files fail, as a disk, a network or a quota
// would.
//
//     MODRIG_FAULT="pwrite 3 once"     the third call fails; "ever": that one and all after it; a number
//     after
//                                      that is the error, in place of the usual one
//     MODRIG_FAULT_OF=/.tessel-part-   only calls on files whose path holds this fail
//     MODRIG_FAULT_TAKEN=1             the first file of a name of its own is removed before it is locked
//     MODRIG_FAULT_COUNTS=file         tells at the end how many calls of each kind there were
//     MODRIG_FAULT_NETWORK=1           every folder lies on another machine
//     MODRIG_FAULT_DELAY=500           every read at a place takes so many microseconds more
//     MODRIG_FAULT_TOUCH=1             a file that is copied by the system is changed when it has been
//
// What a failing call would have done is not done; of a write, half of it is, and a file that is to be closed
// is closed.
#include <array>
#include <atomic>
#include <cerrno>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string_view>

#include <dlfcn.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/mman.h>
#include <sys/sendfile.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

#define INTERPOSED extern "C" __attribute__((visibility("default")))

namespace
{
constexpr std::string_view kFile = "/registry.db";
constexpr std::string_view kPartOfIt = "/.tessel-part-"; // what takes its place
constexpr long kNfs = 0x6969;
constexpr std::size_t kLongestPath = 4096;

struct Kind
{
    const char* name;
    int error;
    std::atomic<unsigned> calls = 0;
};

Kind kOpen{"open", EMFILE};
Kind kCreate{"create", EACCES}; // an open that makes a file
Kind kRead{"read", EIO};
Kind kPread{"pread", EIO};
Kind kWrite{"write", ENOSPC};
Kind kPwrite{"pwrite", ENOSPC};
Kind kFsync{"fsync", EIO};
Kind kFdatasync{"fdatasync", EIO};
Kind kFtruncate{"ftruncate", EFBIG};
Kind kFcntl{"fcntl", EIO};
Kind kUnlink{"unlink", EACCES};
Kind kMmap{"mmap", ENOMEM};
Kind kMunmap{"munmap", EINVAL};
Kind kClose{"close", EIO};
Kind kStat{"stat", EACCES};
Kind kFstat{"fstat", EIO};
Kind kAccess{"access", EACCES};
Kind kRename{"rename", EACCES};
Kind kLink{"link", EPERM};
Kind kFchmod{"fchmod", EPERM};
Kind kMkostemp{"mkostemp", ENOSPC};

const std::array kKinds = {&kOpen,      &kCreate,    &kRead,   &kPread,  &kWrite, &kPwrite, &kFsync,
                           &kFdatasync, &kFtruncate, &kFcntl,  &kUnlink, &kMmap,  &kMunmap, &kClose,
                           &kStat,      &kFstat,     &kAccess, &kRename, &kLink,  &kFchmod, &kMkostemp};

// The maps of the files, by their addresses.
std::array<std::atomic<void*>, 64> theMaps = {};

template <class Function>
Function* next(const char* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

bool isMeant(const char* path)
{
    static const char* const only = std::getenv("MODRIG_FAULT_OF");
    const std::string_view file = path ? path : "";
    if (only && file.find(only) == file.npos)
        return false;
    return file.find(kFile) != file.npos || file.find(kPartOfIt) != file.npos;
}

struct PathOf
{
    explicit PathOf(int file)
    {
        char link[64];
        std::snprintf(link, sizeof link, "/proc/self/fd/%d", file);
        const ssize_t length = readlink(link, text, sizeof text - 1);
        text[length < 0 ? 0 : length] = '\0';
    }

    char text[kLongestPath];
};

bool isMeant(int file)
{
    return isMeant(PathOf(file).text);
}

struct Fault
{
    char kind[16] = {};
    unsigned number = 0;
    bool lasting = false;
    int error = 0;
};

Fault readFault()
{
    Fault fault;
    char duration[8] = {};
    if (const char* text = std::getenv("MODRIG_FAULT"))
        std::sscanf(text, "%15s %u %7s %d", fault.kind, &fault.number, duration, &fault.error);
    fault.lasting = std::string_view(duration) == "ever";
    return fault;
}

// Whether this call is to fail; sets the reason.
bool fails(Kind& kind)
{
    static const Fault fault = readFault();
    const unsigned number = ++kind.calls;
    if (std::string_view(fault.kind) != kind.name || number < fault.number ||
        (number > fault.number && !fault.lasting))
        return false;
    errno = fault.error != 0 ? fault.error : kind.error;
    return true;
}

template <class Which>
bool fails(Kind& kind, Which which)
{
    const int before = errno;
    if (!isMeant(which))
    {
        errno = before;
        return false;
    }
    errno = before;
    return fails(kind);
}

void delay(int file)
{
    static const char* const time = std::getenv("MODRIG_FAULT_DELAY");
    if (time && isMeant(file))
        usleep(static_cast<useconds_t>(std::atoi(time)));
}

bool failsToOpen(const char* path, int flags)
{
    if (fails(kOpen, path))
        return true;
    const int before = errno;
    struct stat status = {};
    const bool makes = (flags & O_CREAT) != 0 && isMeant(path) && fstatat(AT_FDCWD, path, &status, 0) != 0;
    errno = before;
    return makes && fails(kCreate);
}

struct Counts
{
    ~Counts()
    {
        const char* file = std::getenv("MODRIG_FAULT_COUNTS");
        FILE* counts = file ? std::fopen(file, "w") : nullptr;
        if (!counts)
            return;
        for (const Kind* kind : kKinds)
            std::fprintf(counts, "%s %u\n", kind->name, kind->calls.load());
        std::fclose(counts);
    }
} theCounts;
} // namespace

#define OPENING(function)                                                                                    \
    INTERPOSED int function(const char* path, int flags, ...)                                                \
    {                                                                                                        \
        va_list arguments;                                                                                   \
        va_start(arguments, flags);                                                                          \
        const mode_t mode = va_arg(arguments, mode_t);                                                       \
        va_end(arguments);                                                                                   \
        return failsToOpen(path, flags) ? -1                                                                 \
                                        : next<int(const char*, int, ...)>(#function)(path, flags, mode);    \
    }
OPENING(open)
OPENING(open64)

INTERPOSED ssize_t read(int file, void* bytes, size_t count)
{
    return fails(kRead, file) ? -1 : next<decltype(read)>("read")(file, bytes, count);
}

#define READING(function)                                                                                    \
    INTERPOSED ssize_t function(int file, void* bytes, size_t count, off_t offset)                           \
    {                                                                                                        \
        delay(file);                                                                                         \
        return fails(kPread, file) ? -1 : next<decltype(pread)>(#function)(file, bytes, count, offset);      \
    }
READING(pread)
READING(pread64)

INTERPOSED ssize_t sendfile(int to, int from, off_t* offset, size_t count)
{
    const ssize_t sent = next<decltype(sendfile)>("sendfile")(to, from, offset, count);
    static const bool touches = std::getenv("MODRIG_FAULT_TOUCH") != nullptr;
    if (touches && sent > 0)
        futimens(from, nullptr);
    return sent;
}

INTERPOSED ssize_t write(int file, const void* bytes, size_t count)
{
    const auto perform = next<decltype(write)>("write");
    if (!fails(kWrite, file))
        return perform(file, bytes, count);
    const int error = errno;
    static_cast<void>(perform(file, bytes, count / 2));
    errno = error;
    return -1;
}

#define WRITING(function)                                                                                    \
    INTERPOSED ssize_t function(int file, const void* bytes, size_t count, off_t offset)                     \
    {                                                                                                        \
        const auto perform = next<decltype(pwrite)>(#function);                                              \
        if (!fails(kPwrite, file))                                                                           \
            return perform(file, bytes, count, offset);                                                      \
        const int error = errno;                                                                             \
        static_cast<void>(perform(file, bytes, count / 2, offset));                                          \
        errno = error;                                                                                       \
        return -1;                                                                                           \
    }
WRITING(pwrite)
WRITING(pwrite64)

INTERPOSED int fsync(int file)
{
    return fails(kFsync, file) ? -1 : next<decltype(fsync)>("fsync")(file);
}

INTERPOSED int fdatasync(int file)
{
    return fails(kFdatasync, file) ? -1 : next<decltype(fdatasync)>("fdatasync")(file);
}

#define TRUNCATING(function)                                                                                 \
    INTERPOSED int function(int file, off_t size) noexcept                                                   \
    {                                                                                                        \
        return fails(kFtruncate, file) ? -1 : next<int(int, off_t)>(#function)(file, size);                  \
    }
TRUNCATING(ftruncate)
TRUNCATING(ftruncate64)

#define CONTROLLING(function)                                                                                \
    INTERPOSED int function(int file, int command, ...)                                                      \
    {                                                                                                        \
        va_list arguments;                                                                                   \
        va_start(arguments, command);                                                                        \
        void* const argument = va_arg(arguments, void*);                                                     \
        va_end(arguments);                                                                                   \
        return fails(kFcntl, file) ? -1 : next<int(int, int, ...)>(#function)(file, command, argument);      \
    }
CONTROLLING(fcntl)
CONTROLLING(fcntl64)

INTERPOSED int unlink(const char* path) noexcept
{
    return fails(kUnlink, path) ? -1 : next<int(const char*)>("unlink")(path);
}

#define MAPPING(function)                                                                                    \
    INTERPOSED void* function(void* at, size_t size, int protection, int flags, int file,                    \
                              off_t offset) noexcept                                                         \
    {                                                                                                        \
        const bool meant = file >= 0 && isMeant(file);                                                       \
        if (meant && fails(kMmap))                                                                           \
            return MAP_FAILED;                                                                               \
        void* const map = next<void*(void*, size_t, int, int, int, off_t)>(#function)(at, size, protection,  \
                                                                                      flags, file, offset);  \
        for (auto& known : theMaps)                                                                          \
            if (void* none = nullptr; meant && known.compare_exchange_strong(none, map))                     \
                break;                                                                                       \
        return map;                                                                                          \
    }
MAPPING(mmap)
MAPPING(mmap64)

INTERPOSED int munmap(void* map, size_t size) noexcept
{
    for (auto& known : theMaps)
        if (void* mine = map; map && known.compare_exchange_strong(mine, nullptr))
            if (fails(kMunmap))
                return -1;
    return next<int(void*, size_t)>("munmap")(map, size);
}

INTERPOSED int close(int file)
{
    const bool failing = fails(kClose, file);
    const int error = errno;
    const int status = next<decltype(close)>("close")(file);
    if (failing)
        errno = error;
    return failing ? -1 : status;
}

#define ASKING(function, kind, Which)                                                                        \
    INTERPOSED int function(Which which, struct stat* status) noexcept                                       \
    {                                                                                                        \
        return fails(kind, which) ? -1 : next<int(Which, struct stat*)>(#function)(which, status);           \
    }
ASKING(stat, kStat, const char*)
ASKING(lstat, kStat, const char*)
ASKING(fstat, kFstat, int)

#define ASKING_64(function, kind, Which)                                                                     \
    INTERPOSED int function(Which which, struct stat64* status) noexcept                                     \
    {                                                                                                        \
        return fails(kind, which) ? -1 : next<int(Which, struct stat64*)>(#function)(which, status);         \
    }
ASKING_64(stat64, kStat, const char*)
ASKING_64(lstat64, kStat, const char*)
ASKING_64(fstat64, kFstat, int)

INTERPOSED int access(const char* path, int mode) noexcept
{
    return fails(kAccess, path) ? -1 : next<int(const char*, int)>("access")(path, mode);
}

INTERPOSED int rename(const char* from, const char* to) noexcept
{
    return fails(kRename, from) ? -1 : next<int(const char*, const char*)>("rename")(from, to);
}

INTERPOSED int link(const char* from, const char* to) noexcept
{
    return fails(kLink, from) ? -1 : next<int(const char*, const char*)>("link")(from, to);
}

INTERPOSED int fchmod(int file, mode_t mode) noexcept
{
    return fails(kFchmod, file) ? -1 : next<int(int, mode_t)>("fchmod")(file, mode);
}

INTERPOSED int mkostemp(char* name, int flags)
{
    return fails(kMkostemp, static_cast<const char*>(name))
               ? -1
               : next<decltype(mkostemp)>("mkostemp")(name, flags);
}

INTERPOSED int flock(int file, int operation) noexcept
{
    static std::atomic<bool> takesOne = std::getenv("MODRIG_FAULT_TAKEN") != nullptr;
    const PathOf path(file);
    if (std::string_view(path.text).find(kPartOfIt) != std::string_view::npos && takesOne.exchange(false))
        next<int(const char*)>("unlink")(path.text);
    return next<int(int, int)>("flock")(file, operation);
}

INTERPOSED int statfs(const char* path, struct statfs* system) noexcept
{
    const int status = next<int(const char*, struct statfs*)>("statfs")(path, system);
    if (status == 0 && std::getenv("MODRIG_FAULT_NETWORK"))
        system->f_type = kNfs;
    return status;
}
