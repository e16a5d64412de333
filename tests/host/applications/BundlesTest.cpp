// Bundles whose description or program is not what it should be: each is told in one sentence.
#include "host/applications/platform/ObjectiveCRuntime.h"
#include "tests/host/support/HostWithModules.h"

#include <fstream>
#include <iterator>

#include <gmock/gmock.h>
#include <sys/stat.h>

using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

class Bundles : public HostWithModules
{
protected:
    void SetUp() override { bundle = fixture("Good.bundle", "odd.bundle"); }

    // The end of the sentence about the bundle; what else was said, too.
    std::string refusal()
    {
        testing::internal::CaptureStderr();
        EXPECT_FALSE(load(bundle));
        const std::string toolkit = testing::internal::GetCapturedStderr();
        const std::string start = "The application \"" + bundle.native() + "\" is not loaded: ";
        const std::string said = output();
        EXPECT_THAT(said, StartsWith(start));
        return toolkit + (said.starts_with(start) ? said.substr(start.size()) : said);
    }

    std::string refusalOf(const std::string& text)
    {
        describe(text);
        return refusal();
    }

    void describe(const std::string& text) const { std::ofstream(description(), std::ios::binary) << text; }

    std::filesystem::path description() const { return bundle / "Resources" / "Info-gnustep.plist"; }

    std::string unusable(const std::string& why) const
    {
        return "its description \"" + description().native() + "\" cannot be used: " + why + ".\n";
    }

    std::filesystem::path bundle;
};

TEST_F(Bundles, MayNameTheirProgramByEitherKeyAndInAFolderOfTheirOwn)
{
    for (const char* text :
         {"{ NSExecutable = Good; }", "{ CFBundleExecutable = Good; }", "{ NSExecutable = \"inner/Good\"; }"})
    {
        std::filesystem::create_directory(bundle / "inner");
        std::filesystem::copy_file(bundle / "Good", bundle / "inner" / "Good",
                                   std::filesystem::copy_options::overwrite_existing);
        describe(text);
        EXPECT_TRUE(load(bundle)) << text;
        EXPECT_EQ(output(), "odd.bundle: message 1\n");
        EXPECT_TRUE(unload(bundle));
        output();
    }
}

TEST_F(Bundles, AreToldWhenTheNameOfTheProgramIsNoText)
{
    const std::string start = "<?xml version=\"1.0\"?><plist version=\"1.0\"><dict><key>NSExecutable</key>";
    const std::string end = "</dict></plist>";
    for (const std::string& text :
         {std::string("{ NSExecutable = (Good); }"), std::string("{ NSExecutable = { a = Good; }; }"),
          std::string("{ NSExecutable = <476f6f64>; }"), std::string("{ CFBundleExecutable = (Good); }"),
          std::string("{ NSExecutable = Good; CFBundleExecutable = (Good); }"),
          start + "<integer>5</integer>" + end, start + "<true/>" + end,
          start + "<date>2026-11-22T00:00:00Z</date>" + end, start + "<data>R29vZA==</data>" + end})
        EXPECT_EQ(refusalOf(text), "its description has no text for the name of its program.\n") << text;
}

TEST_F(Bundles, AreToldWhenTheProgramIsNotNamed)
{
    for (const char* text : {"{ }", "{ NSExecutable = \"\"; }", "{ Other = Good; }"})
        EXPECT_EQ(refusalOf(text), "the bundle holds no program for this system.\n") << text;
}

TEST_F(Bundles, AreRefusedWhenTheNameOfTheProgramLeadsOut)
{
    fixture("Good.bundle");
    const std::string absolute = (mFolder / "Good.bundle" / "Good").native();
    for (const std::string& name :
         {std::string("../Good.bundle/Good"), std::string("Resources/../../Good.bundle/Good"),
          std::string("Resources/../Good"), absolute, (bundle / "Good").native()})
        for (const char* key : {"NSExecutable", "CFBundleExecutable"})
            EXPECT_EQ(refusalOf(std::string("{ ") + key + " = \"" + name + "\"; }"),
                      "its description names the program \"" + name + "\", which leads out of the bundle.\n");
    EXPECT_EQ(names(), L"");
}

TEST_F(Bundles, SayWhichProgramIsMissing)
{
    EXPECT_EQ(refusalOf("{ NSExecutable = Gone; }"),
              "its program \"" + (bundle / "Gone").native() + "\" is missing.\n");
    describe("{ NSExecutable = Good; }");
    std::filesystem::remove(bundle / "Good");
    std::filesystem::create_symlink("nowhere", bundle / "Good");
    EXPECT_EQ(refusal(), "its program \"" + (bundle / "Good").native() + "\" is missing.\n");
}

