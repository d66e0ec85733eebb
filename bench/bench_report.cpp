#include "bench/bench_report.h"

#include <cstdio>

namespace {

void printRows(const std::vector<BenchReport::Row>& rows) {
    std::string group;
    double first = 0;
    for (const BenchReport::Row& row : rows) {
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

}  // namespace

void BenchReport::print(bool goalsOnly) const {
    if (!goalsOnly) printRows(rows);
    for (const Goal& goal : goals) {
        std::printf("goal %s: %s (%s) %s\n", goal.name.c_str(), goal.figure.c_str(), goal.goal.c_str(),
                    goal.met ? "met" : "short");
    }
}
