// The check of Mach-O files, asked about files that a linker for macOS has made. The machine that the check
// believes itself on has an Intel processor (tests/fuzz/macos_headers).
#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <iterator>
#include <string>
#include <vector>

#include <tessel/tsversion.h>

#include <mach-o/loader.h>

#include "host/applications/SdkVersion.h"

namespace
{
using Bytes = std::vector<char>;

const std::filesystem::path kBuild = MODRIG_MACOS_BUILD;

Bytes bytesOf(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    EXPECT_TRUE(stream) << file;
    return Bytes(std::istreambuf_iterator<char>(stream), {});
}

tessel::ReadAt reading(const Bytes& bytes)
{
    return [&bytes](std::uint64_t offset, void* buffer, std::size_t wanted)
    {
        if (wanted > bytes.size() || offset > bytes.size() - wanted)
            return false;
        std::memcpy(buffer, bytes.data() + offset, wanted);
        return true;
    };
}

// The end of the sentence that says why a file is refused; nothing when it is not.
std::wstring refusal(const Bytes& bytes)
{
    const auto checked = tessel::checkMappable(bytes.size(), reading(bytes));
    return checked ? std::wstring() : checked.sentence();
}

mach_header_64 headerOf(const Bytes& bytes)
{
    mach_header_64 header = {};
    std::memcpy(&header, bytes.data(), sizeof header);
    return header;
}

Bytes cutTo(const Bytes& bytes, std::size_t size)
{
    return Bytes(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(size));
}
} // namespace

TEST(MachOFiles, AModuleAndALibraryForThisProcessorAreAccepted)
{
    for (const char* file :
         {"samples/primes.zmb", "samples/gears.omp", "samples/moon.bundle/Contents/MacOS/moon",
          "Tessel.app/Contents/MacOS/libtessel.dylib",
          "Tessel.app/Contents/PlugIns/Modrig.bundle/Contents/MacOS/Modrig"})
        EXPECT_EQ(refusal(bytesOf(kBuild / "x86_64" / file)), L"") << file;
}

TEST(MachOFiles, OfAUniversalFileThisProcessorsHalfIsTaken)
{
    EXPECT_EQ(refusal(bytesOf(kBuild / "universal/samples/primes.zmb")), L"");
    EXPECT_EQ(refusal(bytesOf(kBuild / "universal/Tessel.app/Contents/MacOS/Tessel")),
              L"it is a program, not a shared library");
}

TEST(MachOFiles, AModuleForAnotherProcessorIsRefused)
{
    EXPECT_EQ(refusal(bytesOf(kBuild / "arm64/samples/primes.zmb")),
              L"it is built for another kind of processor");
}

TEST(MachOFiles, AProgramAndACompiledSourceAreNoLibraries)
{
    EXPECT_EQ(refusal(bytesOf(kBuild / "x86_64/Tessel.app/Contents/MacOS/Tessel")),
              L"it is a program, not a shared library");
    const auto object = kBuild / "x86_64/samples_build/CMakeFiles/primes.dir/primes/Primes.cpp.o";
    EXPECT_EQ(refusal(bytesOf(object)), L"it is not a shared library");
}

TEST(MachOFiles, AFileOfAnotherSystemIsRefused)
{
    EXPECT_EQ(refusal(bytesOf("/proc/self/exe")), L"it is not a shared library");
    EXPECT_EQ(refusal(Bytes(1000, 'x')), L"it is not a shared library");
}

TEST(MachOFiles, AFileThatEndsInItsHeadersIsRefused)
{
    const Bytes whole = bytesOf(kBuild / "x86_64/samples/primes.zmb");
    const std::size_t headers = sizeof(mach_header_64) + headerOf(whole).sizeofcmds;
    for (std::size_t size = 0; size < headers; ++size)
        ASSERT_NE(refusal(cutTo(whole, size)), L"") << size;
    EXPECT_EQ(refusal(cutTo(whole, headers)), L"the file is cut short");
}

TEST(MachOFiles, AFileThatHasLostAnythingOfItsEndIsRefused)
{
    const Bytes whole = bytesOf(kBuild / "x86_64/samples/primes.zmb");
    for (const std::size_t lost : {std::size_t{1}, whole.size() / 3, whole.size() / 2})
        EXPECT_EQ(refusal(cutTo(whole, whole.size() - lost)), L"the file is cut short") << lost;
}

