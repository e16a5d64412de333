// Records of applications that stand in files beside the plug-ins.
#include "host/applications/ShippedRecords.h"

#include <gmock/gmock.h>

#include "host/text/Unicode.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

namespace
{
class ShippedRecords : public testing::Test
{
protected:
    void write(const std::string& file, const std::string& record) const
    {
        folder.write(file, "Windows Registry Editor Version 5.00\n\n[HKCU\\Product\\Applications\\" + record);
    }
    std::vector<tessel::ShippedRecord> read() const
    {
        return tessel::readShippedRecords(folder.path(), L"Product");
    }

    const TemporaryFolder folder;
};
} // namespace

TEST_F(ShippedRecords, HaveModuleReasonsAndCommandsAndWhatHelpTellsOfThem)
{
    write("a.reg",
          "One]\n\"Module\"=\"One.bundle\"\n\"Description\"=\"The first\"\n\"LoadReasons\"=\"4\"\n"
          "\"Group\"=\"G\"\n[HKCU\\Product\\Applications\\One\\Commands]\n\"A\"=\"EINS\"\n\"B\"=\"B\"\n"
          "[HKCU\\Product\\Applications\\One\\Usage]\n\"A\"=\"[word]\"\n"
          "[HKCU\\Product\\Applications\\One\\Summaries]\n\"a\"=\"Does one thing\"\n");
    const auto records = read();
    ASSERT_EQ(records.size(), 1U);
    EXPECT_EQ(records[0].record.name, L"One");
    EXPECT_EQ(tessel::toUtf8(records[0].record.module), (folder / "One.bundle").string());
    EXPECT_EQ(records[0].record.description, L"The first");
    EXPECT_EQ(records[0].record.loadReasons, 4U);
    EXPECT_THAT(records[0].record.commands, ElementsAre(Pair(L"A", L"EINS"), Pair(L"B", L"B")));
    ASSERT_EQ(records[0].commands.size(), 2U);
    EXPECT_EQ(records[0].commands[0].group, L"G");
    EXPECT_EQ(records[0].commands[0].name, L"EINS");
    EXPECT_EQ(records[0].commands[0].usage, L"[word]");
    EXPECT_EQ(records[0].commands[0].summary, L"Does one thing");
    EXPECT_EQ(records[0].commands[1].usage, L"");
}

TEST_F(ShippedRecords, ThatAreNotWholeArePassedOver)
{
    write("a.reg", "NoModule]\n\"LoadReasons\"=\"4\"\n");
    write("b.reg", "NoReasons]\n\"Module\"=\"b.zmb\"\n");
    write("c.reg", "Unreadable]\n\"Module\"=\"c.zmb\"\n\"LoadReasons\"=\"four\"\n");
    folder.write("d.reg", "no registry file");
    EXPECT_THAT(read(), IsEmpty());
    write("e.reg", "Whole]\n\"Module\"=\"e.zmb\"\n\"LoadReasons\"=\"2\"\n");
    EXPECT_EQ(read().size(), 1U);
}
