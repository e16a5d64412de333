#include "host/console/SessionLog.h"

#include <array>
#include <cerrno>
#include <chrono>
#include <cstdio>
#include <ctime>

#include <fcntl.h>
#include <sys/stat.h>

#include "host/platform/OrdinaryFile.h"
#include "host/platform/PrivateFolder.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
std::string timeNow()
{
    using namespace std::chrono;
    const auto now = time_point_cast<milliseconds>(system_clock::now());
    const std::time_t seconds = system_clock::to_time_t(floor<std::chrono::seconds>(now));
    const auto part = static_cast<unsigned>((now.time_since_epoch() % 1s).count());
    std::tm local{};
    localtime_r(&seconds, &local);
    std::array<char, 32> day{};
    std::array<char, 16> zone{};
    std::array<char, 64> all{};
    std::strftime(day.data(), day.size(), "%Y-%m-%dT%H:%M:%S", &local);
    std::strftime(zone.data(), zone.size(), "%z", &local);
    std::snprintf(all.data(), all.size(), "%s.%03u%s ", day.data(), part, zone.data());
    return all.data();
}

Result<> checkIsOrdinary(const Descriptor& file)
{
    struct stat status = {};
    return fstat(file.number(), &status) == 0 ? checkOrdinary(status) : systemFailure(errno);
}
} // namespace

Result<SessionLog> SessionLog::open(const std::filesystem::path& file)
{
    const auto failed = [&](const std::wstring& reason)
    {
        return Failure{translated(L"The log {} cannot be written: {}.", file, reason)};
    };
    Descriptor opened(
        ::open(file.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NONBLOCK | O_NOCTTY, kOwnersOnly));
    if (!opened)
        return failed(systemFailure(errno).sentence);
    if (const auto ordinary = checkIsOrdinary(opened); !ordinary)
        return failed(ordinary.sentence());
    return SessionLog(file, std::move(opened));
}

void SessionLog::record(std::string_view text)
{
    for (std::size_t end = text.find('\n'); end != text.npos; end = text.find('\n'))
    {
        mOpenLine += text.substr(0, end);
        writeLine(mOpenLine);
        mOpenLine.clear();
        text.remove_prefix(end + 1);
    }
    mOpenLine += text;
}

void SessionLog::writeLine(std::string_view line)
{
    auto written = mOpened.write(timeNow().append(line).append("\n"));
    if (mWritten)
        mWritten = std::move(written);
}

Result<> SessionLog::finish()
{
    if (!mOpenLine.empty())
        writeLine(mOpenLine);
    mOpenLine.clear();
    if (mWritten)
        return {};
    return Failure{translated(L"Some of the log {} could not be written: {}.", mFile, mWritten.sentence())};
}
} // namespace tessel
