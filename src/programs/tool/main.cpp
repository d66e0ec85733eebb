#include "programs/tool/demo_show_command.h"
#include "programs/tool/info_command.h"
#include "programs/tool/options.h"
#include "programs/tool/record_command.h"
#include "programs/tool/send_command.h"
#include "programs/tool/table_command.h"
#include "programs/tool/trace_command.h"

#include <QCoreApplication>

#include <cstdio>
#include <exception>
#include <string>
#include <vector>

namespace {

int runCommand(const ToolOptions& options) {
    if (options.command == "info") return runInfo(options);
    if (options.command == "table") return runTable(options);
    if (options.command == "demo-show") return runDemoShow(options);
    if (options.command == "send") return runSend(options);
    if (options.command == "record") return runRecord(options);
    return runTrace(options);
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
        return runCommand(parsed.options);
    } catch (const std::exception& failure) {
        std::fprintf(stderr, "zeph-tool: %s\n", failure.what());
        return 1;
    }
}
