#include "util/command_line.h"
#include "util/message_host.h"
#include "util/text.h"

TEST(Text, NumbersAndFlagsAreTrimmedAndNothingElse) {
    for (const auto& [text, number] : {std::pair{" -12 ", -12}, {"+7", 7}, {"2147483647", 2147483647}})
        EXPECT_EQ(parseLong(text), number);
    for (const char* bad : {"", " ", "2147483648", "1.5", "12a", "+-3", "0x10", "- 5"})
        EXPECT_FALSE(parseLong(bad)) << bad;
    EXPECT_EQ(parseFlag("TRUE"), true);
    EXPECT_EQ(parseFlag(" False"), false);
    for (const char* bad : {"", "1", "-1", "yes"})
        EXPECT_FALSE(parseFlag(bad)) << bad;
}

TEST(Text, LowersBeyondAsciiAndShowsEachLineBreakOnce) {
    EXPECT_EQ(lowerCase("ÄRCH_1" + utf8FromLatin1("\xC4")), "ärch_1ä");
    EXPECT_EQ(onOneLine("a\r\nb\nc\rd"), "a / b / c / d");
}

TEST(CommandLine, KeepsQuotedBlanksAndDropsTheQuotes) {
    const std::vector<std::string> words{"a", "my house.zee", "bc"};
    EXPECT_EQ(GetCommandLine("a \t\"my house.zee\"  b\"\"c  \"\" ", 10), words);
    EXPECT_EQ(GetCommandLine(commandLineText(words), 10), words);
    EXPECT_EQ(GetCommandLine("1 2 3", 2).size(), 2u);
    const CommandLineParms parms = ProcessCommandLineParms({"first.zee", "SHOWERROR", "second.zee", "showerror"});
    EXPECT_TRUE(parms.ShowNextError);
    EXPECT_EQ(parms.FileToOpen, "second.zee");
}
