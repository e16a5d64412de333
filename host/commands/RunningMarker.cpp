#include "host/commands/RunningMarker.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <ctime>
#include <memory>
#include <utility>

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/platform/PrivateFolder.h"
#include "host/platform/SmallFile.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::array<char, 16> kMagic = {'t', 'e', 's', 's', 'e', 'l', ' ', 'r',
                                         'u', 'n', 'n', 'i', 'n', 'g', ' ', '1'};
constexpr char kFilePrefix[] = "running.";
constexpr char kMarkerLock[] = "lock";
constexpr std::size_t kDeepest = 128;
constexpr std::size_t kTextBytes = 56000;

static_assert(std::atomic<std::uint32_t>::is_always_lock_free, "a signal handler must not wait");

bool readWhole(int descriptor, void* buffer, std::size_t size)
{
    return pread(descriptor, buffer, size, 0) == static_cast<ssize_t>(size);
}

bool isHeldElsewhere(const std::filesystem::path& path)
{
    const Descriptor file(open(path.c_str(), O_RDWR | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK));
    struct flock whole = {};
    whole.l_type = F_WRLCK;
    whole.l_whence = SEEK_SET;
    return file && fcntl(file.number(), F_GETLK, &whole) == 0 && whole.l_type != F_UNLCK;
}

// Written, not only made long: a page that the disk has no room for would end the process when it is touched.
bool fillWithZeros(int descriptor, std::size_t size)
{
    const std::vector<char> zeros(size);
    for (std::size_t written = 0; written < size;)
    {
        const ssize_t count =
            pwrite(descriptor, &zeros[written], size - written, static_cast<off_t>(written));
        if (count <= 0)
            return false;
        written += static_cast<std::size_t>(count);
    }
    return true;
}
} // namespace

struct RunningMarker::Slot
{
    Deed deed;
    Reason reason;
    std::atomic<std::uint32_t> waits;
    std::uint32_t textAt;
    std::uint32_t pathLength;
    std::uint32_t detailLength;
    std::int64_t since;

    std::size_t textEnd() const { return std::size_t{textAt} + pathLength + detailLength; }
};

struct RunningMarker::Page
{
    std::array<char, 16> magic;
    pid_t process;
    std::atomic<std::int32_t> ending;
    std::atomic<std::uint32_t> depth;
    std::array<Slot, kDeepest> slots;
    std::array<char, kTextBytes> texts;

    std::string_view text(std::size_t at, std::size_t length) const { return {texts.data() + at, length}; }
    // The innermost that was written down; null when there is none, or where the file is damaged.
    const Slot* top() const
    {
        const std::size_t count = std::min<std::size_t>(depth.load(std::memory_order_acquire), kDeepest);
        if (count == 0 || slots[count - 1].textEnd() > kTextBytes)
            return nullptr;
        return &slots[count - 1];
    }
};

RunningMarker::RunningMarker(const std::filesystem::path& folder)
{
    auto kept = keepIn(folder);
    if (!kept)
        mOutlivesProcess =
            Failure{translated(L"What ends Tessel cannot be remembered: {}.", kept.sentence())};
    if (!mPage)
        map(MAP_ANONYMOUS, -1);
}

Result<> RunningMarker::keepIn(const std::filesystem::path& folder)
{
    std::error_code failed;
    if (std::filesystem::create_directories(folder, failed); failed)
        return Failure{
            translated(L"the folder {} cannot be made: {}", folder, systemFailure(failed.value()).sentence)};
    // Held while we look for what others have left and make our own file: one that has no lock yet would be
    // taken for one of the dead.
    const FileLock locked(folder / kMarkerLock);
    if (!locked.held())
        return locked.held();
    collect(folder);
    make(folder);
    const int file = mFile.descriptor;
    if (file < 0 || !lockNow(file) || !fillWithZeros(file, sizeof(Page)) || !map(0, file))
        return Failure{
            translated(L"the file {} cannot be written: {}", mFile.path, systemFailure(errno).sentence)};
    return {};
}

