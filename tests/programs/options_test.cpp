#include "programs/tool/options.h"

#include <gtest/gtest.h>

namespace {

std::string problem(const std::vector<std::string>& args) {
    return parseToolOptions(args).problem;
}

}  // namespace

TEST(ToolOptions, TakeEachCommandsSwitches) {
    const ToolOptions trace =
        parseToolOptions({"trace", "a.zee", "--capture", "b.zcap", "--until", "90", "--engine", "opengl", "--json"})
            .options;
    EXPECT_EQ(trace.file, "a.zee");
    EXPECT_EQ(trace.capture, "b.zcap");
    EXPECT_EQ(trace.until, 90);
    EXPECT_EQ(trace.engine, "opengl");
    EXPECT_TRUE(trace.json);
    EXPECT_EQ(trace.seed, 1u);
    const ToolOptions send = parseToolOptions({"send", "--loop", "b.zcap", "--speed", "2.5", "--port", "1"}).options;
    EXPECT_EQ(send.file, "b.zcap");
    EXPECT_TRUE(send.loop);
    EXPECT_EQ(send.speed, 2.5);
    EXPECT_EQ(send.port, 1);
    EXPECT_TRUE(parseToolOptions({"send", "--help"}).options.help);
    const ToolOptions convert = parseToolOptions({"convert", "a.zee", "--force", "b.zee"}).options;
    EXPECT_EQ(convert.file, "a.zee");
    EXPECT_EQ(convert.secondFile, "b.zee");
    EXPECT_TRUE(convert.force);
}

TEST(ToolOptions, NameWhatIsWrongWithACall) {
    EXPECT_EQ(problem({}), "no command is named");
    EXPECT_EQ(problem({"play"}), "there is no command 'play'");
    EXPECT_EQ(problem({"info"}), "no file is named");
    EXPECT_EQ(problem({"info", "a", "b"}), "'b' is one file too many");
    EXPECT_EQ(problem({"info", "a", "--seed", "1"}), "info does not take --seed");
    EXPECT_EQ(problem({"trace", "a", "--until", "9"}), "--capture is missing");
    EXPECT_EQ(problem({"trace", "a", "--capture", "b", "--until"}), "--until needs a value");
    EXPECT_EQ(problem({"trace", "a", "--capture", "b", "--until", "-1"}), "'-1' is no value of --until");
    EXPECT_EQ(problem({"trace", "a", "--capture", "b", "--until", "9", "--engine", "x"}),
              "'x' is no value of --engine");
    EXPECT_EQ(problem({"record", "--out", "a", "--port", "65536"}), "'65536' is no value of --port");
    EXPECT_EQ(problem({"render", "a", "--capture", "b", "--out", "c"}), "render needs --at, or --from and --to");
    EXPECT_EQ(problem({"render", "a", "--capture", "b", "--out", "c", "--from", "9", "--to", "8"}),
              "--to lies before --from");
    EXPECT_EQ(problem({"record", "--out", "a"}), "");
    EXPECT_EQ(problem({"record", "--out", "a", "b"}), "'b' is one file too many");
    EXPECT_EQ(problem({"convert", "a"}), "no file to write is named");
    EXPECT_EQ(problem({"convert", "a", "b", "c"}), "'c' is one file too many");
}

TEST(ToolOptions, UsageAndHelpNameEveryCommand) {
    for (const char* command : {"info", "table", "trace", "render", "send", "record", "demo-show", "convert"}) {
        EXPECT_NE(toolHelp("").find(std::string("zeph-tool ") + command), std::string::npos) << command;
        EXPECT_EQ(toolUsage(command).rfind(std::string("usage: zeph-tool ") + command, 0), 0u) << command;
    }
}
