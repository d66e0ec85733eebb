#include "programs/tool/options.h"
#include "util/command_line.h"

// Those of the commands that end by themselves are tested by calling the tool.
TEST(ToolOptions, TakeTheSwitchesOfSend) {
    const ToolOptions send = parseToolOptions(GetCommandLine("send --loop b.zcap --speed 2.5 --port 1", 9)).options;
    EXPECT_TRUE(send.loop);
    EXPECT_EQ(send.speed, 2.5);
    EXPECT_EQ(send.port, 1);
}

TEST(ToolOptions, NameWhatIsWrongWithACall) {
    const std::pair<const char*, const char*> rows[] = {
        {"", "no command is named"},
        {"play", "there is no command 'play'"},
        {"info", "no file is named"},
        {"info a b", "'b' is one file too many"},
        {"info a --seed 1", "info does not take --seed"},
        {"trace a --until 9", "--capture is missing"},
        {"trace a --capture b --until", "--until needs a value"},
        {"trace a --capture b --until -1", "'-1' is no value of --until"},
        {"trace a --capture b --until 9 --engine x", "'x' is no value of --engine"},
        {"record --out a --port 65536", "'65536' is no value of --port"},
        {"render a --capture b --out c", "render needs --at, or --from and --to"},
        {"render a --capture b --out c --from 9 --to 8", "--to lies before --from"},
        {"record --out a", ""},
        {"convert a", "no file to write is named"},
    };
    for (const auto& [call, problem] : rows)
        EXPECT_EQ(parseToolOptions(GetCommandLine(call, 99)).problem, problem) << call;
}
