// Which file is behind the memory of the process, by either way of asking the system.
#include "host/applications/platform/ElfMappings.h"

#include <fstream>
#include <iostream>
#include <memory>

#include <dlfcn.h>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/applications/platform/MappedImage.h"
#include "host/platform/Descriptor.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
constexpr std::size_t kPage = 4096;

class MappedFiles : public testing::Test
{
protected:
    // As many of these as are wanted are mapped; each is unmapped at the end of the process.
    static const void* mapped(const std::filesystem::path& file)
    {
        const tessel::Descriptor opened(open(file.c_str(), O_RDONLY | O_CLOEXEC));
        const void* page = mmap(nullptr, kPage, PROT_READ, MAP_PRIVATE, opened.number(), 0);
        return page == MAP_FAILED ? nullptr : page;
    }

    std::filesystem::path file(const std::string& name) const
    {
        std::ofstream(mFolder / name) << name;
        return mFolder / name;
    }

    static ino_t inodeOf(const std::filesystem::path& file)
    {
        struct stat status = {};
        EXPECT_EQ(stat(file.c_str(), &status), 0);
        return status.st_ino;
    }

    // Whether the system can be asked about one address, which some are too old for.
    static bool canBeAsked() { return tessel::fileAskedFor(&std::cout).has_value(); }

    TemporaryFolder mFolder;
};
} // namespace

TEST_F(MappedFiles, AreToldApartByEitherWay)
{
    const auto one = file("one");
    const auto two = file("two");
    const void* ofOne = mapped(one);
    const void* ofTwo = mapped(two);
    for (const auto ask : {tessel::fileMappedAt, tessel::fileListedFor})
    {
        ASSERT_TRUE(ask(ofOne) && ask(ofTwo));
        EXPECT_EQ(ask(ofOne)->inode, inodeOf(one));
        EXPECT_EQ(ask(ofTwo)->inode, inodeOf(two));
        EXPECT_EQ(ask(ofOne)->device, ask(ofTwo)->device);
    }
}

TEST_F(MappedFiles, AreFoundByAnyAddressOfTheirsAndByNoneAfterThem)
{
    const char* page = static_cast<const char*>(mapped(file("one")));
    const auto file = tessel::fileListedFor(page);
    ASSERT_TRUE(file);
    EXPECT_EQ(tessel::fileListedFor(page + kPage - 1), file);
    EXPECT_NE(tessel::fileListedFor(page + kPage), file);
    EXPECT_NE(tessel::fileListedFor(page - 1), file);
}

TEST_F(MappedFiles, AreTheSameToTheSystemAskedAndToItsList)
{
    if (!canBeAsked())
        GTEST_SKIP() << "this system is too old to be asked";
    const auto heap = std::make_unique<int>();
    const void* const addresses[] = {mapped(file("one")), &kPage, heap.get(),
                                     reinterpret_cast<const void*>(&open)};
    for (const void* address : addresses)
    {
        ASSERT_TRUE(tessel::fileAskedFor(address));
        EXPECT_EQ(tessel::fileAskedFor(address), tessel::fileListedFor(address));
    }
}

TEST_F(MappedFiles, AreNoneWhereNothingIsMapped)
{
    for (const auto ask : {tessel::fileMappedAt, tessel::fileListedFor, tessel::fileAskedFor})
        EXPECT_FALSE(ask(nullptr));
}

TEST_F(MappedFiles, AreThoseOfTheProcessThatAsks)
{
    static_cast<void>(tessel::fileMappedAt(&kPage));
    const auto path = file("one");
    const pid_t child = fork();
    if (child == 0)
    {
        const auto found = tessel::fileAskedFor(mapped(path));
        _exit(!canBeAsked() || (found && found->inode == inodeOf(path)) ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    EXPECT_EQ(status, 0);
}

TEST_F(MappedFiles, LeaveOneDescriptorOpenHoweverManyAreAskedFor)
{
    const auto next = []
    {
        return tessel::Descriptor(open("/dev/null", O_RDONLY | O_CLOEXEC)).number();
    };
    static_cast<void>(tessel::fileMappedAt(&kPage));
    const int before = next();
    for (int i = 0; i < 3; ++i)
    {
        static_cast<void>(tessel::fileMappedAt(&kPage));
        static_cast<void>(tessel::fileListedFor(&kPage));
    }
    EXPECT_EQ(next(), before);
}

TEST_F(MappedFiles, OfALibraryAreKnownByItsHandle)
{
    const std::filesystem::path good = std::filesystem::path(FIXTURE_MODULES) / "Good.zmb";
    const auto path = mFolder / "Good.zmb";
    std::filesystem::copy_file(good, path);
    void* library = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    ASSERT_TRUE(library);
    EXPECT_TRUE(tessel::isMappedFrom(library, tessel::RegularFile(path)));
    EXPECT_FALSE(tessel::isMappedFrom(library, tessel::RegularFile(good)));
    const void* address = tessel::addressIn(library);
    EXPECT_TRUE(tessel::isInLibrary(address));
    ASSERT_EQ(dlclose(library), 0);
    EXPECT_FALSE(tessel::isInLibrary(address));
}
