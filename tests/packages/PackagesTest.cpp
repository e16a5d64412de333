// The packages by themselves: what they say they hold and need, and what installing and removing them leaves.
#include <set>

#include <gmock/gmock.h>

#include "tests/packages/Packages.h"
#include "tests/support/TemporaryFolder.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace
{
constexpr char kAllPackages[] = PACKAGES "/*.deb";

std::string field(const std::string& package, const std::string& name)
{
    return runCommand("dpkg-deb --field '" + packageFile(package).string() + "' " + name).output;
}

// A root folder with an empty dpkg in it.
class Root
{
public:
    Root()
    {
        for (const char* folder : {"info", "updates", "triggers"})
            fs::create_directories(mFolder / "var/lib/dpkg" / folder);
        mFolder.write("var/lib/dpkg/status", "");
    }

    // The packages that these need are installed in the real root, if anywhere. Also where dpkg is told to
    // leave manuals out.
    CommandOutcome dpkg(const std::string& arguments) const
    {
        const std::string asRoot = geteuid() == 0 ? "" : "fakeroot ";
        return runCommand(
            asRoot + "dpkg --root='" + mFolder.path().string() +
            "' --force-not-root --force-bad-path --force-depends --force-unsafe-io --path-include='*' " +
            arguments);
    }

    std::string installed() const
    {
        return runCommand("dpkg-query --admindir='" + (mFolder / "var/lib/dpkg").string() +
                          "' -W -f='${db:Status-Abbrev}${Package} ${Version}\n'")
            .output;
    }

    // Without what dpkg itself keeps.
    std::set<std::string> files() const
    {
        std::set<std::string> names;
        for (const auto& entry : fs::recursive_directory_iterator(mFolder.path()))
            names.insert(entry.path().lexically_relative(mFolder.path()).string());
        std::erase_if(names, [](const std::string& name) { return name.starts_with("var"); });
        return names;
    }

    const TemporaryFolder& folder() const { return mFolder; }

private:
    TemporaryFolder mFolder;
};

// The package as the next version would be, with one sample less.
std::string nextVersion(const TemporaryFolder& folder)
{
    const std::string tree = (folder / "tree").string();
    const std::string package = (folder / "next.deb").string();
    const auto made = runCommand(
        "dpkg-deb -R '" + packageFile("tessel").string() + "' '" + tree +
        "' && sed -i 's/^Version: .*/Version: 99.0/' '" + tree + "/DEBIAN/control' && rm '" + tree +
        "/usr/" LIBRARIES "/tessel/samples/units.lsp' && dpkg-deb --root-owner-group -Znone -b '" + tree +
        "' '" + package + "'");
    EXPECT_EQ(made.status, 0) << made.output;
    return package;
}
} // namespace

TEST(Packages, AreWithoutFaultsToLintian)
{
    const auto outcome =
        runCommand(std::string("lintian --allow-root --fail-on error,warning ") + kAllPackages);
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    EXPECT_THAT(outcome.output, Not(HasSubstr(": "))) << "nothing is said about any of them";
}

TEST(Packages, AreTheSameToTheLastBitWhenMadeAgain)
{
    const TemporaryFolder folder;
    const auto made = runCommand(PACKAGE_MAKER " --from " BUILD " '" + folder.path().string() + "'");
    ASSERT_EQ(made.status, 0) << made.output;
    for (const char* package : {"tessel", "tessel-dev", "modrig"})
    {
        const auto first = packageFile(package);
        const auto compared =
            runCommand("cmp '" + first.string() + "' '" + (folder / first.filename()).string() + "'");
        EXPECT_EQ(compared.status, 0) << package << compared.output;
    }
}

TEST(Packages, NameWhatTheirProgramsNeed)
{
    EXPECT_THAT(field("tessel", "Depends"), AllOf(HasSubstr("libgnustep-gui"), HasSubstr("libecl"),
                                                  HasSubstr("-cairo"), HasSubstr("libc6")));
    EXPECT_THAT(field("modrig", "Depends"), AllOf(HasSubstr("libgnustep-gui"), Not(HasSubstr("libecl"))));
    EXPECT_EQ(field("tessel-dev", "Depends"), "tessel (= " MODRIG_VERSION ")\n");
    for (const char* package : {"tessel", "tessel-dev", "modrig"})
        EXPECT_EQ(field(package, "Version"), MODRIG_VERSION "\n");
}

TEST(Packages, GoWithoutATraceAfterAnUpgrade)
{
    const Root root;
    const auto installed = root.dpkg(std::string("-i ") + kAllPackages);
    ASSERT_EQ(installed.status, 0) << installed.output;
    const std::string library = "usr/" LIBRARIES "/";
    EXPECT_THAT(root.files(), AllOf(Contains("usr/bin/tessel"), Contains("usr/include/tessel/tessel/tsrx.h"),
                                    Contains(library + "modrig/Modrig.bundle/Modrig"),
                                    Contains(library + "tessel/samples/units.lsp"),
                                    Contains("usr/share/man/man1/tessel.1.gz")));

    const TemporaryFolder next;
    const auto upgraded = root.dpkg("-i '" + nextVersion(next) + "'");
    EXPECT_EQ(upgraded.status, 0) << upgraded.output;
    EXPECT_THAT(root.installed(), HasSubstr("ii tessel 99.0\n"));
    EXPECT_THAT(root.files(), Not(Contains(library + "tessel/samples/units.lsp")));
    const auto runs = runCommand("'" + (root.folder() / "usr/bin/tessel").string() + "' --version");
    EXPECT_EQ(runs.status, 0) << runs.output;

    const auto removed = root.dpkg("--purge tessel tessel-dev modrig");
    EXPECT_EQ(removed.status, 0) << removed.output;
    EXPECT_THAT(root.files(), IsEmpty());
}
