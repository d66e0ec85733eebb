#include "programs/tool/convert_command.h"
#include "programs/tool/demo_show_command.h"
#include "programs/tool/info_command.h"
#include "programs/tool/options.h"
#include "programs/tool/record_command.h"
#include "programs/tool/render_command.h"
#include "programs/tool/send_command.h"
#include "programs/tool/table_command.h"
#include "programs/tool/trace_command.h"
#include "util/failure.h"

#include <QCoreApplication>

#include <cstdio>
#include <exception>
#include <string>
#include <vector>

namespace {

struct Command {
    std::string_view name;
    int (*run)(const ToolOptions& options);
};

constexpr Command kCommands[] = {{"info", runInfo},          {"table", runTable},    {"trace", runTrace},
                                 {"render", runRender},      {"send", runSend},      {"record", runRecord},
                                 {"demo-show", runDemoShow}, {"convert", runConvert}};

int runCommand(const ToolOptions& options) {
    for (const Command& command : kCommands) {
        if (command.name == options.command) return command.run(options);
    }
    return 2;
}

}  // namespace

int main(int argc, char** argv) {
    const ParsedOptions parsed = parseToolOptions({argv + 1, argv + argc});
    if (parsed.options.help) {
        std::fputs(toolHelp(parsed.options.command).c_str(), stdout);
        return 0;
    }
    if (!parsed.problem.empty()) {
        std::fprintf(stderr, "zeph-tool: %s\n%s", parsed.problem.c_str(), toolUsage(parsed.options.command).c_str());
        return 2;
    }
    const QCoreApplication application(argc, argv);
    try {
        const int status = runCommand(parsed.options);
        // A full disk shows only here, for what was printed waits in the stream's buffer.
        require(std::fflush(stdout) == 0 && std::ferror(stdout) == 0, "the result could not be written");
        return status;
    } catch (const std::exception& failure) {
        std::fprintf(stderr, "zeph-tool: %s\n", failure.what());
        return 1;
    }
}
