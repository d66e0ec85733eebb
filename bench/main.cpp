// Prints every benchmark as a table, each row beside the first of its group; with --goals only the goal lines.
#include "bench/bench_report.h"

#include <cstdio>
#include <string_view>

namespace {

void printRows(const BenchReport& report) {
    std::string group;
    double first = 0;
    for (const BenchReport::Row& row : report.rows) {
        if (row.group != group) {
            group = row.group;
            first = row.microseconds;
            std::printf("\n%s\n", group.c_str());
        }
        const double ratio = first > 0 ? row.microseconds / first : 0;
        std::printf("  %-58s %12.1f us %8.2f x\n", row.name.c_str(), row.microseconds, ratio);
    }
    std::printf("\n");
}

void printGoals(const BenchReport& report) {
    for (const BenchReport::Goal& goal : report.goals) {
        std::printf("goal %s: %s (%s) %s\n", goal.name.c_str(), goal.figure.c_str(), goal.goal.c_str(),
                    goal.met ? "met" : "short");
    }
}

}  // namespace

int main(int count, char** arguments) {
    const bool goalsOnly = count == 2 && std::string_view(arguments[1]) == "--goals";
    if (count > 1 && !goalsOnly) {
        std::fprintf(stderr, "usage: %s [--goals]\n", arguments[0]);
        return 2;
    }
    BenchReport report;
    benchLoad(report);
    benchUndo(report);
    benchObjectFiles(report);
    benchParser(report);
    benchCommands(report);
    benchCompile(report);
    benchMasks(report);
    benchFrame(report);
    benchGL(report);
    if (!goalsOnly) printRows(report);
    printGoals(report);
    return 0;
}
