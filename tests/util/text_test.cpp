#include "util/command_line.h"
#include "util/message_host.h"
#include "util/text.h"

TEST(ParseLong, TakesTrimmedDecimalsOf32BitsOnly) {
    EXPECT_EQ(parseLong(" -12 "), -12);
    EXPECT_EQ(parseLong("+7"), 7);
    EXPECT_EQ(parseLong("2147483647"), 2147483647);
    EXPECT_EQ(parseLong("-2147483648"), -2147483647 - 1);
    for (const char* bad : {"", " ", "2147483648", "1.5", "12a", "+-3", "0x10", "- 5"}) {
        EXPECT_FALSE(parseLong(bad)) << bad;
    }
}

TEST(ParseFlag, TakesTheTwoWordsInAnyCase) {
    EXPECT_EQ(parseFlag("TRUE"), true);
    EXPECT_EQ(parseFlag(" False"), false);
    for (const char* bad : {"", "1", "-1", "yes"})
        EXPECT_FALSE(parseFlag(bad)) << bad;
}

TEST(LowerCase, LowersBeyondAscii) {
    EXPECT_EQ(lowerCase("Arch_1"), "arch_1");
    EXPECT_EQ(lowerCase("ÄRCH"), "ärch");
    EXPECT_EQ(lowerCase(utf8FromLatin1("\xC4")), "ä");
}

TEST(OnOneLine, ShowsEachKindOfLineBreakOnce) {
    EXPECT_EQ(onOneLine("a\r\nb\nc\rd"), "a / b / c / d");
}

TEST(CommandLine, KeepsQuotedBlanksAndDropsTheQuotes) {
    const std::vector<std::string> expected{"a", "my house.zee", "bc"};
    EXPECT_EQ(GetCommandLine("a \t\"my house.zee\"  b\"\"c", 10), expected);
    EXPECT_EQ(GetCommandLine(commandLineText({"my house.zee", "showerror", "/a/b"}), 10),
              (std::vector<std::string>{"my house.zee", "showerror", "/a/b"}));
    EXPECT_EQ(GetCommandLine("1 2 3", 2).size(), 2u);
    EXPECT_TRUE(GetCommandLine("  \"\" ", 10).empty());
}

TEST(CommandLine, TakesTheSwitchInAnyCaseAndTheLastFile) {
    const CommandLineParms parms = ProcessCommandLineParms({"first.zee", "SHOWERROR", "second.zee", "showerror"});
    EXPECT_TRUE(parms.ShowNextError);
    EXPECT_EQ(parms.FileToOpen, "second.zee");
}
