// What the dialog stores when it is closed, and what becomes of it where nothing can be stored.
#include "tests/integration/ModrigInHost.h"

#include <csignal>
#include <fstream>

#include <sys/resource.h>

#include <gmock/gmock.h>

using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

namespace fs = std::filesystem;

namespace
{
using Paths = ModrigUnderTest::Paths;

constexpr char kMessage19[] = "Message: A list of applications could not be stored in the registry. Changes "
                              "made since it was last stored may be lost.\n";

Paths manyPaths(std::size_t count, const std::wstring& folder)
{
    Paths paths;
    for (std::size_t index = 1; index <= count; ++index)
        paths.push_back(folder + L"/größe " + std::to_wstring(index) + L" 100%s.lsp");
    return paths;
}

// No file of this process grows beyond the size while the object lives: the disk is full.
class FullDisk
{
public:
    explicit FullDisk(rlim_t bytes) : mSignal(std::signal(SIGXFSZ, SIG_IGN))
    {
        getrlimit(RLIMIT_FSIZE, &mLimit);
        const rlimit full = {bytes, mLimit.rlim_max};
        setrlimit(RLIMIT_FSIZE, &full);
    }
    ~FullDisk()
    {
        setrlimit(RLIMIT_FSIZE, &mLimit);
        std::signal(SIGXFSZ, mSignal);
    }
    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;

private:
    rlimit mLimit = {};
    void (*mSignal)(int);
};

class Storing : public ModrigInHost
{
protected:
    Storing() { said(); }

    static void close(const Paths& suite, const Paths& files)
    {
        ModrigUnderTest::replaceStartup(suite);
        ModrigUnderTest::replaceHistory(files);
        ModrigUnderTest::close();
    }

    // Closes the dialog with these lists.
    void store(const Paths& suite, const Paths& files)
    {
        dialog([&] { close(suite, files); });
    }

    // The next session finds these lists.
    void expectStored(const Paths& suite, const Paths& files)
    {
        restart();
        loadModrig();
        EXPECT_EQ(ModrigUnderTest::startup(), suite);
        EXPECT_EQ(ModrigUnderTest::history(), files);
    }

    fs::path registry() const { return profile() / "registry.db"; }

    const Paths startup = {L"tool without a dot"}; // listed, and never loaded
    const Paths history = manyPaths(3, L"/before");
};
} // namespace

TEST_F(Storing, KeepsAHistoryOfFiveThousand)
{
    const Paths many = manyPaths(5000, L"/a/b");
    store({}, many);
    EXPECT_EQ(said(), "");
    expectStored({}, many);
    EXPECT_EQ(said(), "");
    store({}, history);
    expectStored({}, history);
}

TEST_F(Storing, OfAShorterListLeavesNothingOfTheLongerOne)
{
    store(startup, manyPaths(5, L"/a"));
    store({}, history);
    said();
    EXPECT_TRUE(type(LR"(REGISTRY LIST Software\Tessel\R21\Profiles\Default\Dialogs\Modrig\History)"));
    EXPECT_EQ(said(), "NumHistory = 3\n"
                      "1History = /before/größe 1 100%s.lsp\n"
                      "2History = /before/größe 2 100%s.lsp\n"
                      "3History = /before/größe 3 100%s.lsp\n");
    EXPECT_TRUE(type(LR"(REGISTRY LIST Software\Tessel\R21\Profiles\Default\Dialogs\Modrig\Startup)"));
    EXPECT_EQ(said(), "NumStartup = 0\n");
}

TEST_F(Storing, InARegistryThatMayOnlyBeReadIsTold)
{
    store(startup, history);
    fs::permissions(registry(), fs::perms::owner_read);
    restart();
    loadModrig();
    EXPECT_EQ(said(),
              "The registry " + registry().string() +
                  " may only be read: what is stored there is used, and nothing new will be stored.\n");
    EXPECT_EQ(ModrigUnderTest::startup(), startup);
    EXPECT_EQ(ModrigUnderTest::history(), history);
    store({}, manyPaths(10, L"/later"));
    EXPECT_EQ(said(), std::string(kMessage19) + kMessage19);
    fs::permissions(registry(), fs::perms::owner_read | fs::perms::owner_write);
    expectStored(startup, history);
}

TEST_F(Storing, InAFileThatIsNoRegistryIsToldAndTheFileIsLeftAlone)
{
    const std::string letter = "Dear Sir or Madam, " + std::string(5000, 'x');
    end();
    folder.write("profile/registry.db", letter);
    restart();
    loadModrig();
    EXPECT_THAT(said(),
                StartsWith("The registry " + registry().string() +
                           " cannot be used: file is not a database. It was left as it is, and nothing "
                           "will be stored. REGISTRY RESTORE puts back the copy of 2"));
    store(startup, history);
    EXPECT_EQ(said(), std::string(kMessage19) + kMessage19);
    std::ifstream file(registry(), std::ios::binary);
    const std::string after{std::istreambuf_iterator<char>(file), {}};
    EXPECT_TRUE(after == letter);
}

TEST_F(Storing, OnAFullDiskIsToldAndWhatWasStoredBeforeIsStillThere)
{
    store(startup, history);
    restart();
    loadModrig();
    said();
    {
        const FullDisk fullDisk(fs::file_size(registry()) + 100'000);
        EXPECT_FALSE(tryDialog([] { close({}, manyPaths(5000, L"/later")); }));
    }
    const std::string told = said();
    EXPECT_THAT(
        told,
        AllOf(HasSubstr(kMessage19), HasSubstr("The registry " + registry().string()),
              HasSubstr("could not be written: File too large. What was stored before is unchanged. ")));
    EXPECT_TRUE(type(L"VERSION")) << "the command after it is stored again";
    expectStored(startup, history);
    store({}, history);
    EXPECT_EQ(said(), "");
    expectStored({}, history);
}