TEST(MachOFiles, HeadersThatContradictThemselvesAreRefused)
{
    const Bytes whole = bytesOf(kBuild / "x86_64/samples/primes.zmb");
    // The first command is a segment's: it may not end before itself, nor after all commands.
    for (const std::uint32_t size : {0U, 7U, 8U, 71U, headerOf(whole).sizeofcmds + 1})
    {
        Bytes changed = whole;
        std::memcpy(changed.data() + sizeof(mach_header_64) + offsetof(load_command, cmdsize), &size,
                    sizeof size);
        EXPECT_EQ(refusal(changed), L"its program headers are damaged") << size;
    }
    Bytes more = whole;
    mach_header_64 header = headerOf(whole);
    ++header.ncmds;
    std::memcpy(more.data(), &header, sizeof header);
    EXPECT_EQ(refusal(more), L"its program headers are damaged");
}

TEST(MachOFiles, AUniversalFileThatEndsBeforeItsHalvesDoIsRefused)
{
    const Bytes whole = bytesOf(kBuild / "universal/samples/primes.zmb");
    const std::size_t half = bytesOf(kBuild / "x86_64/samples/primes.zmb").size();
    EXPECT_EQ(refusal(cutTo(whole, 0)), L"it is not a shared library");
    EXPECT_EQ(refusal(cutTo(whole, 6)), L"the file is cut short");
    EXPECT_EQ(refusal(cutTo(whole, half / 2)), L"the file is cut short");
}

TEST(MachOFiles, AUniversalFileIsWhatItsHalfForThisProcessorIs)
{
    const Bytes whole = bytesOf(kBuild / "universal/samples/primes.zmb");
    // The table of the halves, most significant byte first: a processor, what kind of it, a place, a size.
    constexpr std::size_t kCount = 4;
    constexpr std::size_t kTable = 8;
    constexpr std::size_t kEntry = 20;
    const auto with = [&](std::size_t place, std::initializer_list<int> bytes)
    {
        Bytes changed = whole;
        std::transform(bytes.begin(), bytes.end(), changed.begin() + static_cast<std::ptrdiff_t>(place),
                       [](int byte) { return static_cast<char>(byte); });
        return changed;
    };
    // Which of the two is ours is the linker's to choose: both are given another processor, then each
    // other's.
    Bytes foreign = with(kTable, {0, 0, 0, 18});
    std::copy_n(foreign.begin() + kTable, 4, foreign.begin() + kTable + kEntry);
    EXPECT_EQ(refusal(foreign), L"it is built for another kind of processor");
    Bytes exchanged = whole;
    std::swap_ranges(exchanged.begin() + kTable, exchanged.begin() + kTable + 4,
                     exchanged.begin() + kTable + kEntry);
    EXPECT_EQ(refusal(exchanged), L"it is built for another kind of processor");
    EXPECT_EQ(refusal(with(kCount, {0, 0, 0, 0})), L"it is built for another kind of processor");
    EXPECT_EQ(refusal(with(kCount, {0, 0, 0, 33})), L"it is not a shared library");
}

TEST(MachOFiles, AFileOfAnotherKindIsRefused)
{
    const Bytes whole = bytesOf(kBuild / "x86_64/samples/primes.zmb");
    constexpr std::uint32_t kCore = 4;
    constexpr std::uint32_t kDebuggingSymbols = 10;
    for (const std::uint32_t kind : {0U, 1U, kCore, kDebuggingSymbols, 0xFFFFFFFFU})
    {
        mach_header_64 header = headerOf(whole);
        header.filetype = kind;
        Bytes changed = whole;
        std::memcpy(changed.data(), &header, sizeof header);
        EXPECT_EQ(refusal(changed), L"it is not a shared library") << kind;
    }
    Bytes old = whole;
    old[0] = '\xCE'; // a file for processors of 32 bits
    EXPECT_EQ(refusal(old), L"it is not a shared library");
}

TEST(MachOFiles, TheVersionOfTheSdkIsReadFromEitherKindOfFile)
{
    const tessel::SdkVersion own{TESSEL_SDK_VERSION_MAJOR, TESSEL_SDK_VERSION_MINOR};
    for (const char* folder : {"x86_64", "universal"})
    {
        const Bytes bytes = bytesOf(kBuild / folder / "samples/primes.zmb");
        EXPECT_EQ(tessel::sdkVersionIn(bytes.size(), reading(bytes)), own) << folder;
    }
    const Bytes library = bytesOf(kBuild / "x86_64/Tessel.app/Contents/MacOS/libtessel.dylib");
    EXPECT_EQ(tessel::sdkVersionIn(library.size(), reading(library)), std::nullopt);
}
