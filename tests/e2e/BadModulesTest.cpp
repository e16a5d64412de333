// Modules that cannot be loaded: the host names the file and the reason, and lives on.
#include <gmock/gmock.h>

#include <filesystem>

#include "tests/e2e/HostProcess.h"

using testing::AllOf;
using testing::HasSubstr;

namespace
{
struct BadModule
{
    const char* file;
    const char* reason; // how the sentence goes on
};

// Names the case in the list of tests; without it the name would hold addresses.
void PrintTo(const BadModule& module, std::ostream* stream)
{
    *stream << module.file;
}

std::string fixture(const std::string& file)
{
    return std::string(FIXTURE_MODULES) + "/" + file;
}

class BadModules : public testing::TestWithParam<BadModule>
{
protected:
    BadModules() { session.alwaysWith({"--safe"}); }

    HostSession session;
};

std::string nameOf(const testing::TestParamInfo<BadModule>& info)
{
    std::string name = std::filesystem::path(info.param.file).stem();
    return name;
}
} // namespace

TEST_P(BadModules, AreToldInOneSentenceAndTheHostLivesOn)
{
    const std::string path = fixture(GetParam().file);
    const auto result = session.run({"LOAD " + path, "APPS", "LOAD " + fixture("Good.zmb"), "APPS"});
    EXPECT_EQ(result.exitStatus, 1) << result.output;
    EXPECT_THAT(result.output,
                AllOf(HasSubstr("The application \"" + path + "\" is not loaded: " + GetParam().reason),
                      HasSubstr("Command: APPS\nNo application is loaded.\n"), HasSubstr("\n  Good.zmb ")));
}

INSTANTIATE_TEST_SUITE_P(
    OfEveryKind, BadModules,
    testing::Values(
        BadModule{"NoEntry.zmb", "it has no entry point \"tsrxEntryPoint\""},
        BadModule{"Unresolved.zmb", "undefined symbol: aFunctionThatNobodyHas"},
        BadModule{"UnresolvedClasses.bundle", "undefined symbol: aFunctionThatNobodyHas"},
        BadModule{"UnresolvedMember.zmb", "undefined symbol: moon::phaseOf(wchar_t const*, int).\n"},
        BadModule{"MissingDependency.zmb", "libfixture_absent.so: cannot open shared object file"},
        BadModule{"Answers3.zmb", "its entry point answered 3"},
        BadModule{"Throws.zmb", "its entry point threw an exception: the coffee is cold"},
        BadModule{"ThrowsNumber.omp", "its entry point threw something"},
        BadModule{"ThrowsInMapping.zmb",
                  "while it was being mapped, its code threw an exception: the ruler is broken.\n"},
        BadModule{"RaisesInMapping.bundle", "while it was being mapped, its code threw an exception: "
                                            "NSInternalInconsistencyException: the kettle is empty.\n"},
        BadModule{"Raises.bundle",
                  "its entry point threw an exception: NSInvalidArgumentException: the tea is cold"},
        BadModule{"Missing.bundle", "No such file or directory"}),
    nameOf);

TEST(BadModule, ThatIsCutShortIsRefusedBeforeItIsMapped)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto cut = session.folder() / "cut short.zmb";
    std::filesystem::copy_file(fixture("Good.zmb"), cut);
    std::filesystem::resize_file(cut, std::filesystem::file_size(cut) / 2);
    const auto result = session.run({"LOAD \"" + cut.string() + "\"", "VERSION"});
    EXPECT_EQ(result.exitStatus, 1) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr(cut.string()), HasSubstr("Command: VERSION\nTessel R21")));
}

TEST(BadModule, ThatRefusesToLeaveStays)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result =
        session.run({"LOAD " + fixture("RefusesToUnload.omp"), "UNLOAD RefusesToUnload.omp", "APPS"});
    EXPECT_EQ(result.exitStatus, 1) << result.output;
    EXPECT_THAT(result.output,
                AllOf(HasSubstr("is not unloaded: "), HasSubstr("Command: APPS\n  RefusesToUnload.omp")));
}