RunningMarker::~RunningMarker()
{
    if (mPage)
        munmap(mPage, sizeof(Page));
    if (mFile.descriptor >= 0)
        unlink(mFile.path.c_str());
    mOld.push_back(mFile);
    for (const OpenFile& file : mOld)
        if (file.descriptor >= 0)
            close(file.descriptor);
}

void RunningMarker::collect(const std::filesystem::path& folder)
{
    std::error_code failed;
    for (std::filesystem::directory_iterator entry(folder, failed), end; !failed && entry != end;
         entry.increment(failed))
    {
        const std::filesystem::path& path = entry->path();
        if (!path.filename().native().starts_with(kFilePrefix))
            continue;
        const int descriptor = open(path.c_str(), O_RDWR | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK);
        if (descriptor < 0 || !lockNow(descriptor))
        {
            if (descriptor >= 0)
                close(descriptor);
            continue;
        }
        mOld.push_back({path, descriptor});
        const auto page = std::make_unique<Page>();
        const bool whole = readWhole(descriptor, page.get(), sizeof(Page)) && page->magic == kMagic;
        if (const Slot* slot = whole ? page->top() : nullptr)
        {
            const std::size_t detailAt = std::size_t{slot->textAt} + slot->pathLength;
            mLeftovers.push_back({{slot->deed, slot->reason, slot->waits != 0, slot->since,
                                   std::string(page->text(slot->textAt, slot->pathLength)),
                                   std::string(page->text(detailAt, slot->detailLength))},
                                  page->ending});
        }
    }
    std::ranges::sort(mLeftovers, {}, [](const Leftover& leftover) { return leftover.work.since; });
}

// Asked, not tried: a lock that is taken, if only for a moment, would make a session of the dead look alive.
bool RunningMarker::otherSessionRuns() const
{
    std::error_code failed;
    if (mFile.descriptor < 0)
        return false;
    for (std::filesystem::directory_iterator entry(mFile.path.parent_path(), failed), end;
         !failed && entry != end; entry.increment(failed))
        if (entry->path().filename().native().starts_with(kFilePrefix) && !holds(entry->path()) &&
            isHeldElsewhere(entry->path()))
            return true;
    return false;
}

// Of these the locks would go with any descriptor that is closed.
bool RunningMarker::holds(const std::filesystem::path& path) const
{
    return path == mFile.path || std::ranges::find(mOld, path, &OpenFile::path) != mOld.end();
}

void RunningMarker::forgetLeftovers()
{
    for (const OpenFile& file : std::exchange(mOld, {}))
    {
        unlink(file.path.c_str());
        close(file.descriptor);
    }
}

void RunningMarker::make(const std::filesystem::path& folder)
{
    const std::string name = kFilePrefix + std::to_string(getpid()) + ".";
    // A number may come again while what an earlier process of it has left is still there.
    for (std::size_t number = 0; number <= mOld.size() && mFile.descriptor < 0; ++number)
    {
        mFile.path = folder / (name + std::to_string(number));
        mFile.descriptor = open(mFile.path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, kOwnersOnly);
    }
}

bool RunningMarker::map(int flags, int file)
{
    void* mapped = mmap(nullptr, sizeof(Page), PROT_READ | PROT_WRITE, MAP_SHARED | flags, file, 0);
    if (mapped == MAP_FAILED)
        return false;
    mPage = static_cast<Page*>(mapped);
    mPage->process = getpid();
    mPage->magic = kMagic;
    return true;
}

// Once the end is noted it stays as it is: where a thread of an application ends the process, the others go
// on until it is over, and what they end would take the mark away.
bool RunningMarker::marks() const
{
    return mPage && mPage->ending == kVanished;
}

std::size_t RunningMarker::depth() const
{
    return mPage ? mPage->depth.load(std::memory_order_relaxed) : 0;
}

