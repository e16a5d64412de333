#include <gmock/gmock.h>

#include "host/ui/platform/gnustep/filepanel/TypedNames.h"

using testing::ElementsAre;
using testing::IsEmpty;
using namespace tessel::filepanel;

TEST(TypedNames, AreOneWithoutQuotationMarks)
{
    EXPECT_THAT(typedNames("my tool.lsp"), ElementsAre("my tool.lsp"));
    EXPECT_THAT(typedNames("a\"b.lsp"), ElementsAre("a\"b.lsp"));
    EXPECT_THAT(typedNames(""), IsEmpty());
}

TEST(TypedNames, AreSeveralInQuotationMarks)
{
    EXPECT_THAT(typedNames("\"a b.lsp\" \"c.lsp\""), ElementsAre("a b.lsp", "c.lsp"));
    EXPECT_THAT(typedNames("\"a.lsp\"\"b.lsp\""), ElementsAre("a.lsp", "b.lsp"));
    EXPECT_THAT(typedNames("\"a.lsp\" \"b"), ElementsAre("a.lsp", "b")) << "the last one is being typed";
    EXPECT_THAT(typedNames("\"\" \"b.lsp\""), ElementsAre("b.lsp"));
    EXPECT_THAT(typedNames("\""), IsEmpty());
}

TEST(TypedNames, StandInTheFieldAsTheyAreTyped)
{
    EXPECT_EQ("", fieldText({}));
    EXPECT_EQ("a b.lsp", fieldText({"a b.lsp"}));
    EXPECT_EQ("\"a b.lsp\" \"c.lsp\"", fieldText({"a b.lsp", "c.lsp"}));
}

TEST(TypedPath, IsInTheFolderUnlessItIsAWholeOne)
{
    EXPECT_EQ("/work/a.lsp", typedPath("a.lsp", "/work", "/home/me"));
    EXPECT_EQ("/a.lsp", typedPath("a.lsp", "/", "/home/me"));
    EXPECT_EQ("/work/sub/a.lsp", typedPath("sub/a.lsp", "/work", "/home/me"));
    EXPECT_EQ("/a.lsp", typedPath("../a.lsp", "/work", "/home/me"));
    EXPECT_EQ("/other/a.lsp", typedPath("/other/a.lsp", "/work", "/home/me"));
    EXPECT_EQ("/other", typedPath("/other/", "/work", "/home/me"));
    EXPECT_EQ("/", typedPath("/", "/work", "/home/me"));
}

TEST(TypedPath, KnowsTheHomeFolder)
{
    EXPECT_EQ("/home/me", typedPath("~", "/work", "/home/me"));
    EXPECT_EQ("/home/me/a.lsp", typedPath("~/a.lsp", "/work", "/home/me"));
    EXPECT_EQ("/work/~a.lsp", typedPath("~a.lsp", "/work", "/home/me")) << "a name may begin like this";
}

TEST(TypedStart, IsTakenApartAtTheLastSlash)
{
    EXPECT_EQ("", typedStart("gea").way);
    EXPECT_EQ("gea", typedStart("gea").beginning);
    EXPECT_EQ("~/sub/", typedStart("~/sub/gea").way);
    EXPECT_EQ("gea", typedStart("~/sub/gea").beginning);
    EXPECT_EQ("", typedStart("/").beginning);
}

TEST(Completion, GoesOnWithTheFirstNameThatBeginsSo)
{
    EXPECT_EQ("gears.omp", completed("ge", {"fan.omp", "gears.omp", "gel.omp"}));
    EXPECT_EQ("", completed("x", {"fan.omp"}));
    EXPECT_EQ("", completed("", {"fan.omp"}));
}

TEST(Completion, PrefersTheSameCase)
{
    EXPECT_EQ("gears.omp", completed("ge", {"GEARS.omp", "gears.omp"}));
    EXPECT_EQ("GEARS.omp", completed("ge", {"GEARS.omp"}));
}

TEST(Completion, LeavesAWholeNameAlone)
{
    EXPECT_EQ("", completed("tool", {"tool", "tool.lsp"}));
}
