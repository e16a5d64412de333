// A file that is replaced after the host has checked it and before it is mapped.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::Not;

namespace
{
class SwappedFile : public testing::TestWithParam<const char*>
{
protected:
    SwappedFile()
    {
        session.alwaysWith({"--safe"});
        fs::copy(fixtureModule(GetParam()), path, fs::copy_options::recursive);
        fs::copy_file(program(), other);
    }

    std::string program() const
    {
        return path.extension() == ".bundle" ? path / fs::path(GetParam()).stem() : path;
    }

    HostSession session;
    const fs::path path = session.folder() / GetParam();
    const fs::path other = session.folder() / "other";
};

std::string nameOfSwapped(const testing::TestParamInfo<const char*>& info)
{
    std::string name = info.param;
    std::ranges::replace(name, '.', '_');
    return name;
}
} // namespace

TEST_P(SwappedFile, IsRefused)
{
    session.set("LD_PRELOAD", SWAPS_FILES);
    session.set("SWAP_FILE", program());
    session.set("SWAP_WITH", other);
    const auto result = session.run({"LOAD " + path.string(), "APPS"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("swapped\n"));
    EXPECT_THAT(result.output, HasSubstr("The application \"" + path.string() + "\" is not loaded: "));
    EXPECT_THAT(result.output, Not(HasSubstr("message 1")));
    EXPECT_THAT(result.output, HasSubstr("No application is loaded.\n"));
}

TEST_P(SwappedFile, IsRefusedWhenItHasGrown)
{
    session.set("LD_PRELOAD", SWAPS_FILES);
    session.set("GROW_FILE", program());
    const auto result = session.run({"LOAD " + path.string(), "APPS"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("The application \"" + path.string() + "\" is not loaded: "));
    EXPECT_THAT(result.output, Not(HasSubstr("message 1")));
}

TEST_P(SwappedFile, IsLoadedWhenItIsTheSame)
{
    session.set("LD_PRELOAD", SWAPS_FILES);
    const auto result = session.run({"LOAD " + path.string()});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("message 1"));
}

INSTANTIATE_TEST_SUITE_P(OfEveryKind, SwappedFile,
                         testing::Values("Good.zmb", "Good.omp", "Good.bundle", "Classes.bundle"),
                         nameOfSwapped);
