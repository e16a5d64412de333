// What the check of a shared library promises, tried on a real one: no cut file and no changed header byte
// may end the process.
#include "tests/host/support/HostWithModules.h"
#include "tests/support/Content.h"

#include <cstring>
#include <fstream>
#include <iterator>
#include <random>

#include <elf.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/platform/ImageCheck.h"
#include "host/platform/RegularFile.h"

namespace
{
std::string goodModule()
{
    return contentOf(std::filesystem::path(FIXTURE_MODULES) / "Good.zmb");
}

std::wstring check(std::string_view content)
{
    return tessel::checkMappable(content.size(),
                                 [&](std::uint64_t offset, void* buffer, std::size_t size)
                                 {
                                     if (size > content.size() || offset > content.size() - size)
                                         return false;
                                     std::memcpy(buffer, content.data() + offset, size);
                                     return true;
                                 })
        .sentence();
}

template <class Field>
std::string with(std::string content, std::size_t offset, Field value)
{
    std::memcpy(content.data() + offset, &value, sizeof value);
    return content;
}

// How many bytes at the beginning the check reads.
std::size_t headerSize(const std::string& content)
{
    Elf64_Ehdr header;
    std::memcpy(&header, content.data(), sizeof header);
    return header.e_phoff + header.e_phnum * sizeof(Elf64_Phdr);
}
} // namespace

TEST(ImageCheck, FindsNothingWrongWithAnyLibraryThatWasBuiltHere)
{
    for (const auto& entry : std::filesystem::directory_iterator(FIXTURE_MODULES))
        if (entry.is_regular_file())
        {
            EXPECT_EQ(check(contentOf(entry.path())), L"") << entry.path();
        }
}

TEST(ImageCheck, FindsNothingWrongWithTheSystemsOwnLibraries)
{
    constexpr std::wstring_view kRunsToo =
        L"it is a program, not a shared library"; // true of a few libraries
    constexpr std::wstring_view kScript =
        L"it is not a shared library"; // for the linker, under a library's name
    std::size_t libraries = 0;
    for (const auto& entry : std::filesystem::directory_iterator("/usr/lib/x86_64-linux-gnu"))
    {
        if (!entry.is_regular_file() || entry.path().native().find(".so") == std::string::npos)
            continue;
        const tessel::RegularFile file(entry.path());
        const auto read = [&](std::uint64_t offset, void* buffer, std::size_t size)
        {
            return file.read(offset, buffer, size);
        };
        const std::wstring whyNot = tessel::checkMappable(file.size(), read).sentence();
        if (whyNot == kRunsToo || whyNot == kScript)
            continue;
        EXPECT_EQ(whyNot, L"") << entry.path();
        ++libraries;
    }
    EXPECT_GT(libraries, 50U);
}

TEST(ImageCheck, RefusesEveryBeginningOfALibrary)
{
    const std::string content = goodModule();
    for (std::size_t length = 0; length < content.size(); ++length)
    {
        const auto whyNot = check(std::string_view(content).substr(0, length));
        ASSERT_EQ(whyNot, length < SELFMAG ? L"it is not a shared library" : L"the file is cut short")
            << length << " of " << content.size();
    }
}

TEST(ImageCheck, TellsOtherKindsOfFilesApart)
{
    const std::string content = goodModule();
    EXPECT_EQ(check(with(content, offsetof(Elf64_Ehdr, e_machine), std::uint16_t{EM_AARCH64})),
              L"it is built for another kind of processor");
    EXPECT_EQ(check(with(content, EI_CLASS, char{ELFCLASS32})), L"it is built for another kind of processor");
    EXPECT_EQ(check(with(content, offsetof(Elf64_Ehdr, e_type), std::uint16_t{ET_REL})),
              L"it is an object file, not a shared library");
    EXPECT_EQ(check(with(content, offsetof(Elf64_Ehdr, e_type), std::uint16_t{ET_EXEC})),
              L"it is a program, not a shared library");
    EXPECT_EQ(check(contentOf("/proc/self/exe")), L"it is a program, not a shared library");
    EXPECT_EQ(check("MZ and then something"), L"it is not a shared library");
}

class DamagedModule : public HostWithModules
{
protected:
    // Loads the content in a process of its own. True when that ended by itself: after a refusal with one
    // sentence, or after a load that worked.
    bool survives(const std::string& content)
    {
        const auto path = mFolder.write("damaged.zmb", content);
        const pid_t child = fork();
        if (child == 0)
        {
            const bool loaded = load(path);
            const std::string said = output();
            const bool oneSentence = said.starts_with("The application ") && said.ends_with(".\n");
            _exit(loaded || oneSentence ? 0 : 1);
        }
        int status = 0;
        waitpid(child, &status, 0);
        return WIFEXITED(status) && WEXITSTATUS(status) == 0;
    }
};

TEST_F(DamagedModule, IsRefusedWhereverItIsCut)
{
    const std::string content = goodModule();
    for (std::size_t length = 1; length < content.size(); length += 97)
    {
        const auto path = mFolder.write("cut.zmb", content.substr(0, length));
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(),
                  notLoaded(path, length < SELFMAG ? "it is not a shared library" : "the file is cut short"));
    }
}

TEST_F(DamagedModule, NeverEndsTheHostByAChangedBitInItsHeaders)
{
    const std::string content = goodModule();
    std::mt19937 random(20240229);
    for (std::size_t offset = 0; offset < headerSize(content); ++offset)
    {
        const auto bit = random() % 8;
        const char changed = static_cast<char>(content[offset] ^ (1 << bit));
        EXPECT_TRUE(survives(with(content, offset, changed))) << "bit " << bit << " of byte " << offset;
    }
}

TEST_F(DamagedModule, NeverEndsTheHostByRandomHeaderBytes)
{
    const std::string content = goodModule();
    std::mt19937 random(42);
    for (int i = 0; i < 300; ++i)
    {
        std::string damaged = content;
        for (int changes = 0; changes < 4; ++changes)
            damaged[random() % headerSize(content)] = static_cast<char>(random());
        EXPECT_TRUE(survives(damaged)) << "attempt " << i;
    }
}