TEST_F(Bundles, AreToldWhenTheDescriptionIsNoPropertyList)
{
    for (const char* text :
         {"Once upon { a time", "(Good", "{ NSExecutable = Good", "{ NSExecutable = \"Good",
          "<?xml version=\"1.0\"?><plist version=\"1.0\"><dict><key>NSExecutable", "<?xml version=\"1.0\"?>",
          "\xFF\xFE\xFF", "bplist00\1\2", "\177ELF\2\1\1"})
    {
        const std::string said = refusalOf(text);
        EXPECT_THAT(said, StartsWith("its description \"" + description().native() +
                                     "\" cannot be used: it is no property list"))
            << text;
        EXPECT_EQ(std::count(said.begin(), said.end(), '\n'), 1) << said;
    }
}

// The toolkit takes gigabytes for these bytes, or does not come back.
TEST_F(Bundles, AreToldWhenTheDescriptionIsForMachinesAlone)
{
    for (const char first : {'\0', '\1'})
        EXPECT_EQ(refusalOf(first + std::string("\6\1\3\0\0\0\0\0", 8)),
                  unusable("it is no property list that a person or a tool for bundles writes"));
}

TEST_F(Bundles, AreToldWhenTheDescriptionIsNoTable)
{
    for (const char* text :
         {"(Good)", "Good", "<476f6f64>", "<?xml version=\"1.0\"?><plist version=\"1.0\"><array/></plist>"})
        EXPECT_EQ(refusalOf(text), unusable("it is no table of names and values")) << text;
}

TEST_F(Bundles, AreToldWhenTheDescriptionIsNoFileWithContent)
{
    describe("");
    EXPECT_EQ(refusal(), unusable("the file is empty"));
    std::filesystem::remove(description());
    std::filesystem::create_directory(description());
    EXPECT_EQ(refusal(), unusable("it is a folder, not a file"));
    std::filesystem::remove(description());
    ASSERT_EQ(mkfifo(description().c_str(), 0600), 0);
    EXPECT_EQ(refusal(), unusable("it is not an ordinary file"));
    std::filesystem::remove(description());
    std::filesystem::create_symlink("/dev/zero", description());
    EXPECT_EQ(refusal(), unusable("it is not an ordinary file"));
    std::filesystem::remove(description());
    EXPECT_EQ(refusal(), "the bundle holds no program for this system.\n");
}

TEST_F(Bundles, AreToldWhenTheDescriptionIsTooLargeOrNestedWithoutEnd)
{
    constexpr std::size_t kLarge = (1U << 20U) + 1;
    std::string large = "{ NSExecutable = Good; }";
    large.resize(kLarge, ' ');
    EXPECT_EQ(refusalOf(large), unusable("it is too large for a description"));
    for (const char* beginning : {"(", "{a=", "<array>"})
    {
        std::string nested = "{ NSExecutable = Good; a = ";
        while (nested.size() < kLarge - 10)
            nested += beginning;
        EXPECT_EQ(refusalOf(nested), unusable("it holds too many lists for a description")) << beginning;
    }
}

TEST_F(Bundles, TakeADescriptionOfTheSizeThatLargeOnesHave)
{
    std::string text = "{ NSExecutable = Good; a = (";
    for (int i = 0; i < 4000; ++i)
        text += "{ type = \"a longer text for this kind of file\"; }, ";
    describe(text + "last); }");
    EXPECT_TRUE(load(bundle)) << output();
}

TEST_F(Bundles, WithAnOddIdentifierAreLoaded)
{
    for (const char* identifier : {"(a)", "{ a = b; }", "<00ff>", "\"\""})
    {
        describe(std::string("{ NSExecutable = Good; CFBundleIdentifier = ") + identifier + "; }");
        EXPECT_TRUE(load(bundle)) << identifier << output();
        EXPECT_TRUE(unload(bundle));
        output();
    }
}

TEST_F(Bundles, AreDescribedAtTheirTopWhereNoResourcesAre)
{
    std::filesystem::rename(description(), bundle / "Info.plist");
    EXPECT_TRUE(load(bundle)) << output();
    EXPECT_TRUE(unload(bundle));
    output();
    std::ofstream(bundle / "Info.plist") << "(";
    EXPECT_THAT(refusal(),
                StartsWith("its description \"" + (bundle / "Info.plist").native() + "\" cannot be used: "));
}

// It is looked for in pieces, the end of one of which may cut the name in two.
TEST(BundleLoading, IsNeededWhereverTheNameOfTheRuntimeStandsInTheProgram)
{
    constexpr std::size_t kAroundThePiecesEnd = 16384;
    const std::string name = "__objc_exec_class";
    const TemporaryFolder folder;
    for (std::size_t before = kAroundThePiecesEnd - 20; before <= kAroundThePiecesEnd + 2; ++before)
    {
        const auto program = folder / "program";
        std::ofstream(program) << std::string(before, '_') << name;
        EXPECT_TRUE(tessel::needsBundleLoading(program)) << before;
    }
}
