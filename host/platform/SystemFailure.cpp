#include "host/platform/SystemFailure.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iterator>

#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// The system would translate its words by the locale, which need not be installed.
struct KnownError
{
    int number;
    Sentence<> words;
};

constexpr KnownError kKnownErrors[] = {
    {E2BIG, Sentence(L"Argument list too long")},
    {EACCES, Sentence(L"Permission denied")},
    {EBUSY, Sentence(L"Device or resource busy")},
    {ECONNREFUSED, Sentence(L"Connection refused")},
    {EDQUOT, Sentence(L"Disk quota exceeded")},
    {EEXIST, Sentence(L"File exists")},
    {EFBIG, Sentence(L"File too large")},
    {EINVAL, Sentence(L"Invalid argument")},
    {EIO, Sentence(L"Input/output error")},
    {EISDIR, Sentence(L"Is a directory")},
    {ELOOP, Sentence(L"Too many levels of symbolic links")},
    {EMFILE, Sentence(L"Too many open files")},
    {ENAMETOOLONG, Sentence(L"File name too long")},
    {ENFILE, Sentence(L"Too many open files in system")},
    {ENODEV, Sentence(L"No such device")},
    {ENOENT, Sentence(L"No such file or directory")},
    {ENOEXEC, Sentence(L"Exec format error")},
    {ENOLCK, Sentence(L"No locks available")},
    {ENOMEM, Sentence(L"Cannot allocate memory")},
    {ENOSPC, Sentence(L"No space left on device")},
    {ENOTDIR, Sentence(L"Not a directory")},
    {ENOTEMPTY, Sentence(L"Directory not empty")},
    {ENXIO, Sentence(L"No such device or address")},
    {EPERM, Sentence(L"Operation not permitted")},
    {EPIPE, Sentence(L"Broken pipe")},
    {EROFS, Sentence(L"Read-only file system")},
    {ESTALE, Sentence(L"Stale file handle")},
    {ETIMEDOUT, Sentence(L"Connection timed out")},
    {ETXTBSY, Sentence(L"Text file busy")},
    {EXDEV, Sentence(L"Invalid cross-device link")},
};
} // namespace

Failure systemFailure(int error)
{
    const auto* known = std::ranges::find(kKnownErrors, error, &KnownError::number);
    return {known == std::end(kKnownErrors) ? toWide(std::strerror(error)) : translated(known->words)};
}
} // namespace tessel
