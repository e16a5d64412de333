#include <gmock/gmock.h>

#include "tests/e2e/HostProcess.h"

using testing::HasSubstr;

namespace
{
constexpr char kSentence[] = "Tessel cannot open a window: there is no display.";
}

TEST(WithoutADisplay, TheDialogSaysSoInOneSentenceAndTheSessionGoesOn)
{
    const HostSession session;
    const auto result = session.run({"MODRIG", "VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output,
                HasSubstr(std::string("Command: MODRIG\n") + kSentence + "\nCommand: VERSION\nTessel R21"));
}

TEST(WithoutADisplay, TheSameIsSaidOfADisplayThatDoesNotAnswer)
{
    HostSession session;
    session.set("DISPLAY", ":9999");
    const auto result = session.run({"MODRIG", "VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr(kSentence));
}