// Counted last: whenever the process ends, what is counted is whole.
void RunningMarker::begin(Deed deed, std::string_view path, std::string_view detail)
{
    if (!marks())
        return;
    const std::size_t depth = this->depth();
    if (depth < kDeepest)
    {
        const std::size_t at = depth == 0 ? 0 : mPage->slots[depth - 1].textEnd();
        if (at + path.size() + detail.size() > kTextBytes)
            path = detail = {};
        Slot& slot = mPage->slots[depth];
        slot.deed = deed;
        slot.reason = mReason;
        slot.waits = 0;
        slot.textAt = static_cast<std::uint32_t>(at);
        slot.pathLength = static_cast<std::uint32_t>(path.size());
        slot.detailLength = static_cast<std::uint32_t>(detail.size());
        slot.since = std::time(nullptr);
        std::ranges::copy(path, mPage->texts.begin() + static_cast<std::ptrdiff_t>(at));
        std::ranges::copy(detail, mPage->texts.begin() + static_cast<std::ptrdiff_t>(at + path.size()));
    }
    mPage->depth.store(static_cast<std::uint32_t>(depth + 1), std::memory_order_release);
}

void RunningMarker::endTo(std::size_t depth)
{
    if (marks())
        mPage->depth.store(static_cast<std::uint32_t>(depth), std::memory_order_release);
}

void RunningMarker::noteWaiting()
{
    const std::size_t depth = this->depth();
    if (depth > 0 && depth <= kDeepest && mPage->slots[depth - 1].deed == Deed::kCommand)
        mPage->slots[depth - 1].waits = 1;
}

bool RunningMarker::innermost(AtWork& work) const noexcept
{
    const Slot* slot = mPage && mPage->process == getpid() ? mPage->top() : nullptr;
    if (!slot)
        return false;
    work = {slot->deed, slot->reason, slot->waits != 0, mPage->text(slot->textAt, slot->pathLength),
            mPage->text(std::size_t{slot->textAt} + slot->pathLength, slot->detailLength)};
    return true;
}

void RunningMarker::noteEnding(int ending) noexcept
{
    if (mPage && mPage->process == getpid())
        mPage->ending = ending;
}

std::wstring wordsFor(RunningMarker::Deed deed, const std::wstring& detail)
{
    switch (deed)
    {
    case RunningMarker::Deed::kEntryPoint:
        return translated(L"while its entry point ran");
    case RunningMarker::Deed::kUnloading:
        return translated(L"while it was being unloaded");
    case RunningMarker::Deed::kCommand:
        return translated(L"while its command \"{}\" ran", detail);
    case RunningMarker::Deed::kLispFile:
        return translated(L"while its Lisp ran");
    case RunningMarker::Deed::kLoading:
        break;
    }
    return translated(L"while it was being loaded");
}

std::wstring wordsForEnding(int ending)
{
    struct Words
    {
        int ending;
        Sentence<> text;
    };
    static constexpr Words kWords[] = {
        {RunningMarker::kVanished,
         Sentence(L"it ended without a signal that can be caught, by \"_exit\", a kill "
                  L"or a power cut")},
        {RunningMarker::kCalledExit, Sentence(L"it called \"exit\"")},
        {RunningMarker::kEndedByKey, Sentence(L"you ended it with Ctrl-C")},
        {SIGSEGV, Sentence(L"memory fault (SIGSEGV)")},
        {SIGBUS, Sentence(L"memory fault (SIGBUS)")},
        {SIGABRT, Sentence(L"it stopped at an error of its own (SIGABRT)")},
        {SIGFPE, Sentence(L"arithmetic fault (SIGFPE)")},
        {SIGILL, Sentence(L"unknown instruction (SIGILL)")},
        {SIGTRAP, Sentence(L"breakpoint (SIGTRAP)")},
        {SIGSYS, Sentence(L"unknown call of the system (SIGSYS)")},
        {SIGQUIT, Sentence(L"quit from outside (SIGQUIT)")},
        {SIGTERM, Sentence(L"it did not come back (SIGTERM)")},
        {SIGHUP, Sentence(L"it did not come back (SIGHUP)")},
        {SIGINT, Sentence(L"it did not come back (SIGINT)")},
        {SIGXCPU, Sentence(L"too much time used (SIGXCPU)")}};
    for (const Words& words : kWords)
        if (words.ending == ending)
            return translated(words.text);
    return translated(L"a signal");
}
} // namespace tessel
