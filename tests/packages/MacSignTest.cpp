// The signing of what was built on a Mac, with a program in the place of Apple's that notes its words.
#include <filesystem>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

namespace fs = std::filesystem;
using testing::HasSubstr;

namespace
{
class MacSign : public TreeOfPrograms
{
protected:
    MacSign()
    {
        for (const char* file : {"MacOS/Tessel", "MacOS/libtessel.dylib", "MacOS/tesselc",
                                 "PlugIns/A.bundle/Contents/MacOS/A", "PlugIns/A.reg", "Resources/icon"})
            folder.write("Tessel.app/Contents/" + std::string(file), "");
        codesign("echo \"$@\" | sed -e 's|" + folder.path().string() +
                 "/||' -e 's|/[^ ]*/packaging/tessel.entitlements |entitled |'");
    }

    void codesign(const std::string& lines) const { program("bin/codesign", lines); }
    CommandOutcome sign(const std::string& words) const
    {
        return runCommand("cd '" + folder.path().string() + "' && " + path() + "'" MACOS_SIGN "' " + words);
    }
};
} // namespace

TEST_F(MacSign, SignsEverythingThatCountsAsCodeBeforeWhatItLiesIn)
{
    EXPECT_EQ(sign("Tessel.app/").output, "--force --sign - Tessel.app/Contents/PlugIns/A.bundle\n"
                                          "--force --sign - Tessel.app/Contents/PlugIns/A.reg\n"
                                          "--force --sign - Tessel.app/Contents/MacOS/libtessel.dylib\n"
                                          "--force --sign - Tessel.app/Contents/MacOS/tesselc\n"
                                          "--force --sign - Tessel.app\n");
}

TEST_F(MacSign, WithAnIdentityProgramsMayLoadWhatOthersHaveSigned)
{
    const std::string by = "--force --sign Some One --timestamp --options runtime ";
    EXPECT_EQ(sign("Tessel.app 'Some One'").output,
              by + "Tessel.app/Contents/PlugIns/A.bundle\n" + by + "Tessel.app/Contents/PlugIns/A.reg\n" +
                  by + "Tessel.app/Contents/MacOS/libtessel.dylib\n" + by +
                  "--entitlements entitled Tessel.app/Contents/MacOS/tesselc\n" + by +
                  "--entitlements entitled Tessel.app\n");
}

TEST_F(MacSign, EndsWithTheFirstThatCannotBeSigned)
{
    codesign("echo \"$@\"; echo 'no identity found' >&2; exit 1");
    const auto outcome = sign("Tessel.app Nobody");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output, HasSubstr("A.bundle\nno identity found\n"));
    EXPECT_EQ(outcome.output.find("A.reg"), std::string::npos);
}

TEST_F(MacSign, SaysWhatItCannotSign)
{
    EXPECT_EQ(sign("bin").output, "bin is no application and no bundle for macOS.\n");
    fs::remove(folder / "bin/codesign");
    EXPECT_EQ(sign("Tessel.app").output,
              "There is no codesign here: it comes with Apple's developer tools.\n");
}
